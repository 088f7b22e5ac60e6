#include "import/textures/TexturePlace.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>

namespace quarn {

namespace {

float single(double number) {
    constexpr double MOST = std::numeric_limits<float>::max();
    return static_cast<float>(std::clamp(number, -MOST, MOST));
}

} // namespace

bool layTexture(const TexturePlace& mesh, const TexturePlace& place, TextureUse& use) {
    if (mesh == place) { // without rounding
        use = {use.texture, TextureUse().u, TextureUse().v};
        return true;
    }
    const double determinant = mesh.u[0] * mesh.v[1] - mesh.u[1] * mesh.v[0];
    if (determinant == 0.0 || !std::isfinite(1.0 / determinant))
        return false;
    const auto seenFromMesh = [&](const double(&row)[3]) -> std::array<float, 3> {
        const double a = (row[0] * mesh.v[1] - row[1] * mesh.v[0]) / determinant;
        const double b = (row[1] * mesh.u[0] - row[0] * mesh.u[1]) / determinant;
        return {single(a), single(b), single(row[2] - a * mesh.u[2] - b * mesh.v[2])};
    };
    use.u = seenFromMesh(place.u);
    use.v = seenFromMesh(place.v);
    return true;
}

} // namespace quarn
