#include "engine/sunhours/SurfaceGrid.h"

#include "engine/sunhours/MeshNumbers.h"
#include "engine/sunhours/SceneTriangles.h"

#include <cmath>
#include <string>

namespace quarn {

namespace {

double cutsOf(const SceneTriangle& triangle, double size) {
    return std::max(1.0, std::ceil(triangle.longestEdge() / size - 1e-9));
}

void addPart(SurfaceGrid& grid, const SceneTriangle& triangle, const double (&u)[3],
             const double (&v)[3], bool has_two_sides) {
    for (int i = 0; i < 3; ++i) {
        const KM_3dPoint corner = triangle.at(u[i], v[i]);
        grid.corners.emplace_back(static_cast<float>(corner.x), static_cast<float>(corner.y),
                                  static_cast<float>(corner.z));
    }
    grid.points.add(
        triangle.point((u[0] + u[1] + u[2]) / 3.0, (v[0] + v[1] + v[2]) / 3.0, has_two_sides));
}

/// Rows of triangles that stand, and between them those that hang.
void addTriangle(SurfaceGrid& grid, const SceneTriangle& triangle, int cuts, bool has_two_sides) {
    const double step = 1.0 / cuts;
    for (int i = 0; i < cuts; ++i)
        for (int j = 0; i + j < cuts; ++j) {
            const double u = i * step;
            const double v = j * step;
            addPart(grid, triangle, {u, u + step, u}, {v, v, v + step}, has_two_sides);
            if (i + j + 1 < cuts)
                addPart(grid, triangle, {u + step, u + step, u}, {v, v + step, v + step},
                        has_two_sides);
        }
}

template <class Visit> void eachTriangle(const DisplayScene& scene, const Visit& visit) {
    for (std::size_t i = 0; i < scene.meshes().size(); ++i) {
        const DisplayScene::MeshObject& object = scene.meshes()[i];
        if (!object.mesh || !object.visible)
            continue;
        for (const KM_MeshTriangle& indices : object.mesh->mesh().m_F)
            if (const SceneTriangle triangle(object, indices); triangle.area() > 0.0)
                visit(i, triangle);
    }
}

} // namespace

Result<SurfaceGrid> gridOfSurfaces(const DisplayScene& scene, double size) {
    double count = 0.0;
    eachTriangle(scene, [&](std::size_t, const SceneTriangle& triangle) {
        count += std::pow(cutsOf(triangle, size), 2.0);
    });
    if (count > static_cast<double>(most_grid_triangles))
        return Error{"A grid of this size has more than " + std::to_string(most_grid_triangles) +
                     " triangles. Give a larger size."};
    SurfaceGrid grid{SurfacePoints(scene.surfaceBox().Diagonal().Length()), {}};
    const std::vector<bool> one_sided = oneSidedMeshes(scene);
    eachTriangle(scene, [&](std::size_t mesh, const SceneTriangle& triangle) {
        addTriangle(grid, triangle, static_cast<int>(cutsOf(triangle, size)), !one_sided[mesh]);
    });
    return grid;
}

} // namespace quarn
