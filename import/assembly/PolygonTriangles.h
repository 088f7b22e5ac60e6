#pragma once

#include "import/assembly/CornerGrid.h"
#include "kelmar/KM_Point.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

namespace quarn {

/// Cuts polygons into triangles: convex ones from their first corner, others by taking off ears one
/// after the other (G. H. Meisters, "Polygons Have Ears", The American Mathematical Monthly 82(6),
/// 1975), so that nothing outside of a planar outline is covered. An outline that winds so much
/// that this would take more than some seconds is cut as it comes from there on. Keeps its memory
/// from one polygon to the next.
class PolygonTriangles {
public:
    /// The numbers of three corners of the polygon, which turn as the polygon does.
    using Triangle = std::array<std::uint32_t, 3>;

    /// @param corners  in their order round the polygon, also such that are no usable numbers
    /// @return two triangles less than there are corners; valid until the next call
    std::span<const Triangle> cut(std::span<const KM_3dPoint> corners);

private:
    using Flat = CornerGrid::Place;

    void flatten(std::span<const KM_3dPoint> corners);
    double turnAt(std::uint32_t before, std::uint32_t here, std::uint32_t after) const;
    bool isConvex() const;
    void cutFan();
    void cutEars();
    bool isEar(std::uint32_t corner);
    bool keepsEarOff(std::uint32_t other, std::uint32_t corner) const;
    void takeOff(std::uint32_t corner);

    std::vector<Flat> m_flat; ///< the corners in the polygon's plane, anticlockwise
    std::vector<Triangle> m_triangles;
    std::vector<std::uint32_t> m_before; ///< the corner that is left before each
    std::vector<std::uint32_t> m_after;
    std::vector<std::uint32_t> m_reflex; ///< corners that no ear may hold
    CornerGrid m_near;                   ///< those corners
    std::uint64_t m_looks_left = 0;      ///< at other corners
};

} // namespace quarn
