#include "tests/engine/display/LookScenes.h"

#include "engine/display/RayPick.h"

#include <gtest/gtest.h>

namespace quarn {
namespace {

constexpr int size = 64;
constexpr KM_Color floor_color{40, 160, 60, 255};
constexpr KM_Color lid_color{200, 40, 40, 255};

/// What stands between the camera above and a green floor.
SceneContent under(KM_Mesh lid, bool is_one_sided, const KM_Xform& place = KM_Xform()) {
    SceneContent content;
    addMesh(content, floorMesh(-9, -9, 9, 9, 0), floor_color);
    const std::size_t index = addLook(content, std::move(lid), [&](Material& material) {
        material.base_color = lid_color;
        material.is_one_sided = is_one_sided;
    });
    content.meshes[index].placed.world_from_mesh = place;
    return content;
}

KM_Mesh lid(float height = 2.0F) {
    return floorMesh(-3, -3, 3, 3, height);
}

/// Its front looks down.
KM_Mesh turnedLid(float height = 2.0F) {
    KM_Mesh mesh = lid(height);
    for (KM_MeshTriangle& triangle : mesh.m_F)
        std::swap(triangle.vi[1], triangle.vi[2]);
    return mesh;
}

/// The pixel in the middle, seen from above.
bool seesLid(const SceneContent& content, const wchar_t* mode = L"Rendered") {
    const Image image = drawn(content, topView(5.0), modeNamed(mode), size, size);
    const auto pixel = image.pixel(size / 2, size / 2);
    return pixel[0] > pixel[1];
}

TEST(OneSided, SurfaceIsSeenFromItsFrontAlone) {
    for (const wchar_t* const mode : {L"Rendered", L"Shaded"}) {
        EXPECT_TRUE(seesLid(under(lid(), true), mode));
        EXPECT_FALSE(seesLid(under(turnedLid(), true), mode));
        EXPECT_TRUE(seesLid(under(turnedLid(), false), mode));
    }
}

TEST(OneSided, BackIsSeenInModesThatShowNoMaterials) {
    for (const wchar_t* const mode : {L"Clay", L"Translucent", L"X-Ray", L"Drawing"}) {
        const auto picture = [&](bool is_one_sided) {
            return drawn(under(turnedLid(), is_one_sided), topView(5.0), modeNamed(mode), size,
                         size);
        };
        EXPECT_EQ(picture(true).rgba, picture(false).rgba);
    }
}

TEST(OneSided, ManyBacksAreLookedThrough) {
    SceneContent content = under(turnedLid(1.0F), true);
    for (int i = 0; i < 40; ++i)
        addLook(content, turnedLid(1.5F + 0.1F * static_cast<float>(i)), [](Material& material) {
            material.base_color = lid_color;
            material.is_one_sided = true;
        });
    EXPECT_FALSE(seesLid(content));
}

// As leaves are made: two faces in one place, each with a picture of its own.
TEST(OneSided, OfTwoFacesInOnePlaceTheOneThatFacesTheObserverIsSeen) {
    for (const bool front_first : {true, false}) {
        SceneContent content = under(front_first ? lid() : turnedLid(), true);
        addLook(content, front_first ? turnedLid() : lid(), [](Material& material) {
            material.base_color = {40, 40, 200, 255};
            material.is_one_sided = true;
        });
        const Image image = drawn(content, topView(5.0), modeNamed(L"Rendered"), size, size);
        for (int y = 20; y < 44; ++y)
            for (int x = 20; x < 44; ++x)
                ASSERT_GT(image.pixel(x, y)[front_first ? 0 : 2], 150) << x << ' ' << y;
    }
}

TEST(OneSided, FrontTurnsWithAPlacedMeshAndStaysWithAMirroredOne) {
    const KM_Xform over = KM_Xform::Translation(0.0, 0.0, 4.0) *
                          KM_Xform::Rotation(KM_PI, KM_3dVector::XAxis, KM_3dPoint::Origin);
    EXPECT_FALSE(seesLid(under(lid(), true, over)));
    EXPECT_TRUE(seesLid(under(turnedLid(), true, over)));
    // Upside down in a mirror, as the half of a symmetric model is: its outer side stays outside.
    const KM_Xform mirrored = KM_Xform::Translation(0.0, 0.0, 4.0) * KM_Xform::Diagonal(1, 1, -1);
    EXPECT_FALSE(seesLid(under(lid(), true, mirrored)));
    EXPECT_TRUE(seesLid(under(turnedLid(), true, mirrored)));
    const KM_Xform aside = KM_Xform::Translation(0.0, 0.0, 1.0) * KM_Xform::Diagonal(-1, 1, 1);
    EXPECT_TRUE(seesLid(under(lid(), true, aside)));
    EXPECT_FALSE(seesLid(under(turnedLid(), true, aside)));
}

TEST(OneSided, BackCastsAShadow) {
    const auto lit = [](KM_Mesh mesh) {
        SceneContent content = under(std::move(mesh), true);
        content.lights.push_back(sunLight({0.0, 0.0, -1.0}));
        const Image image = drawn(content, topView(8.0), modeNamed(L"Rendered"), size, size);
        return brightness(image, size / 2, size / 2) / brightness(image, 4, 4);
    };
    EXPECT_LT(lit(turnedLid()), 0.75);
}

// The camera stands under the lid and looks at a mirror on the floor, in the lower half of the
// picture.
TEST(OneSided, MirrorLooksThroughABackToo) {
    const auto mirrored = [](bool faces_mirror) {
        SceneContent content;
        addLook(content, floorMesh(-4, -4, 4, 4, 0), [](Material& material) {
            material.base_color = {255, 255, 255, 255};
            material.metalness = 1.0F;
            material.roughness = 0.0F;
        });
        KM_Mesh mesh = floorMesh(-3, 0, 3, 40, 3);
        if (faces_mirror)
            for (KM_MeshTriangle& triangle : mesh.m_F)
                std::swap(triangle.vi[1], triangle.vi[2]);
        addLook(content, std::move(mesh), [](Material& material) {
            material.base_color = {200, 20, 20, 255};
            material.is_unlit = true;
            material.is_one_sided = true;
        });
        const Image image = drawn(content, perspectiveView({0.0, -9.0, 2.0}, {0.0, 0.0, 2.0}),
                                  modeNamed(L"Rendered"), size, size);
        int red = 0;
        for (int y = size / 2 + 2; y < size; ++y)
            for (int x = 0; x < size; ++x)
                red += image.pixel(x, y)[0] > image.pixel(x, y)[1] + 80 ? 1 : 0;
        return red;
    };
    EXPECT_GT(mirrored(true), 100);
    EXPECT_EQ(mirrored(false), 0);
}

TEST(OneSided, PaneBehindItsBackIsMixedWithWhatIsBehind) {
    SceneContent content = under(turnedLid(3.0F), true);
    const Image without = [&] {
        SceneContent floor;
        addMesh(floor, floorMesh(-9, -9, 9, 9, 0), floor_color);
        addLook(floor, lid(1.0F), [](Material& material) {
            material.base_color = {255, 255, 255, 100};
            material.see_through = true;
        });
        return drawn(floor, topView(5.0), modeNamed(L"Rendered"), size, size);
    }();
    addLook(content, lid(1.0F), [](Material& material) {
        material.base_color = {255, 255, 255, 100};
        material.see_through = true;
    });
    const Image image = drawn(content, topView(5.0), modeNamed(L"Rendered"), size, size);
    EXPECT_TRUE(samePixel(image, 32, 32, without, 32, 32));
}

TEST(OneSided, BodyOfGlassShowsItsFarSideToo) {
    const auto body = [](bool is_one_sided) {
        SceneContent content;
        addLook(content, boxMesh({-2, -2, -2}, {2, 2, 2}), [&](Material& material) {
            material.base_color = {255, 255, 255, 255};
            material.transmission = 1.0F;
            material.roughness = 0.0F;
            material.thickness = 4.0F;
            material.attenuation_distance = 2.0F;
            material.attenuation_color = {0.2F, 0.9F, 0.3F};
            material.is_one_sided = is_one_sided;
        });
        return drawn(content, perspectiveView({6, -9, 5}, {0, 0, 0}), modeNamed(L"Rendered"), size,
                     size);
    };
    EXPECT_EQ(body(true).rgba, body(false).rgba);
}

TEST(OneSided, PicksPassBacksWhereTheViewDoesNotShowThem) {
    DisplayScene scene;
    ASSERT_TRUE(scene.update(under(turnedLid(), true)).ok());
    PickRay ray{{0.0, 0.0, 9.0}, {0.0, 0.0, -1.0}};
    ASSERT_TRUE(firstSurface(scene, ray));
    EXPECT_EQ(firstSurface(scene, ray)->mesh, 1U);
    ray.passes_backs = true;
    ASSERT_TRUE(firstSurface(scene, ray));
    EXPECT_EQ(firstSurface(scene, ray)->mesh, 0U);
    const PickRay from_below{{0.0, 0.0, 1.0}, {0.0, 0.0, 1.0}, false, true};
    ASSERT_TRUE(firstSurface(scene, from_below));
    EXPECT_EQ(firstSurface(scene, from_below)->mesh, 1U);
}

TEST(OneSided, DepthIsThatOfWhatIsSeen) {
    DepthImage depth;
    drawn(under(turnedLid(), true), topView(5.0), modeNamed(L"Rendered"), size, size, &depth);
    const std::size_t middle = size / 2 * size + size / 2;
    EXPECT_FLOAT_EQ(depth.nearness[middle], depth.nearness[2 * size + 2]);
}

} // namespace
} // namespace quarn
