#include "tests/engine/display/DisplayFixture.h"

#include "engine/display/CameraRays.h"
#include "engine/display/ScreenProjection.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace quarn {
namespace {

/// A floor and a plane that rises from its border and leans over it by 45 degrees.
KM_Mesh leaningWall() {
    KM_Mesh mesh;
    for (const auto& [y, z] : {std::pair{-3.0F, 0.0F}, {0.0F, 0.0F}, {-0.6F, 0.6F}})
        for (const float x : {-4.0F, 4.0F})
            mesh.m_V.emplace_back(x, y, z);
    for (const std::uint32_t first : {0U, 2U}) {
        mesh.m_F.push_back({{first, first + 1, first + 3}});
        mesh.m_F.push_back({{first, first + 3, first + 2}});
    }
    return mesh;
}

// The line runs two pixels down for every hundred across, so that it lies now in the middle of a
// row of pixels and now between two, where all that they show is nearer than the line.
TEST(WholeLines, TheFootOfALeaningWallIsDrawnWithoutGaps) {
    SceneContent content;
    addMesh(content, leaningWall());
    const KM_Viewport viewport = perspectiveView({1.5, -14.0, 3.0}, {0.0, 0.0, 0.0});
    constexpr int width = 800;
    constexpr int height = 450;
    const Image image = drawn(content, viewport, modeNamed(L"Drawing", 2), width, height);
    const CameraRays rays =
        cameraRays(viewport, width, height, {{-4.0, -3.0, 0.0}, {4.0, 0.0, 0.6}});
    ScreenSegment foot;
    ASSERT_TRUE(ScreenProjection(rays, width, height, 1.0F)
                    .project({-3.8, 0.0, 0.0}, {3.8, 0.0, 0.0}, foot));
    const float slope = (foot.to.y - foot.from.y) / (foot.to.x - foot.from.x);
    ASSERT_GT(std::abs(slope), 0.01F); // else no gap could be seen
    for (float x = foot.from.x; x < foot.to.x; ++x) {
        const auto y = static_cast<int>(foot.from.y + slope * (x - foot.from.x));
        const auto column = static_cast<int>(x);
        double darkest = 255.0;
        for (int row = y - 1; row <= y + 1; ++row)
            darkest = std::min(darkest, brightness(image, column, row));
        EXPECT_LT(darkest, 170.0) << column;
    }
}

} // namespace
} // namespace quarn
