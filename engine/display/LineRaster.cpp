#include "engine/display/LineRaster.h"

#include "engine/display/LineBlend.h"
#include "engine/display/LineCrowding.h"
#include "engine/display/VisibleParts.h"
#include "engine/display/kernel/FrameSetup.h"
#include "engine/images/Image.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <cmath>

namespace quarn {

namespace {

float widest(const LineStyle& style) {
    return std::max(style.width_px, style.outline_width_px);
}

} // namespace

void LineBatch::reset(const LineStyle& style) {
    m_style = style;
    m_segments.clear();
}

LineBatch::BandRange LineBatch::bandsOf(const ScreenSegment& s, int band_count) const {
    const float reach = 0.5F * widest(m_style) + 0.5F;
    const auto band = [band_count](float y) {
        const float index = std::floor(y / static_cast<float>(band_height));
        return static_cast<int>(std::clamp(index, 0.0F, static_cast<float>(band_count - 1)));
    };
    return {band(std::min(s.from.y, s.to.y) - reach), band(std::max(s.from.y, s.to.y) + reach)};
}

void LineBatch::sortIntoBands(int picture_height) {
    const int band_count = (picture_height + band_height - 1) / band_height;
    m_starts.assign(static_cast<std::size_t>(band_count) + 1, 0);
    for (const ScreenSegment& s : m_segments) {
        const BandRange bands = bandsOf(s, band_count);
        for (int band = bands.first; band <= bands.last; ++band)
            ++m_starts[static_cast<std::size_t>(band) + 1];
    }
    for (std::size_t i = 1; i < m_starts.size(); ++i)
        m_starts[i] += m_starts[i - 1];
    m_entries.resize(m_starts.back());
    // Filling from behind turns each start into its own running end and back.
    for (std::size_t i = m_segments.size(); i-- > 0;) {
        const BandRange bands = bandsOf(m_segments[i], band_count);
        for (int band = bands.first; band <= bands.last; ++band)
            m_entries[--m_starts[static_cast<std::size_t>(band) + 1]] =
                static_cast<std::uint32_t>(i);
    }
    m_starts.erase(m_starts.begin());
    m_starts.push_back(static_cast<std::uint32_t>(m_entries.size()));
}

std::span<const std::uint32_t> LineBatch::inBand(int band) const {
    const auto index = static_cast<std::size_t>(band);
    return std::span(m_entries).subspan(m_starts[index], m_starts[index + 1] - m_starts[index]);
}

namespace {

/// One band of the picture, and how much of each pixel the lines of the present style cover.
class Band {
public:
    Band(const LineTarget& target, const LineCrowding& crowding, int index)
        : m_target(target), m_crowding(crowding), m_top(index * LineBatch::band_height),
          m_bottom(std::min(target.height, m_top + LineBatch::band_height)),
          m_cover(static_cast<std::size_t>(target.width) *
                  static_cast<std::size_t>(m_bottom - m_top)),
          m_rows(static_cast<std::size_t>(m_bottom - m_top)), m_surfaces(target) {}

    void setStyle(const LineStyle& style) {
        if (style == m_style)
            return;
        blend();
        m_style = style;
    }
    void add(const ScreenSegment& segment);
    /// Lays the present style over the picture.
    void blend();

private:
    struct RowRange {
        int begin = 0;
        int end = 0;
    };
    void addSteep(const ScreenSegment& s, float reach);
    void addFlat(const ScreenSegment& s, float reach);
    void cover(int x, int y, const ScreenSegment& s);
    float leftByLayers(int x, int y, float nearness) const;

    const LineTarget& m_target;
    const LineCrowding& m_crowding;
    int m_top;
    int m_bottom;
    LineStyle m_style;
    std::vector<float> m_cover;
    std::vector<RowRange> m_rows; ///< where the cover is not 0
    SurfaceView m_surfaces;
};

void Band::add(const ScreenSegment& s) {
    const float reach = 0.5F * widest(m_style) + 0.5F;
    const float dx = s.to.x - s.from.x;
    const float dy = s.to.y - s.from.y;
    if (std::fabs(dx) >= std::fabs(dy))
        addFlat(s, reach);
    else
        addSteep(s, reach);
}

int firstCenterFrom(float place, int limit) {
    return std::max(limit, static_cast<int>(std::ceil(place - 0.5F)));
}

int endOfCentersTo(float place, int limit) {
    return std::min(limit, static_cast<int>(std::floor(place - 0.5F)) + 1);
}

/// Column by column.
void Band::addFlat(const ScreenSegment& s, float reach) {
    const float dx = s.to.x - s.from.x;
    const float slope = dx != 0.0F ? (s.to.y - s.from.y) / dx : 0.0F;
    const float across = reach * std::sqrt(1.0F + slope * slope);
    const float left = std::min(s.from.x, s.to.x);
    const float right = std::max(s.from.x, s.to.x);
    const int end = endOfCentersTo(right + reach, m_target.width);
    for (int x = firstCenterFrom(left - reach, 0); x < end; ++x) {
        const float at = std::clamp(static_cast<float>(x) + 0.5F, left, right);
        const float y = s.from.y + slope * (at - s.from.x);
        const int y_end = endOfCentersTo(y + across, m_bottom);
        for (int row = firstCenterFrom(y - across, m_top); row < y_end; ++row)
            cover(x, row, s);
    }
}

/// Row by row.
void Band::addSteep(const ScreenSegment& s, float reach) {
    const float slope = (s.to.x - s.from.x) / (s.to.y - s.from.y);
    const float across = reach * std::sqrt(1.0F + slope * slope);
    const float upper = std::min(s.from.y, s.to.y);
    const float lower = std::max(s.from.y, s.to.y);
    const int end = endOfCentersTo(lower + reach, m_bottom);
    for (int row = firstCenterFrom(upper - reach, m_top); row < end; ++row) {
        const float at = std::clamp(static_cast<float>(row) + 0.5F, upper, lower);
        const float x = s.from.x + slope * (at - s.from.y);
        const int x_end = endOfCentersTo(x + across, m_target.width);
        for (int column = firstCenterFrom(x - across, 0); column < x_end; ++column)
            cover(column, row, s);
    }
}

void Band::cover(int x, int y, const ScreenSegment& s) {
    const float dx = s.to.x - s.from.x;
    const float dy = s.to.y - s.from.y;
    const float px = static_cast<float>(x) + 0.5F - s.from.x;
    const float py = static_cast<float>(y) + 0.5F - s.from.y;
    const float square = dx * dx + dy * dy;
    const float t = square > 0.0F ? std::clamp((px * dx + py * dy) / square, 0.0F, 1.0F) : 0.0F;
    const float ex = px - t * dx;
    const float ey = py - t * dy;
    const float distance = std::sqrt(ex * ex + ey * ey);
    const auto row = static_cast<std::size_t>(y - m_top);
    float& covered =
        m_cover[row * static_cast<std::size_t>(m_target.width) + static_cast<std::size_t>(x)];
    const float strength = s.from.strength + t * (s.to.strength - s.from.strength);
    const float growth = s.from.growth + t * (s.to.growth - s.from.growth);
    const float width = m_style.width_px + growth * (widest(m_style) - m_style.width_px);
    float amount = strength * std::min(0.5F * width + 0.5F - distance, std::min(1.0F, width));
    if (amount <= covered)
        return;
    const float nearness = s.from.nearness + t * (s.to.nearness - s.from.nearness);
    if (m_style.hidden_by_pixel && m_surfaces.hides(x, y, nearness))
        return;
    amount *= leftByLayers(x, y, nearness);
    if (amount <= covered)
        return;
    covered = amount;
    RowRange& range = m_rows[row];
    range = range.end == 0 ? RowRange{x, x + 1}
                           : RowRange{std::min(range.begin, x), std::max(range.end, x + 1)};
}

/// See-through surfaces let lines behind them through, each a part.
float Band::leftByLayers(int x, int y, float nearness) const {
    if (!m_target.layers || m_style.covered_strength >= 1.0F)
        return 1.0F;
    int fewest = layers_kept;
    const auto look = [&](int column, int row) {
        const float* const layers =
            m_target.layers +
            (static_cast<std::size_t>(std::clamp(row, 0, m_target.height - 1)) *
                 static_cast<std::size_t>(m_target.width) +
             static_cast<std::size_t>(std::clamp(column, 0, m_target.width - 1))) *
                layers_kept;
        int before = 0;
        while (before < fewest && nearness < (1.0F - 3e-4F) * layers[before])
            ++before;
        fewest = before;
    };
    look(x, y);
    look(x - 1, y);
    look(x + 1, y);
    look(x, y - 1);
    look(x, y + 1);
    float left = 1.0F;
    for (int i = 0; i < fewest; ++i)
        left *= m_style.covered_strength;
    return left;
}

void Band::blend() {
    const auto freedom = [this](int x, int y) {
        if (m_style.crowded <= 0.0F)
            return 1.0F;
        return 1.0F - m_style.crowded * (1.0F - m_crowding.strength(x, y));
    };
    for (int y = m_top; y < m_bottom; ++y) {
        RowRange& range = m_rows[static_cast<std::size_t>(y - m_top)];
        float* const cover = m_cover.data() + static_cast<std::size_t>(y - m_top) *
                                                  static_cast<std::size_t>(m_target.width);
        std::uint32_t* const row = m_target.pixels + static_cast<std::size_t>(y) *
                                                         static_cast<std::size_t>(m_target.width);
        for (int x = range.begin; x < range.end; ++x) {
            if (cover[x] > 0.0F)
                row[x] =
                    blendedOver(row[x], m_style.color, cover[x] * m_style.opacity * freedom(x, y));
            cover[x] = 0.0F;
        }
        range = {};
    }
}

/// Adds the part of a segment that lies in a band, piece by piece.
void addToCrowding(const ScreenSegment& s, float width, int top, int bottom,
                   LineCrowding& crowding) {
    constexpr float piece_px = 6.0F;
    const float dx = s.to.x - s.from.x;
    const float dy = s.to.y - s.from.y;
    float enter = 0.0F;
    float leave = 1.0F;
    if (dy != 0.0F) {
        const float a = (static_cast<float>(top) - s.from.y) / dy;
        const float b = (static_cast<float>(bottom) - s.from.y) / dy;
        enter = std::max(enter, std::min(a, b));
        leave = std::min(leave, std::max(a, b));
    } else if (s.from.y < static_cast<float>(top) || s.from.y >= static_cast<float>(bottom)) {
        return;
    }
    if (leave <= enter)
        return;
    const float length = (leave - enter) * std::sqrt(dx * dx + dy * dy);
    const int pieces = 1 + static_cast<int>(length / piece_px);
    const float step = (leave - enter) / static_cast<float>(pieces);
    const float strength = 0.5F * (s.from.strength + s.to.strength);
    const float area = strength * width * length / static_cast<float>(pieces);
    const auto inBand = [&](float y) {
        return std::clamp(y, static_cast<float>(top), static_cast<float>(bottom) - 0.5F);
    };
    for (int i = 0; i < pieces; ++i) {
        const float t = enter + (static_cast<float>(i) + 0.5F) * step;
        crowding.add(s.from.x + t * dx, inBand(s.from.y + t * dy), area);
    }
}

void findCrowding(std::span<const LineBatch> batches, int band, LineCrowding& crowding) {
    const int top = band * LineBatch::band_height;
    for (const LineBatch& batch : batches) {
        if (batch.style().crowded <= 0.0F)
            continue;
        const float width = batch.style().width_px;
        for (const std::uint32_t segment : batch.inBand(band))
            addToCrowding(batch.segment(segment), width, top, top + LineBatch::band_height,
                          crowding);
    }
}

} // namespace

void drawLines(std::span<const LineBatch> batches, const LineTarget& target) {
    static_assert(LineCrowding::cell_size == LineBatch::band_height,
                  "each band fills a row of cells of its own");
    const int band_count = (target.height + LineBatch::band_height - 1) / LineBatch::band_height;
    LineCrowding crowding;
    if (std::any_of(batches.begin(), batches.end(),
                    [](const LineBatch& batch) { return batch.style().crowded > 0.0F; })) {
        crowding.reset(target.width, target.height);
        tbb::parallel_for(0, band_count,
                          [&](int index) { findCrowding(batches, index, crowding); });
        crowding.finish();
    }
    tbb::parallel_for(0, band_count, [&](int index) {
        Band band(target, crowding, index);
        for (const LineBatch& batch : batches) {
            band.setStyle(batch.style());
            for (const std::uint32_t segment : batch.inBand(index))
                band.add(batch.segment(segment));
        }
        band.blend();
    });
}

} // namespace quarn
