#include "engine/images/ImageFile.h"
#include "tests/engine/display/DisplayFixture.h"
#include "tests/support/AllocationCount.h"
#include "tests/support/TempFolder.h"

#include <gtest/gtest.h>

#include <cmath>
#include <tuple>

namespace quarn {
namespace {

constexpr int wide_px = 240;
constexpr int high_px = 136;

/// Hills with a ball, a pane of glass, a fence of thirteen bars, a curve and a point.
SceneContent yard() {
    SceneContent content;
    addMesh(content, hillMesh(40), {150, 140, 120, 255});
    addMesh(content, sphereMesh({3, 1, 9}, 6.0F, 24), {235, 235, 225, 255});
    addMesh(content, boxMesh({-20, -6, 0}, {-10, -5.8, 12}), {120, 160, 200, 90});
    auto glass = std::make_shared<Material>(*content.meshes.back().placed.material);
    glass->see_through = true;
    content.meshes.back().placed.material = glass;
    for (int i = -6; i <= 6; ++i)
        addMesh(content, boxMesh({3.0 * i - 0.4, -25, 0}, {3.0 * i + 0.4, -24, 14}));
    SceneCurve curve;
    curve.id = KM_CreateUuid();
    for (int i = 0; i <= 40; ++i)
        curve.polyline.Append({30.0 * std::cos(0.3 * i), 30.0 * std::sin(0.3 * i), 6.0 + 0.2 * i});
    content.curves.push_back(curve);
    content.points.push_back({KM_CreateUuid(), {0.0, 0.0, 20.0}});
    content.lights.push_back(sunLight({0.8, 0.4, -0.5}));
    return content;
}

/// Frame by frame around the yard, once in twenty frames.
class Turntable {
public:
    explicit Turntable(const SceneContent& content) { EXPECT_TRUE(m_scene.update(content).ok()); }

    const Image& draw(const DisplayModeAttributes& mode, int frame, int width = wide_px,
                      int height = high_px) {
        const double angle = 2.0 * KM_PI / 20.0 * frame;
        const KM_Viewport camera = perspectiveView(
            {90.0 * std::cos(angle), 90.0 * std::sin(angle), 45.0}, {0.0, 0.0, 2.0});
        EXPECT_TRUE(m_pipeline.draw(m_scene, camera, mode, width, height, m_picture).ok());
        return m_picture;
    }

private:
    DisplayScene m_scene;
    DisplayPipeline m_pipeline;
    Image m_picture;
};

struct Look {
    const wchar_t* mode;
    MeshEdgeChoice edges = MeshEdgeChoice::standard;
};

class SteadyPipelineMemory : public testing::TestWithParam<std::tuple<Look, int>> {};

TEST_P(SteadyPipelineMemory, FramesAfterTheFirstTwoAskForNone) {
    const auto& [look, level] = GetParam();
    const DisplayModeAttributes mode = withEdges(modeNamed(look.mode, level), look.edges);
    Turntable turntable(yard());
    turntable.draw(mode, 0);
    turntable.draw(mode, 1);
    for (int frame = 2; frame < 20; ++frame) {
        const AllocationCount before = AllocationCount::now();
        turntable.draw(mode, frame);
        const AllocationCount after = AllocationCount::now();
        EXPECT_EQ(0U, requestsBetween(before, after)) << "in frame " << frame;
    }
}

TEST_P(SteadyPipelineMemory, AThousandFramesHoldNoMoreMemoryThanTwenty) {
    const auto& [look, level] = GetParam();
    const DisplayModeAttributes mode = withEdges(modeNamed(look.mode, level), look.edges);
    Turntable turntable(yard());
    const auto turn = [&] {
        for (int frame = 0; frame < 20; ++frame)
            turntable.draw(mode, frame, 40, 24);
        return AllocationCount::now().held_bytes;
    };
    const std::size_t after_one = turn();
    std::size_t after_many = 0;
    for (int i = 0; i < 50; ++i)
        after_many = turn();
    EXPECT_LE(after_many, after_one);
}

INSTANTIATE_TEST_SUITE_P(
    Modes, SteadyPipelineMemory,
    testing::Combine(testing::Values(Look{L"Wireframe"}, Look{L"Wireframe", MeshEdgeChoice::all},
                                     Look{L"Shaded"}, Look{L"Shaded", MeshEdgeChoice::all},
                                     Look{L"Rendered"}, Look{L"Translucent"}, Look{L"X-Ray"},
                                     Look{L"Drawing"}, Look{L"Drawing", MeshEdgeChoice::all},
                                     Look{L"Clay"}),
                     testing::Values(0, 1, 2)),
    [](const auto& each) {
        const Look& look = std::get<0>(each.param);
        std::string name = KM_wString(look.mode).ToUtf8();
        std::erase(name, '-');
        name += look.edges == MeshEdgeChoice::all ? "WithAllEdges" : "";
        return name + "AtLevel" + std::to_string(std::get<1>(each.param));
    });

TEST(PictureBuffers, OfALargePictureGoAfterManySmallOnes) {
    const SceneContent content = yard();
    DisplayScene scene;
    ASSERT_TRUE(scene.update(content).ok());
    const KM_Viewport camera = perspectiveView({90.0, 0.0, 45.0}, {0.0, 0.0, 2.0});
    DisplayPipeline pipeline;
    const auto heldAfter = [&](int width, int height) {
        Image picture;
        EXPECT_TRUE(
            pipeline.draw(scene, camera, modeNamed(L"X-Ray", 2), width, height, picture).ok());
        picture = Image();
        return AllocationCount::now().held_bytes;
    };
    constexpr std::size_t megabyte = 1 << 20;
    const std::size_t small_first = heldAfter(40, 24);
    const std::size_t large = heldAfter(1200, 800);
    EXPECT_GE(large, small_first + 10 * megabyte); // layers alone take 3.8 MB for each kept
    EXPECT_EQ(pipeline.heldPixels(), 1200 * 800);
    EXPECT_GE(heldAfter(40, 24), small_first + 10 * megabyte);
    std::size_t small_last = 0;
    for (int i = 0; i < 130; ++i)
        small_last = heldAfter(40, 24);
    EXPECT_LE(small_last, small_first + 2 * megabyte);
    EXPECT_EQ(pipeline.heldPixels(), 40 * 24);
}

struct Encoding {
    ImageFormat format;
    /// What the format's library asks for itself, and gives back at the end of a picture.
    std::size_t asked_by_the_library;
};

class SteadyEncoding : public testing::TestWithParam<Encoding> {};

TEST_P(SteadyEncoding, AsksForNoMoreThanTheLibraryDoes) {
    Turntable turntable(yard());
    const DisplayModeAttributes mode = modeNamed(L"Rendered", 2);
    ImageEncoder encoder;
    for (int frame = 0; frame < 20; ++frame) {
        const AllocationCount before = AllocationCount::now();
        const auto encoded = encoder.encode(turntable.draw(mode, frame), GetParam().format);
        const AllocationCount after = AllocationCount::now();
        EXPECT_TRUE(encoded.ok());
        if (frame < 2)
            continue;
        EXPECT_LE(requestsBetween(before, after), GetParam().asked_by_the_library);
        EXPECT_EQ(before.held_bytes, after.held_bytes);
    }
}

INSTANTIATE_TEST_SUITE_P(Formats, SteadyEncoding,
                         testing::Values(Encoding{ImageFormat::jpeg, 9},
                                         Encoding{ImageFormat::png, 11},
                                         Encoding{ImageFormat::bmp, 0},
                                         Encoding{ImageFormat::tga, 0}));

TEST(SteadyFiles, WritingAPictureAsksForNothing) {
    const test::TempFolder folder;
    Turntable turntable(yard());
    const Image& picture = turntable.draw(modeNamed(L"Shaded", 0), 0);
    const std::string file = (folder.path() / "a name that is not short.bmp").string();
    ImageEncoder encoder;
    ASSERT_TRUE(encoder.write(file.c_str(), picture).ok());
    const AllocationCount before = AllocationCount::now();
    const Result<void> written = encoder.write(file.c_str(), picture);
    const AllocationCount after = AllocationCount::now();
    EXPECT_TRUE(written.ok());
    EXPECT_EQ(0U, requestsBetween(before, after));
}

} // namespace
} // namespace quarn
