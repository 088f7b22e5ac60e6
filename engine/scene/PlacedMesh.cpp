#include "engine/scene/PlacedMesh.h"

#include <algorithm>
#include <cmath>

namespace quarn {

namespace {

/// True when each axis goes to an axis: then the corners of a box go to the corners of its image.
bool keepsAxes(const KM_Xform& x) {
    for (int i = 0; i < 3; ++i) {
        int in_row = 0;
        int in_column = 0;
        for (int j = 0; j < 3; ++j) {
            in_row += x.m_xform[i][j] != 0.0 ? 1 : 0;
            in_column += x.m_xform[j][i] != 0.0 ? 1 : 0;
        }
        if (in_row > 1 || in_column > 1)
            return false;
    }
    return true;
}

} // namespace

KM_BoundingBox PlacedMesh::box() const {
    return box(mesh->BoundingBox());
}

KM_BoundingBox PlacedMesh::box(const KM_BoundingBox& own_box) const {
    if (!own_box.IsValid() || world_from_mesh.IsIdentity())
        return own_box;
    KM_BoundingBox box;
    if (keepsAxes(world_from_mesh)) {
        for (int i = 0; i < 8; ++i)
            box.Set(world_from_mesh * own_box.Corner(i));
        return box;
    }
    for (const KM_3fPoint& vertex : mesh->m_V)
        if (vertex.IsValid())
            box.Set(world_from_mesh * vertex.ToDouble());
    return box;
}

KM_3dPoint nearbyOrigin(const KM_BoundingBox& box) {
    constexpr double far_in_sizes = 100.0;
    if (!box.IsValid())
        return KM_3dPoint::Origin;
    const KM_3dPoint center = box.Center();
    const double size = box.Diagonal().Length();
    const double distance = std::max({std::abs(center.x), std::abs(center.y), std::abs(center.z)});
    if (!(distance > far_in_sizes * size) || size == 0.0)
        return KM_3dPoint::Origin;
    const double step = std::pow(10.0, std::ceil(std::log10(size)) + 1.0);
    const auto round = [step](double coordinate) { return step * std::round(coordinate / step); };
    return {round(center.x), round(center.y), round(center.z)};
}

} // namespace quarn
