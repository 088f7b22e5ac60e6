#include "tests/engine/display/DisplayFixture.h"

#include "engine/images/ColorSpace.h"

#include <gtest/gtest.h>

#include <array>
#include <cmath>

namespace quarn {
namespace {

using Light = std::array<double, 3>;

/// Scene light in the middle of a view from above.
Light lightOf(const SceneContent& content, const wchar_t* mode) {
    const Image image = drawn(content, topView(5.0), modeNamed(mode), 100, 100);
    Light light{};
    for (std::size_t c = 0; c < 3; ++c)
        light[c] = sceneLightShownAs(linearFromSrgbByte(image.pixel(48, 52)[c]));
    return light;
}

/// In steps of a channel's 255.
int shownAs(double light) {
    return srgbByteFromLinear(toneMapped(static_cast<float>(light)));
}

void addFloor(KM_Mesh& mesh, float height) {
    const auto first = static_cast<std::uint32_t>(mesh.m_V.size());
    for (const KM_3fPoint& corner : floorMesh(-4.0F, -4.0F, 4.0F, 4.0F, height).m_V)
        mesh.m_V.push_back(corner);
    mesh.m_F.push_back({{first, first + 1, first + 2}});
    mesh.m_F.push_back({{first, first + 2, first + 3}});
}

/// Floors above each other, in one mesh.
SceneContent stack(int floors) {
    KM_Mesh mesh;
    for (int i = 0; i < floors; ++i)
        addFloor(mesh, 0.1F * static_cast<float>(i));
    SceneContent content;
    addMesh(content, std::move(mesh));
    return content;
}

SceneContent nothing() {
    SceneContent content = stack(1);
    content.meshes.front().visible = false;
    return content;
}

// What lies behind a floor keeps 0.9 of its light and takes 0.12 of the floor's colour. The light
// of n floors is s (1 - q^n) + b q^n, with b of the background and q of that; s follows from 16.
TEST(ManyLayers, XRayShowsEachOfUpToSixteenSurfacesBehindEachOther) {
    const Light background = lightOf(nothing(), L"X-Ray");
    const Light sixteen = lightOf(stack(16), L"X-Ray");
    const Light albedo{0.42, 0.58, 0.76};
    for (const int floors : {1, 2, 4, 7, 8, 9, 12, 15}) {
        const Light light = lightOf(stack(floors), L"X-Ray");
        for (std::size_t c = 0; c < 3; ++c) {
            const double q = 0.9 * (1.0 - 0.12 * (1.0 - albedo[c]));
            const double all = std::pow(q, 16);
            const double s = (sixteen[c] - all * background[c]) / (1.0 - all);
            const double part = std::pow(q, floors);
            EXPECT_NEAR(shownAs(light[c]), shownAs(s * (1.0 - part) + background[c] * part), 1.0)
                << floors << " floors, channel " << c;
        }
    }
    EXPECT_GT(std::fabs(sixteen[0] - background[0]), 0.1);
}

TEST(ManyLayers, SurfacesBehindTheSixteenthAreNotSeen) {
    const auto picture = [](int floors) {
        return drawn(stack(floors), topView(3.0), modeNamed(L"X-Ray"), 60, 60);
    };
    EXPECT_EQ(picture(16).rgba, picture(40).rgba);
}

TEST(ManyLayers, TheNearestAreSeenInTheirOrderHoweverTheyAreStored) {
    const auto picture = [](int begin, int end) {
        SceneContent content;
        for (int i = begin; i != end; i += begin < end ? 1 : -1)
            addMesh(content, floorMesh(-4.0F, -4.0F, 4.0F, 4.0F, 0.1F * static_cast<float>(i)),
                    i % 2 == 0 ? KM_Color{250, 210, 200, 255} : KM_Color{200, 230, 250, 255});
        return drawn(content, topView(3.0), modeNamed(L"Translucent"), 60, 60);
    };
    const Image rising = picture(0, 30);
    EXPECT_EQ(rising.rgba, picture(29, -1).rgba);
    EXPECT_EQ(rising.rgba, picture(10, 30).rgba);
    EXPECT_NE(rising.rgba, picture(0, 29).rgba);
}

} // namespace
} // namespace quarn
