#include "tests/engine/display/DisplayFixture.h"

#include <gtest/gtest.h>

#include <cmath>
#include <string>

namespace quarn {
namespace {

/// How much two pictures of one size differ.
struct Difference {
    double mean = 0.0;       ///< of all bytes, 0 to 255
    double far_pixels = 0.0; ///< the share of pixels with a byte that differs by more than 8
};

Difference differenceOf(const Image& a, const Image& b) {
    Difference difference;
    if (a.rgba.size() != b.rgba.size()) {
        ADD_FAILURE() << "pictures of different sizes";
        return difference;
    }
    std::size_t far_pixels = 0;
    for (std::size_t i = 0; i < a.rgba.size(); i += 4) {
        int largest = 0;
        for (std::size_t c = 0; c < 4; ++c) {
            const int step = std::abs(int{a.rgba[i + c]} - int{b.rgba[i + c]});
            difference.mean += step;
            largest = std::max(largest, step);
        }
        far_pixels += largest > 8 ? 1 : 0;
    }
    const auto bytes = static_cast<double>(a.rgba.size());
    difference.mean /= bytes;
    difference.far_pixels = 4.0 * static_cast<double>(far_pixels) / bytes;
    return difference;
}

void expectAlike(const Image& a, const Image& b, double mean, double far_pixels,
                 const std::string& what) {
    const Difference difference = differenceOf(a, b);
    EXPECT_LT(difference.mean, mean) << what;
    EXPECT_LT(difference.far_pixels, far_pixels) << what;
}

const wchar_t* const all_modes[] = {L"Wireframe", L"Shaded",  L"Rendered", L"Translucent",
                                    L"X-Ray",     L"Drawing", L"Clay"};

/// Turned, stretched unevenly, mirrored, and only moved.
std::vector<KM_Xform> differentPlaces() {
    const KM_Xform turn = KM_Xform::Rotation(0.7, {1.0, 2.0, 0.5}, KM_3dPoint::Origin);
    const auto at = [](double x, double y) { return KM_Xform::Translation(x, y, 1.0); };
    return {at(-6.0, 0.0), at(-2.0, 0.0) * turn * KM_Xform::Diagonal(1.5, 0.5, 0.8),
            at(2.0, 0.0) * KM_Xform::Diagonal(-1.0, 1.0, 1.4),
            at(6.0, 0.0) * KM_Xform::Diagonal(0.6, 1.2, -1.0) * turn};
}

KM_Mesh knob() {
    KM_Mesh mesh = sphereMesh(KM_3dPoint(0.0, 0.0, 0.3), 1.0F, 12);
    const KM_Mesh box = boxMesh({0.2, 0.2, 0.0}, {1.3, 1.1, 0.9});
    mesh.Append(box);
    return mesh;
}

SceneContent withFloorAndSun() {
    SceneContent content;
    addMesh(content, floorMesh(-10.0F, -10.0F, 10.0F, 10.0F, -1.0F));
    content.lights.push_back(sunLight({0.4, 0.5, -0.7}));
    return content;
}

TEST(PlacedMeshDrawing, ObjectsThatShareAMeshLookLikeCopiesInTheirPlaces) {
    SceneContent sharing = withFloorAndSun();
    SceneContent copies = withFloorAndSun();
    const std::shared_ptr<const KM_Mesh> mesh = shared(knob());
    for (const KM_Xform& place : differentPlaces()) {
        sharing.meshes.push_back({{mesh, nullptr, place}, KM_CreateUuid()});
        KM_Mesh copy = knob();
        ASSERT_TRUE(copy.Transform(place));
        copies.meshes.push_back({{shared(std::move(copy)), nullptr, {}}, KM_CreateUuid()});
    }
    const KM_Viewport view = perspectiveView({3.0, -16.0, 9.0}, {0.0, 0.0, 0.5});
    for (const wchar_t* const name : all_modes) {
        const DisplayModeAttributes mode = modeNamed(name, 2);
        expectAlike(drawn(sharing, view, mode, 320, 200), drawn(copies, view, mode, 320, 200), 0.05,
                    0.002, KM_wString(name).ToUtf8());
    }
}

TEST(PlacedMeshDrawing, OneMeshHasOneSearchStructureHoweverOftenItStands) {
    SceneContent content;
    const std::shared_ptr<const KM_Mesh> mesh = shared(knob());
    for (int i = 0; i < 500; ++i)
        content.meshes.push_back(
            {{mesh, nullptr, KM_Xform::Translation(3.0 * (i % 25), 3.0 * (i / 25), 0.0)},
             KM_CreateUuid()});
    DisplayScene scene;
    ASSERT_TRUE(scene.update(content).ok());
    EXPECT_EQ(scene.rays().geometryCount(), 1U);
    for (const DisplayScene::MeshObject& object : scene.meshes()) {
        EXPECT_EQ(object.mesh, scene.meshes().front().mesh);
        EXPECT_EQ(&object.mesh->mesh(), mesh.get());
        EXPECT_EQ(object.mesh->paddedVertices(), mesh->m_V.data());
    }
    for (const RaySurface& surface : scene.rays().surfaces()) {
        EXPECT_EQ(surface.vertices, mesh->m_V.data());
        EXPECT_EQ(surface.triangles, mesh->m_F.data());
    }
}

TEST(PlacedMeshDrawing, OneOfManyObjectsOfAMeshIsHiddenAndComesBack) {
    SceneContent content;
    const std::shared_ptr<const KM_Mesh> mesh = shared(floorMesh(-1.0F, -1.0F, 1.0F, 1.0F, 0.0F));
    for (const double x : {-3.0, 3.0})
        content.meshes.push_back(
            {{mesh, nullptr, KM_Xform::Translation(x, 0.0, 0.0)}, KM_CreateUuid()});
    DisplayScene scene;
    DisplayPipeline pipeline;
    DepthImage depth;
    Image image;
    const auto shows = [&](int x) {
        EXPECT_TRUE(scene.update(content).ok());
        EXPECT_TRUE(
            pipeline.draw(scene, topView(5.0), modeNamed(L"Shaded"), 100, 100, image, &depth).ok());
        return std::isfinite(depth.depth(x, 50));
    };
    EXPECT_TRUE(shows(20) && shows(80));
    content.meshes[0].visible = false;
    EXPECT_FALSE(shows(20));
    EXPECT_TRUE(shows(80));
    content.meshes[0].visible = true;
    EXPECT_TRUE(shows(20) && shows(80));
}

TEST(PlacedMeshDrawing, ModelFarFromTheOriginLooksLikeTheSameModelAtIt) {
    const KM_3dVector far(4.5e6, 5.2e6, 100.0);
    SceneContent here = withFloorAndSun();
    addMesh(here, knob());
    SceneContent there = here;
    for (SceneMesh& object : there.meshes)
        object.placed.world_from_mesh = KM_Xform::Translation(far);
    for (int step = 0; step < 12; ++step) {
        const double angle = step * KM_PI / 180.0; // a slow turntable
        const KM_3dPoint eye(8.0 * std::cos(angle), 8.0 * std::sin(angle), 4.0);
        const KM_Viewport view = perspectiveView(eye, KM_3dPoint::Origin);
        const KM_Viewport far_view = perspectiveView(eye + far, KM_3dPoint::Origin + far);
        for (const wchar_t* const name : {L"Rendered", L"Drawing", L"Wireframe"}) {
            const DisplayModeAttributes mode = modeNamed(name, 2);
            expectAlike(drawn(here, view, mode, 240, 160), drawn(there, far_view, mode, 240, 160),
                        0.02, 0.001, KM_wString(name).ToUtf8() + std::to_string(step));
        }
    }
}

TEST(PlacedMeshDrawing, CurvesAndPointsOfAFarModelStandWhereItDoes) {
    const KM_3dVector far(4.5e6, 5.2e6, 100.0);
    SceneContent here;
    addMesh(here, floorMesh(-4.0F, -4.0F, 4.0F, 4.0F, 0.0F));
    here.curves.push_back({KM_CreateUuid(), KM_3dPointArray(), {255, 0, 0, 255}, true});
    SceneContent there = here;
    there.meshes[0].placed.world_from_mesh = KM_Xform::Translation(far);
    for (const KM_3dPoint& p : {KM_3dPoint(-3.0, 1.0, 1.0), KM_3dPoint(3.0, -2.0, 1.0)}) {
        here.curves[0].polyline.Append(p);
        there.curves[0].polyline.Append(p + far);
    }
    here.points.push_back({KM_CreateUuid(), {0.0, 3.0, 0.5}, {0, 0, 255, 255}, true});
    there.points.push_back({KM_CreateUuid(), KM_3dPoint(0.0, 3.0, 0.5) + far, {0, 0, 255, 255}});
    const KM_3dPoint eye(2.0, -9.0, 6.0);
    const DisplayModeAttributes mode = modeNamed(L"Shaded", 2);
    expectAlike(drawn(here, perspectiveView(eye, KM_3dPoint::Origin), mode, 240, 160),
                drawn(there, perspectiveView(eye + far, KM_3dPoint::Origin + far), mode, 240, 160),
                0.02, 0.001, "Shaded");
}

TEST(PlacedMeshDrawing, SizeOfAModelDoesNotChangeItsPicture) {
    const auto pictureAt = [](double scale, const wchar_t* mode) {
        SceneContent content;
        content.lights.push_back(sunLight({0.4, 0.5, -0.7}));
        KM_Mesh mesh = knob();
        mesh.Append(floorMesh(-3.0F, -3.0F, 3.0F, 3.0F, -1.0F));
        EXPECT_TRUE(mesh.Transform(KM_Xform::Scale(KM_3dPoint::Origin, scale)));
        addMesh(content, std::move(mesh));
        KM_Viewport view =
            perspectiveView(KM_3dPoint(6.0 * scale, -7.0 * scale, 5.0 * scale), KM_3dPoint::Origin);
        view.SetFrustumNearFar(1.0 * scale, 100.0 * scale);
        return drawn(content, view, modeNamed(mode, 2), 240, 160);
    };
    for (const wchar_t* const mode : {L"Rendered", L"X-Ray", L"Drawing", L"Clay"}) {
        const Image usual = pictureAt(1.0, mode);
        for (const double scale : {1e-6, 1e-3, 1e3, 1e9, 3e11})
            expectAlike(usual, pictureAt(scale, mode), 0.05, 0.002,
                        KM_wString(mode).ToUtf8() + " at " + std::to_string(scale));
    }
}

} // namespace
} // namespace quarn
