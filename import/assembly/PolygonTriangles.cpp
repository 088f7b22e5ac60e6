#include "import/assembly/PolygonTriangles.h"

#include <cmath>
#include <numeric>

namespace quarn {

namespace {

/// Some seconds' worth: ears of outlines that wind a great deal have many corners near them.
constexpr std::uint64_t MOST_LOOKS = 200'000'000;

/// Normal to the plane of a polygon, as long as twice its area (M. Newell, in I. Sutherland,
/// R. Sproull and R. Schumacker, "A Characterization of Ten Hidden-Surface Algorithms", ACM
/// Computing Surveys 6(1), 1974).
KM_3dVector normalOf(std::span<const KM_3dPoint> corners) {
    KM_3dVector normal;
    for (std::size_t i = 2; i < corners.size(); ++i)
        normal += KM_CrossProduct(corners[i - 1] - corners[0], corners[i] - corners[0]);
    return normal;
}

} // namespace

std::span<const PolygonTriangles::Triangle>
PolygonTriangles::cut(std::span<const KM_3dPoint> corners) {
    m_triangles.clear();
    if (corners.size() < 3)
        return {};
    flatten(corners);
    if (corners.size() == 3 || isConvex())
        cutFan();
    else
        cutEars();
    return m_triangles;
}

/// Looks along the axis that is nearest to the normal.
void PolygonTriangles::flatten(std::span<const KM_3dPoint> corners) {
    const KM_3dVector n = normalOf(corners);
    const double x = std::abs(n.x);
    const double y = std::abs(n.y);
    const double z = std::abs(n.z);
    m_flat.clear();
    for (const KM_3dPoint& p : corners)
        if (z >= x && z >= y)
            m_flat.push_back(n.z < 0.0 ? Flat{p.y, p.x} : Flat{p.x, p.y});
        else if (y >= x)
            m_flat.push_back(n.y < 0.0 ? Flat{p.x, p.z} : Flat{p.z, p.x});
        else
            m_flat.push_back(n.x < 0.0 ? Flat{p.z, p.y} : Flat{p.y, p.z});
}

/// Twice the area of three corners: positive where they turn left.
double PolygonTriangles::turnAt(std::uint32_t before, std::uint32_t here,
                                std::uint32_t after) const {
    const Flat& a = m_flat[before];
    const Flat& b = m_flat[here];
    const Flat& c = m_flat[after];
    return (b.x - a.x) * (c.y - b.y) - (b.y - a.y) * (c.x - b.x);
}

bool PolygonTriangles::isConvex() const {
    const auto count = static_cast<std::uint32_t>(m_flat.size());
    std::uint32_t before = count - 1;
    for (std::uint32_t here = 0; here < count; before = here++)
        if (turnAt(before, here, here + 1 < count ? here + 1 : 0) < 0.0)
            return false;
    return true;
}

void PolygonTriangles::cutFan() {
    for (std::uint32_t i = 2; i < m_flat.size(); ++i)
        m_triangles.push_back({0, i - 1, i});
}

void PolygonTriangles::cutEars() {
    const auto count = static_cast<std::uint32_t>(m_flat.size());
    m_before.resize(count);
    m_after.resize(count);
    m_reflex.clear();
    for (std::uint32_t i = 0; i < count; ++i) {
        m_before[i] = i > 0 ? i - 1 : count - 1;
        m_after[i] = i + 1 < count ? i + 1 : 0;
    }
    for (std::uint32_t i = 0; i < count; ++i)
        if (!(turnAt(m_before[i], i, m_after[i]) > 0.0))
            m_reflex.push_back(i);
    m_near.fill(m_flat, m_reflex);
    m_looks_left = MOST_LOOKS;
    std::uint32_t corner = 0;
    std::uint32_t refused = 0;
    for (std::uint32_t left = count; left > 3;) {
        // Outlines that cross themselves may be left without an ear; then any corner goes.
        if (refused < left && m_looks_left > 0 && !isEar(corner)) {
            ++refused;
            corner = m_after[corner];
            continue;
        }
        takeOff(corner);
        corner = m_after[corner];
        refused = 0;
        --left;
    }
    m_triangles.push_back({m_before[corner], corner, m_after[corner]});
}

bool PolygonTriangles::isEar(std::uint32_t corner) {
    const std::uint32_t before = m_before[corner];
    const std::uint32_t after = m_after[corner];
    --m_looks_left;
    return turnAt(before, corner, after) > 0.0 &&
           !m_near.anyNear(m_flat[before], m_flat[corner], m_flat[after],
                           [this, corner](std::uint32_t other) {
                               m_looks_left -= m_looks_left > 0;
                               return keepsEarOff(other, corner);
                           });
}

bool PolygonTriangles::keepsEarOff(std::uint32_t other, std::uint32_t corner) const {
    const std::uint32_t before = m_before[corner];
    const std::uint32_t after = m_after[corner];
    // Corners at one place: outlines of holes hang on their polygon by an edge taken twice.
    const bool is_own = m_flat[other] == m_flat[before] || m_flat[other] == m_flat[corner] ||
                        m_flat[other] == m_flat[after];
    const bool is_gone = m_after[m_before[other]] != other;
    return !is_own && !is_gone && turnAt(before, corner, other) >= 0.0 &&
           turnAt(corner, after, other) >= 0.0 && turnAt(after, before, other) >= 0.0;
}

void PolygonTriangles::takeOff(std::uint32_t corner) {
    const std::uint32_t before = m_before[corner];
    const std::uint32_t after = m_after[corner];
    m_triangles.push_back({before, corner, after});
    m_after[before] = after;
    m_before[after] = before;
}

} // namespace quarn
