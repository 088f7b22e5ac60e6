#pragma once

#include "engine/display/LineRaster.h"

#include <cstdint>
#include <vector>

namespace quarn {

/// What a picture's depth says of lines that lie on its surfaces.
class SurfaceView {
public:
    explicit SurfaceView(const LineTarget& target) : m_target(target) {}

    /// Two pixels to one side of a line.
    struct Aside {
        int x = 0;
        int y = 0;
    };

    /// A line on a surface is not hidden by it, nor is one that runs along its outline: the nearest
    /// point of the line may lie in the next pixel, so the farthest of the surfaces seen there
    /// counts.
    bool hides(int x, int y, float nearness) const;
    /// True when a place of a line lies where a plane beside the line would run on to. At the foot
    /// of a wall the line is farther away than all that the pixels around show, and yet seen.
    bool meetsSurfaceBeside(const ScreenSegment& line, const ScreenPoint& place) const;
    /// How sharply surfaces bend across a line: the second difference of depth, in pixels. 0 within
    /// a plane, about the size of the step where a surface ends before another, and `open_end`
    /// where nothing lies behind.
    float bendAt(int x, int y, const Aside& aside) const;

    static constexpr float open_end = 10.0F;

private:
    float nearnessAt(int x, int y) const;

    const LineTarget& m_target;
};

/// Cuts the parts out of mesh edges that are seen. It looks along the whole edge: where the depth
/// of a pixel says now seen and now hidden, an edge is not drawn as a row of dots.
class VisibleParts {
public:
    explicit VisibleParts(const LineTarget& target) : m_view(target) {}

    /// Adds the visible parts of the segment. They are as strong and as wide as the surfaces beside
    /// them bend; at the joint of two surfaces that lie in one plane there are none.
    void add(const ScreenSegment& segment, LineBatch& batch);

private:
    void look(const ScreenSegment& segment);
    void lookIntoFolds(const ScreenSegment& segment);
    bool isInFold(const ScreenSegment& segment) const;
    ScreenPoint sampleOf(const ScreenSegment& segment, std::size_t index) const;
    void closeGaps();
    void dropDots();
    float meanBend(std::size_t at, std::size_t begin, std::size_t end) const;
    void addRun(const ScreenSegment& segment, std::size_t begin, std::size_t end,
                LineBatch& batch) const;

    SurfaceView m_view;
    std::vector<std::uint8_t> m_seen; ///< sample by sample, about one a pixel
    std::vector<float> m_bends;
};

} // namespace quarn
