#include "engine/display/VisibleParts.h"

#include "engine/images/Image.h"

#include <algorithm>
#include <cmath>

namespace quarn {

namespace {

/// Depths count as the same within this part of them.
constexpr float same_depth = 3e-4F;
/// A line that is farther than this part of what a pixel shows lies in none of its folds.
constexpr float least_in_fold = 0.97F;

/// In samples.
constexpr std::size_t longest_gap = 3;
constexpr std::size_t shortest_run = 6;
constexpr std::size_t piece = 8;
constexpr std::size_t mean_reach = 8;
constexpr std::size_t probe_step = 8;

/// Bends below the first are joints within a plane, from the second on they are edges.
constexpr float no_bend = 0.08F;
constexpr float clear_bend = 0.45F;
/// Steps in depth, in pixels: from the smaller on an edge begins to be an outline.
constexpr float small_step_px = 4.0F;
constexpr float large_step_px = 9.0F;

float part(float value, float from, float to) {
    return std::clamp((value - from) / (to - from), 0.0F, 1.0F);
}

ScreenPoint along(const ScreenSegment& s, float t) {
    return {s.from.x + t * (s.to.x - s.from.x), s.from.y + t * (s.to.y - s.from.y),
            s.from.nearness + t * (s.to.nearness - s.from.nearness),
            s.from.strength + t * (s.to.strength - s.from.strength), 0.0F};
}

int pixelOf(float place) {
    return static_cast<int>(std::floor(place));
}

/// Calls function(begin, end) for each run of samples with that value.
template <class Function>
void forEachRun(const std::vector<std::uint8_t>& samples, std::uint8_t value,
                const Function& function) {
    for (std::size_t begin = 0; begin < samples.size();) {
        std::size_t end = begin + 1;
        while (end < samples.size() && samples[end] == samples[begin])
            ++end;
        if (samples[begin] == value)
            function(begin, end);
        begin = end;
    }
}

} // namespace

float SurfaceView::nearnessAt(int x, int y) const {
    const int column = std::clamp(x, 0, m_target.width - 1);
    const int row = std::clamp(y, 0, m_target.height - 1);
    return m_target.depth
        ->nearness[static_cast<std::size_t>(row) * static_cast<std::size_t>(m_target.width) +
                   static_cast<std::size_t>(column)];
}

bool SurfaceView::hides(int x, int y, float nearness) const {
    if (!m_target.depth)
        return false;
    const auto hidden = [&](int column, int row) {
        return nearness < (1.0F - same_depth) * nearnessAt(column, row);
    };
    return hidden(x, y) && hidden(x - 1, y) && hidden(x + 1, y) && hidden(x, y - 1) &&
           hidden(x, y + 1);
}

/// Looks at the pixels above and below a flat line, and to the left and right of a steep one.
bool SurfaceView::meetsSurfaceBeside(const ScreenSegment& line, const ScreenPoint& place) const {
    const float dx = line.to.x - line.from.x;
    const float dy = line.to.y - line.from.y;
    const bool is_flat = std::fabs(dx) >= std::fabs(dy);
    const float run = is_flat ? dx : dy;
    if (run == 0.0F)
        return false;
    const float along = is_flat ? place.x : place.y;
    const int column = pixelOf(along);
    const float to_middle = static_cast<float>(column) + 0.5F - along;
    const float across = (is_flat ? place.y : place.x) + to_middle * (is_flat ? dy : dx) / run;
    const float nearness =
        place.nearness + to_middle * (line.to.nearness - line.from.nearness) / run;
    const int row = pixelOf(across);
    if (nearness < least_in_fold * (is_flat ? nearnessAt(column, row) : nearnessAt(row, column)))
        return false;
    const auto meets = [&](int side) {
        float near[3];
        for (int i = 0; i < 3; ++i) {
            const int beside = row + side * (i + 1);
            near[i] = is_flat ? nearnessAt(column, beside) : nearnessAt(beside, column);
        }
        if (std::fabs(near[0] - 2.0F * near[1] + near[2]) > same_depth * near[0])
            return false;
        const float away = std::fabs(static_cast<float>(row + side) + 0.5F - across);
        return nearness >= (1.0F - same_depth) * (near[0] + away * (near[0] - near[1]));
    };
    return meets(-1) || meets(1);
}

float SurfaceView::bendAt(int x, int y, const Aside& aside) const {
    const float here = nearnessAt(x, y);
    const float left = nearnessAt(x - aside.x, y - aside.y);
    const float right = nearnessAt(x + aside.x, y + aside.y);
    if (here <= 0.0F && left <= 0.0F && right <= 0.0F)
        return 0.0F;
    if (here <= 0.0F || left <= 0.0F || right <= 0.0F)
        return open_end;
    const float scale = m_target.depth->parallel ? 1.0F : here;
    return std::min(open_end,
                    std::fabs(left + right - 2.0F * here) / (scale * m_target.pixel_size));
}

void VisibleParts::add(const ScreenSegment& segment, LineBatch& batch) {
    look(segment);
    lookIntoFolds(segment);
    closeGaps();
    dropDots();
    forEachRun(m_seen, 1,
               [&](std::size_t begin, std::size_t end) { addRun(segment, begin, end, batch); });
}

void VisibleParts::look(const ScreenSegment& segment) {
    const float dx = segment.to.x - segment.from.x;
    const float dy = segment.to.y - segment.from.y;
    const float length = std::sqrt(dx * dx + dy * dy);
    const auto count = 1 + static_cast<std::size_t>(length);
    const float scale = length > 0.0F ? 2.0F / length : 0.0F;
    const SurfaceView::Aside aside{static_cast<int>(std::lrintf(-dy * scale)),
                                   static_cast<int>(std::lrintf(dx * scale))};
    m_seen.resize(count);
    m_bends.resize(count);
    for (std::size_t i = 0; i < count; ++i) {
        const ScreenPoint place = sampleOf(segment, i);
        const int x = pixelOf(place.x);
        const int y = pixelOf(place.y);
        m_seen[i] = m_view.hides(x, y, place.nearness) ? 0 : 1;
        m_bends[i] = m_view.bendAt(x, y, aside);
    }
}

ScreenPoint VisibleParts::sampleOf(const ScreenSegment& segment, std::size_t index) const {
    const auto count = static_cast<float>(m_seen.size());
    return along(segment, (static_cast<float>(index) + 0.5F) / count);
}

void VisibleParts::lookIntoFolds(const ScreenSegment& segment) {
    const bool is_seen = std::find(m_seen.begin(), m_seen.end(), 1) != m_seen.end();
    if (!is_seen && !isInFold(segment))
        return;
    for (std::size_t i = 0; i < m_seen.size(); ++i)
        if (!m_seen[i] && m_view.meetsSurfaceBeside(segment, sampleOf(segment, i)))
            m_seen[i] = 1;
}

/// Most lines lie far behind what hides them: a few samples tell.
bool VisibleParts::isInFold(const ScreenSegment& segment) const {
    for (std::size_t i = probe_step / 2; i < m_seen.size(); i += probe_step)
        if (m_view.meetsSurfaceBeside(segment, sampleOf(segment, i)))
            return true;
    return false;
}

void VisibleParts::closeGaps() {
    forEachRun(m_seen, 0, [this](std::size_t begin, std::size_t end) {
        if (begin > 0 && end < m_seen.size() && end - begin <= longest_gap)
            std::fill(m_seen.begin() + static_cast<std::ptrdiff_t>(begin),
                      m_seen.begin() + static_cast<std::ptrdiff_t>(end), std::uint8_t{1});
    });
}

/// Runs at an end of the edge may go on in the next one, if they are not alone.
void VisibleParts::dropDots() {
    forEachRun(m_seen, 1, [this](std::size_t begin, std::size_t end) {
        if (end - begin < shortest_run && end - begin < m_seen.size() && m_seen.size() > 12)
            std::fill(m_seen.begin() + static_cast<std::ptrdiff_t>(begin),
                      m_seen.begin() + static_cast<std::ptrdiff_t>(end), std::uint8_t{0});
    });
}

float VisibleParts::meanBend(std::size_t at, std::size_t begin, std::size_t end) const {
    const std::size_t first = std::max(begin, at - std::min(at, mean_reach));
    const std::size_t last = std::min(end, at + mean_reach + 1);
    float sum = 0.0F;
    for (std::size_t i = first; i < last; ++i)
        sum += m_bends[i];
    return sum / static_cast<float>(last - first);
}

void VisibleParts::addRun(const ScreenSegment& segment, std::size_t begin, std::size_t end,
                          LineBatch& batch) const {
    const auto count = static_cast<float>(m_seen.size());
    const auto pointAt = [&](std::size_t sample) {
        ScreenPoint point = along(segment, static_cast<float>(sample) / count);
        const float bend = meanBend(std::min(sample, end - 1), begin, end);
        point.strength *= part(bend, no_bend, clear_bend);
        point.growth = part(bend, small_step_px, large_step_px);
        return point;
    };
    ScreenPoint from = pointAt(begin);
    for (std::size_t at = begin; at < end;) {
        at = std::min(end, at + piece);
        const ScreenPoint to = pointAt(at);
        if (from.strength > 0.0F || to.strength > 0.0F)
            batch.add({from, to});
        from = to;
    }
}

} // namespace quarn
