#include "import/assembly/RoundingTold.h"

#include <algorithm>
#include <cmath>
#include <locale>
#include <sstream>
#include <vector>

namespace quarn {

namespace {

constexpr double VISIBLE_SHARE = 1e-5; // of the model's size

/// The distance between neighbouring numbers of single precision, which has 24 binary digits.
double roundingStep(const KM_BoundingBox& box) {
    double largest = 1e-30;
    for (int corner = 0; corner < 8 && box.IsValid(); ++corner) {
        const KM_3dPoint p = box.Corner(corner);
        largest = std::max({largest, std::abs(p.x), std::abs(p.y), std::abs(p.z)});
    }
    return std::ldexp(1.0, std::ilogb(largest) - 23);
}

/// How much longer a transform makes what points along an axis, at most.
double largestScale(const KM_Xform& x) {
    double largest = 0.0;
    for (int axis = 0; axis < 3; ++axis)
        largest = std::max(largest,
                           std::hypot(x.m_xform[0][axis], x.m_xform[1][axis], x.m_xform[2][axis]));
    return largest;
}

} // namespace

std::string roundingText(const SourceScene& scene) {
    std::vector<KM_BoundingBox> boxes;
    for (const SourceMesh& piece : scene.meshes)
        boxes.push_back(piece.mesh ? piece.mesh->BoundingBox() : KM_BoundingBox());
    double step = 0.0;
    KM_BoundingBox all;
    for (const SourcePlace& place : scene.places) {
        const KM_BoundingBox& box = boxes[place.mesh];
        step = std::max(step, largestScale(place.world_from_mesh) * roundingStep(box));
        for (int corner = 0; corner < 8 && box.IsValid(); ++corner)
            all.Set(place.world_from_mesh * box.Corner(corner));
    }
    const double size = all.IsValid() ? all.Diagonal().Length() : 0.0;
    if (!(size > 0.0) || step <= VISIBLE_SHARE * size)
        return {};
    std::ostringstream text;
    text.imbue(std::locale::classic());
    text << "The model lies so far from the origin that its coordinates are rounded to multiples "
            "of "
         << step << ". Move it nearer, or export it as OBJ.";
    return text.str();
}

} // namespace quarn
