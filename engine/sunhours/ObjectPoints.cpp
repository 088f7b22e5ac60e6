#include "engine/sunhours/ObjectPoints.h"

#include "engine/sunhours/MeshNumbers.h"
#include "engine/sunhours/SceneTriangles.h"

#include <algorithm>
#include <cmath>

namespace quarn {

namespace {

/// Of all objects together; and of one, of which more would change means by less than a thousandth.
constexpr std::size_t MOST_POINTS = 300'000;
constexpr std::size_t MOST_OF_OBJECT = 16'384;
constexpr std::size_t FEWEST_OF_OBJECT = 16;

constexpr double GOLDEN = 0.61803398874989485;

/// A number of [0, 1) that looks like chance (G. Steele, D. Lea and C. Flood, "Fast Splittable
/// Pseudorandom Number Generators", OOPSLA 2014: the mixing function).
double scattered(std::uint64_t number) {
    std::uint64_t z = number * 0x9E3779B97F4A7C15U + 0x9E3779B97F4A7C15U;
    z = (z ^ (z >> 30)) * 0xBF58476D1CE4E5B9U;
    z = (z ^ (z >> 27)) * 0x94D049BB133111EBU;
    return static_cast<double>((z ^ (z >> 31)) >> 11) * 0x1p-53;
}

double fraction(double number) {
    return number - std::floor(number);
}

/// Points of one triangle: a lattice of the unit square by the golden ratio, bent onto the triangle
/// so that areas keep their sizes.
void addPoints(const SceneTriangle& triangle, std::size_t index, std::size_t count,
               bool has_two_sides, SurfacePoints& points) {
    const double start = scattered(2 * index);
    const double turn = scattered(2 * index + 1);
    for (std::size_t i = 0; i < count; ++i) {
        const double a = std::sqrt((static_cast<double>(i) + start) / static_cast<double>(count));
        const double b = fraction(static_cast<double>(i) * GOLDEN + turn);
        points.add(triangle.point(a * (1.0 - b), a * b, has_two_sides));
    }
}

double areaOf(const DisplayScene::MeshObject& object) {
    double area = 0.0;
    for (const KM_MeshTriangle& indices : object.mesh->mesh().m_F)
        area += SceneTriangle(object, indices).area();
    return area;
}

/// One point in each of `count` equal shares of the area, somewhere in it by chance, so that a
/// regular mesh is not met in a regular pattern.
void addObject(const DisplayScene::MeshObject& object, std::size_t count, bool has_two_sides,
               double area, SurfacePoints& points) {
    const double share = area / static_cast<double>(count);
    double end = 0.0;
    std::size_t next = 0;
    const auto& triangles = object.mesh->mesh().m_F;
    for (std::size_t t = 0; t < triangles.size(); ++t) {
        const SceneTriangle triangle(object, triangles[t]);
        end += triangle.area();
        const std::size_t before = next;
        while (next < count && (static_cast<double>(next) + scattered(~next)) * share < end)
            ++next;
        addPoints(triangle, t, next - before, has_two_sides, points);
    }
}

} // namespace

ObjectPoints spreadPoints(const DisplayScene& scene) {
    ObjectPoints spread{SurfacePoints(scene.surfaceBox().Diagonal().Length()), {}};
    const auto is_shown = [](const auto& object) { return object.mesh && object.visible; };
    const auto shown = static_cast<std::size_t>(std::ranges::count_if(scene.meshes(), is_shown));
    const std::size_t count =
        std::clamp(MOST_POINTS / std::max<std::size_t>(shown, 1), FEWEST_OF_OBJECT, MOST_OF_OBJECT);
    const std::vector<bool> one_sided = oneSidedMeshes(scene);
    for (std::size_t i = 0; i < scene.meshes().size(); ++i) {
        const DisplayScene::MeshObject& object = scene.meshes()[i];
        if (!is_shown(object))
            continue;
        const std::size_t first = spread.points.size();
        const double area = areaOf(object);
        if (area > 0.0)
            addObject(object, count, !one_sided[i], area, spread.points);
        spread.objects.push_back({i, first, spread.points.size() - first, area});
    }
    return spread;
}

} // namespace quarn
