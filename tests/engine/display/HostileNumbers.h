#pragma once

#include "engine/scene/SceneContent.h"
#include "kelmar/KM_Viewport.h"

#include <random>

namespace quarn {

/// Numbers as no person writes them, among usual ones; the same for each seed.
class HostileNumbers {
public:
    explicit HostileNumbers(unsigned seed) : m_random(seed) {}

    /// From -1 to 1 mostly; else zero, denormal, huge, infinite or no number.
    double any();
    /// The same without what is not finite, as it comes from files and prompts.
    double finite();
    /// One of so many, from 0.
    int choice(int count);

    /// Meshes, placed and not, with and without all that a mesh may have, a curve, a point and
    /// lights. In most scenes something usual is to be seen too.
    SceneContent scene();
    /// A camera with whatever the numbers are; valid.
    KM_Viewport camera();

private:
    double scale(bool may_be_infinite);
    KM_3dPoint point();
    KM_Xform place();
    SceneMesh mesh();
    KM_Light light();

    std::mt19937 m_random;
};

} // namespace quarn
