#include "engine/display/LineRaster.h"

#include "engine/display/LineCrowding.h"
#include "engine/display/VisibleParts.h"
#include "engine/display/kernel/FrameSetup.h"
#include "engine/images/Image.h"

#include <tbb/parallel_for.h>
#include <tbb/task_arena.h>

#include <algorithm>
#include <cmath>
#include <mutex>

namespace quarn {

namespace {

float widest(const LineStyle& style) {
    return std::max(style.width_px, style.outline_width_px);
}

} // namespace

void LineBatch::reset(const LineStyle& style, PictureScratch& scratch) {
    *this = LineBatch();
    m_style = style;
    m_scratch = &scratch;
}

void LineBatch::addChunk() {
    Chunk* const chunk = m_scratch->take<Chunk>(1).data();
    chunk->next = nullptr;
    (m_last ? m_last->next : m_first) = chunk;
    m_last = chunk;
}

void LineBatch::listChunks() {
    m_chunks = m_scratch->take<Chunk*>((m_count + segments_a_chunk - 1) / segments_a_chunk);
    Chunk* chunk = m_first;
    for (Chunk*& listed : m_chunks) {
        listed = chunk;
        chunk = chunk->next;
    }
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
    listChunks();
    const int band_count = (picture_height + band_height - 1) / band_height;
    const auto bands = static_cast<std::size_t>(band_count);
    // Begins as the number of segments in each band, moved on by two.
    const std::span<std::uint32_t> starts = m_scratch->takeZeroed<std::uint32_t>(bands + 2);
    const auto forEachBand = [&](std::uint32_t index, const auto& function) {
        const BandRange range = bandsOf(segment(index), band_count);
        for (int band = range.first; band <= range.last; ++band)
            function(static_cast<std::size_t>(band));
    };
    const auto count = static_cast<std::uint32_t>(m_count);
    for (std::uint32_t i = 0; i < count; ++i)
        forEachBand(i, [&](std::size_t band) { ++starts[band + 2]; });
    for (std::size_t i = 2; i < starts.size(); ++i)
        starts[i] += starts[i - 1];
    m_entries = m_scratch->take<std::uint32_t>(starts.back());
    // Filling moves the start of each band on to its end, which is the next one's start.
    for (std::uint32_t i = 0; i < count; ++i)
        forEachBand(i, [&](std::size_t band) { m_entries[starts[band + 1]++] = i; });
    m_starts = starts.first(bands + 1);
}

std::span<const std::uint32_t> LineBatch::inBand(int band) const {
    const auto index = static_cast<std::size_t>(band);
    return m_entries.subspan(m_starts[index], m_starts[index + 1] - m_starts[index]);
}

namespace {

/// How much of each pixel of a band the lines of one style cover. All of it is 0 while it is not
/// lent.
struct BandCover {
    struct RowRange {
        int begin = 0;
        int end = 0;
    };
    std::span<float> pixels;
    std::span<RowRange> rows; ///< where the cover is not 0
};

/// One cover for each band that is drawn at the same time.
class BandCovers {
public:
    BandCovers(PictureScratch& scratch, int width, int band_count)
        : m_scratch(scratch),
          m_pixels(static_cast<std::size_t>(width) * std::size_t{LineBatch::band_height}),
          m_free(scratch.take<BandCover>(static_cast<std::size_t>(
              std::min(band_count, tbb::this_task_arena::max_concurrency())))) {
        for (BandCover& cover : m_free)
            cover = make();
        m_free_count = m_free.size();
    }
    BandCover lend() {
        const std::lock_guard lock(m_mutex);
        return m_free_count > 0 ? m_free[--m_free_count] : make();
    }
    void takeBack(const BandCover& cover) {
        const std::lock_guard lock(m_mutex);
        if (m_free_count < m_free.size())
            m_free[m_free_count++] = cover;
    }

private:
    BandCover make() {
        return {m_scratch.takeZeroed<float>(m_pixels),
                m_scratch.takeZeroed<BandCover::RowRange>(LineBatch::band_height)};
    }

    PictureScratch& m_scratch;
    std::size_t m_pixels;
    std::mutex m_mutex;
    std::span<BandCover> m_free;
    std::size_t m_free_count = 0;
};

/// One band of the picture.
class Band {
public:
    Band(const LineTarget& target, const LineCrowding& crowding, int index, BandCovers& covers)
        : m_target(target), m_crowding(crowding), m_top(index * LineBatch::band_height),
          m_bottom(std::min(target.height, m_top + LineBatch::band_height)), m_covers(covers),
          m_cover(covers.lend()), m_surfaces(target) {}
    ~Band() { m_covers.takeBack(m_cover); }
    Band(const Band&) = delete;
    Band& operator=(const Band&) = delete;

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
    void addSteep(const ScreenSegment& s, float reach);
    void addFlat(const ScreenSegment& s, float reach);
    void cover(int x, int y, const ScreenSegment& s);
    float leftByLayers(int x, int y, float nearness) const;
    void blendPixel(std::uint32_t& pixel, float amount) const;

    const LineTarget& m_target;
    const LineCrowding& m_crowding;
    int m_top;
    int m_bottom;
    LineStyle m_style;
    BandCovers& m_covers;
    BandCover m_cover; ///< by the present style
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
        m_cover
            .pixels[row * static_cast<std::size_t>(m_target.width) + static_cast<std::size_t>(x)];
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
    BandCover::RowRange& range = m_cover.rows[row];
    if (range.end == 0)
        range = {x, x + 1};
    else
        range = {std::min(range.begin, x), std::max(range.end, x + 1)};
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

void Band::blendPixel(std::uint32_t& pixel, float amount) const {
    const float keep = 1.0F - amount;
    const auto mixed = [&](int shift, std::uint8_t line) {
        const auto under = static_cast<float>(pixel >> shift & 255U);
        return static_cast<std::uint32_t>(keep * under + amount * static_cast<float>(line) + 0.5F)
               << shift;
    };
    pixel = mixed(0, m_style.color.r) | mixed(8, m_style.color.g) | mixed(16, m_style.color.b) |
            0xFF000000U;
}

void Band::blend() {
    const auto freedom = [this](int x, int y) {
        if (m_style.crowded <= 0.0F)
            return 1.0F;
        return 1.0F - m_style.crowded * (1.0F - m_crowding.strength(x, y));
    };
    for (int y = m_top; y < m_bottom; ++y) {
        BandCover::RowRange& range = m_cover.rows[static_cast<std::size_t>(y - m_top)];
        float* const cover = m_cover.pixels.data() + static_cast<std::size_t>(y - m_top) *
                                                         static_cast<std::size_t>(m_target.width);
        std::uint32_t* const row = m_target.pixels + static_cast<std::size_t>(y) *
                                                         static_cast<std::size_t>(m_target.width);
        for (int x = range.begin; x < range.end; ++x) {
            if (cover[x] > 0.0F)
                blendPixel(row[x], cover[x] * m_style.opacity * freedom(x, y));
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

void drawLines(std::span<const LineBatch> batches, const LineTarget& target,
               PictureScratch& scratch) {
    static_assert(LineCrowding::cell_size == LineBatch::band_height,
                  "each band fills a row of cells of its own");
    const int band_count = (target.height + LineBatch::band_height - 1) / LineBatch::band_height;
    LineCrowding crowding;
    if (std::any_of(batches.begin(), batches.end(),
                    [](const LineBatch& batch) { return batch.style().crowded > 0.0F; })) {
        crowding.reset(target.width, target.height, scratch);
        tbb::parallel_for(0, band_count,
                          [&](int index) { findCrowding(batches, index, crowding); });
        crowding.finish();
    }
    BandCovers covers(scratch, target.width, band_count);
    tbb::parallel_for(0, band_count, [&](int index) {
        Band band(target, crowding, index, covers);
        for (const LineBatch& batch : batches) {
            band.setStyle(batch.style());
            for (const std::uint32_t segment : batch.inBand(index))
                band.add(batch.segment(segment));
        }
        band.blend();
    });
}

} // namespace quarn
