#include "tests/engine/display/DisplayFixture.h"

#include <gtest/gtest.h>

namespace quarn {
namespace {

/// The free sky is found at every second pixel corner: at x and y of 1, 3, 5 pixels and so on. What
/// lies between 20.2 and 20.8 pixels of this view, from -2.98 to -2.92, is never met there.
constexpr float thin_left = -2.98F;
constexpr float thin_right = -2.92F;
constexpr int thin_column = 20;

double clayAt(const SceneContent& content, int x) {
    DisplayModeAttributes mode = modeNamed(L"Clay");
    mode.casts_shadows = false; // what is darker is so for want of sky
    const Image image = drawn(content, topView(5.0), mode, 100, 100);
    return brightness(image, x, 50);
}

/// A floor below two plates that leave a slot between them.
SceneContent slot(float left, float right, float height) {
    SceneContent content;
    addMesh(content, floorMesh(-5.0F, -5.0F, 5.0F, 5.0F, 0.0F));
    addMesh(content, floorMesh(-5.0F, -5.0F, left, 5.0F, height));
    addMesh(content, floorMesh(right, -5.0F, 5.0F, 5.0F, height));
    return content;
}

TEST(ClayThinParts, TheBottomOfASlotOfHalfAPixelIsDark) {
    const SceneContent content = slot(thin_left, thin_right, 0.3F);
    const double plate = clayAt(content, 60);
    EXPECT_LT(clayAt(content, thin_column), 0.9 * plate);
    EXPECT_NEAR(clayAt(content, thin_column - 1), plate, 3.0);
    EXPECT_NEAR(clayAt(content, thin_column + 1), plate, 3.0);
}

TEST(ClayThinParts, ABarOfHalfAPixelInTheOpenIsAsBrightAsAPlate) {
    SceneContent content;
    addMesh(content, floorMesh(-5.0F, -5.0F, 5.0F, 5.0F, 0.0F));
    addMesh(content, floorMesh(thin_left, -4.0F, thin_right, 4.0F, 2.0F));
    addMesh(content, floorMesh(0.0F, -4.0F, 4.0F, 4.0F, 2.0F));
    EXPECT_NEAR(clayAt(content, thin_column), clayAt(content, 70), 1.0);
}

} // namespace
} // namespace quarn
