#include "import/assembly/MeshPlacing.h"

#include "import/assembly/MeshCleaning.h"
#include "import/assembly/VertexNormals.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>
#include <utility>

namespace quarn {

namespace {

constexpr double crease_angle_deg = 40.0;

/// The part of an affine transform that turns normals: its cofactors, which unlike its inverse
/// exist for a flattening one as well.
class NormalTransform {
public:
    explicit NormalTransform(const KM_Xform& x) {
        for (int i = 0; i < 3; ++i) {
            for (int j = 0; j < 3; ++j) {
                const int a = (i + 1) % 3;
                const int b = (i + 2) % 3;
                const int c = (j + 1) % 3;
                const int d = (j + 2) % 3;
                m_cofactors[i][j] =
                    x.m_xform[a][c] * x.m_xform[b][d] - x.m_xform[a][d] * x.m_xform[b][c];
            }
        }
        for (int j = 0; j < 3; ++j)
            m_determinant += x.m_xform[0][j] * m_cofactors[0][j];
    }

    bool mirrors() const { return m_determinant < 0.0; }

    /// A unit vector, or zero where `n` or its image has no direction.
    KM_3fVector operator*(const KM_3fVector& n) const {
        std::array<double, 3> turned{};
        for (int i = 0; i < 3; ++i)
            turned[i] = m_cofactors[i][0] * static_cast<double>(n.x) +
                        m_cofactors[i][1] * static_cast<double>(n.y) +
                        m_cofactors[i][2] * static_cast<double>(n.z);
        const double length = std::hypot(turned[0], turned[1], turned[2]);
        if (!(length > 0.0) || !std::isfinite(length))
            return {};
        const double factor = (mirrors() ? -1.0 : 1.0) / length;
        return {static_cast<float>(turned[0] * factor + 0.0),
                static_cast<float>(turned[1] * factor + 0.0),
                static_cast<float>(turned[2] * factor + 0.0)};
    }

private:
    double m_cofactors[3][3] = {};
    double m_determinant = 0.0;
};

bool onlyMoves(const KM_Xform& x) {
    KM_Xform rest = x;
    for (int i = 0; i < 3; ++i)
        rest.m_xform[i][3] = 0.0;
    return rest.IsIdentity();
}

KM_3fPoint placed(const KM_Xform& xform, const KM_3fPoint& vertex) {
    const KM_3dPoint p = xform * vertex.ToDouble();
    const auto single = [](double coordinate) {
        return isUsableCoordinate(coordinate) ? static_cast<float>(coordinate) + 0.0F
                                              : std::numeric_limits<float>::quiet_NaN();
    };
    return {single(p.x), single(p.y), single(p.z)};
}

/// A reserve that is small beside what is kept is not worth the copy that would release it.
template <class Item> void releaseReserve(std::vector<Item>& items) {
    if (items.capacity() - items.size() > items.size() / 16 + 1)
        items.shrink_to_fit();
}

} // namespace

bool isUsableCoordinate(double coordinate) {
    return std::abs(coordinate) <= double{std::numeric_limits<float>::max()};
}

bool isFlattening(const KM_Xform& xform) {
    KM_Xform inverse = xform;
    return !xform.IsValid() || !inverse.Invert() || !inverse.IsValid();
}

std::size_t placeMesh(KM_Mesh& mesh, const KM_Xform& xform) {
    if (xform.IsIdentity())
        return 0;
    tbb::parallel_for(std::size_t{0}, mesh.m_V.size(),
                      [&](std::size_t v) { mesh.m_V[v] = placed(xform, mesh.m_V[v]); });
    const NormalTransform normals(xform);
    if (!onlyMoves(xform))
        tbb::parallel_for(std::size_t{0}, mesh.m_N.size(),
                          [&](std::size_t n) { mesh.m_N[n] = normals * mesh.m_N[n]; });
    if (normals.mirrors())
        for (KM_MeshTriangle& triangle : mesh.m_F)
            std::swap(triangle.vi[1], triangle.vi[2]);
    return dropUnusableTriangles(mesh);
}

void completeMesh(KM_Mesh& mesh) {
    if (mesh.m_N.empty())
        smoothVertexNormals(mesh, crease_angle_deg);
    else
        fillMissingNormals(mesh);
    releaseReserve(mesh.m_V);
    releaseReserve(mesh.m_N);
    releaseReserve(mesh.m_T);
    releaseReserve(mesh.m_C);
    releaseReserve(mesh.m_F);
    mesh.PadForRayTracing();
}

bool hasArea(const KM_Mesh& mesh) {
    constexpr double least_sine = 1e-7; // of a corner; coordinates have seven digits
    return std::any_of(mesh.m_F.begin(), mesh.m_F.end(), [&](const KM_MeshTriangle& triangle) {
        const KM_3dPoint a = mesh.m_V[triangle.vi[0]].ToDouble();
        const KM_3dVector b = mesh.m_V[triangle.vi[1]].ToDouble() - a;
        const KM_3dVector c = mesh.m_V[triangle.vi[2]].ToDouble() - a;
        return KM_CrossProduct(b, c).Length() > least_sine * b.Length() * c.Length();
    });
}

} // namespace quarn
