#pragma once

#include "host/display/ScreenProjection.h"
#include "kelmar/KM_Color.h"

#include <cstdint>
#include <span>
#include <vector>

namespace quarn {

struct DepthImage;

/// How a line looks.
struct LineStyle {
    KM_Color color;
    float opacity = 1.0F;
    float width_px = 1.0F;
    friend bool operator==(const LineStyle&, const LineStyle&) = default;
};

/// Segments of one style, sorted into bands of the picture.
class LineBatch {
public:
    /// Rows of pixels in a band.
    static constexpr int band_height = 16;

    /// Starts anew; keeps the storage.
    void reset(const LineStyle& style);
    void add(const ScreenSegment& segment) { m_segments.push_back(segment); }
    /// Sorts the segments into bands; call it once, after the last `add`.
    void sortIntoBands(int picture_height);

    const LineStyle& style() const { return m_style; }
    const ScreenSegment& segment(std::uint32_t index) const { return m_segments[index]; }
    /// Indices of the segments that touch a band, in the order in which they were added.
    std::span<const std::uint32_t> inBand(int band) const;

private:
    struct BandRange {
        int first;
        int last;
    };
    BandRange bandsOf(const ScreenSegment& segment, int band_count) const;

    LineStyle m_style;
    std::vector<ScreenSegment> m_segments;
    std::vector<std::uint32_t> m_entries;
    std::vector<std::uint32_t> m_starts;
};

/// Where lines are drawn.
struct LineTarget {
    std::uint32_t* pixels = nullptr; ///< bytes r, g, b, a in memory
    int width = 0;
    int height = 0;
    const DepthImage* depth = nullptr; ///< null: surfaces hide no lines
};

/// Draws the batches over the picture, one band a task.
///
/// A pixel is covered by half the width plus 0.5 minus the distance of its middle from the segment,
/// between 0 and 1. Lines of one style that follow each other cover a pixel as much as the one of
/// them that covers it most, so that joints are no darker than the lines. Covers are blended in
/// sRGB, in which thin dark lines look evenly dark.
void drawLines(std::span<const LineBatch> batches, const LineTarget& target);

} // namespace quarn
