#pragma once

#include "engine/display/ScreenProjection.h"
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
    float outline_width_px = 0.0F; ///< what lines grow to, by their points' `growth`
    /// Surfaces hide the line pixel by pixel; else the segments are seen as they are.
    bool hidden_by_pixel = true;
    float crowded = 0.0F;          ///< 1: the line fades fully where lines crowd; 0: not at all
    float covered_strength = 1.0F; ///< what each see-through surface before the line leaves of it
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
    float pixel_size = 1.0F;           ///< see CameraRays; to tell how sharply surfaces bend
    /// For each pixel how near its see-through surfaces are, `layers_kept` of them from the nearest
    /// on, 0 where there are fewer; null: none cover lines.
    const float* layers = nullptr;
};

/// Draws the batches over the picture, one band a task.
///
/// A pixel is covered by half the width plus 0.5 minus the distance of its middle from the segment,
/// between 0 and 1, times the line's strength there. Lines of one style that follow each other
/// cover a pixel as much as the one of them that covers it most, so that joints are no darker than
/// the lines. Covers are blended in sRGB, in which thin dark lines look evenly dark.
void drawLines(std::span<const LineBatch> batches, const LineTarget& target);

} // namespace quarn
