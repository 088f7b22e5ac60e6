// What a file shows and from where: scenes, nodes, lights, the files beside it.

#include "tests/import/gltf/GltfWriter.h"

#include <gmock/gmock.h>
#include <sys/stat.h>

#include <cmath>

namespace quarn::test {
namespace {

using ::testing::AllOf;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::SizeIs;

using Json = GltfWriter::Json;

/// Three triangles on nodes of their own, named after their numbers.
GltfWriter threeNodes() {
    GltfWriter gltf;
    gltf.triangle();
    gltf.json["nodes"].push_back({{"mesh", 0}});
    gltf.json["nodes"].push_back({{"mesh", 0}});
    for (int i = 0; i < 3; ++i)
        gltf.json["nodes"][i]["name"] = std::to_string(i);
    return gltf;
}

std::string namesIn(const ImportedModel& model) {
    std::string names;
    for (const ImportedMesh& mesh : model.meshes)
        names += mesh.name.ToUtf8();
    return names;
}

TEST(GltfScene, TheOneThatIsNamedIsShownElseTheFirstElseAllNodes) {
    GltfWriter gltf = threeNodes();
    EXPECT_EQ(namesIn(gltf.read()), "012");
    gltf.json["scenes"] = {{{"nodes", {1}}}, {{"nodes", {2, 0}}}};
    EXPECT_EQ(namesIn(gltf.read()), "1");
    gltf.json["scene"] = 1;
    EXPECT_EQ(namesIn(gltf.read()), "20");
    gltf.json["scene"] = 9;
    EXPECT_EQ(namesIn(gltf.read()), "1");
}

TEST(GltfScene, NodesThatAreReachedTwiceAreShownOnceAndTold) {
    GltfWriter gltf = threeNodes();
    gltf.json["scenes"] = {{{"nodes", {0, 1}}}};
    gltf.json["nodes"][0]["children"] = {2};
    gltf.json["nodes"][1]["children"] = {2};
    const ImportedModel two_parents = gltf.read();
    EXPECT_EQ(namesIn(two_parents), "021");
    EXPECT_THAT(two_parents.warnings, ElementsAre(HasSubstr("the file has them once more.")));
    gltf.json["nodes"][2]["children"] = {0, 2};
    const ImportedModel rings = gltf.read();
    EXPECT_EQ(namesIn(rings), "021");
    EXPECT_THAT(rings.warnings, ElementsAre(HasSubstr("the file has them 3 times more.")));
}

TEST(GltfScene, CenterThatPositionsAreStatedFromMovesTheWholeScene) {
    GltfWriter gltf = threeNodes();
    gltf.json["extensionsRequired"] = {"CESIUM_RTC"};
    gltf.json["extensions"]["CESIUM_RTC"]["center"] = {4000000.5, -2000000.25, 6000000.125};
    gltf.json["nodes"][0]["children"] = {1};
    gltf.json["nodes"][0]["translation"] = {0, 0, 1};
    const ImportedModel model = gltf.read();
    ASSERT_THAT(model.meshes, SizeIs(3));
    EXPECT_THAT(model.warnings, IsEmpty());
    // Turned from y up to z up.
    expectNear(model.meshes[1].placed.box().m_min, {4000000.5, -6000001.125, -2000000.25}, 1e-6);
    expectNear(model.meshes[2].placed.box().m_min, {4000000.5, -6000000.125, -2000000.25}, 1e-6);
}

TEST(GltfScene, ExtensionsThatMoveNothingAreToldAndPassedOver) {
    GltfWriter gltf = threeNodes();
    gltf.json["extensionsRequired"] = {"KHR_materials_iridescence", "EXT_texture_webp",
                                       "VRMC_materials_mtoon"};
    gltf.json["extensionsUsed"] = {"KHR_materials_iridescence", "KHR_techniques_webgl",
                                   "KHR_materials_sheen"};
    const ImportedModel model = gltf.read();
    EXPECT_EQ(namesIn(model), "012");
    EXPECT_THAT(
        model.warnings,
        ElementsAre("What these glTF extensions say was left out: KHR_materials_iridescence, "
                    "VRMC_materials_mtoon, KHR_techniques_webgl."));
}

TEST(GltfScene, MatrixAndPartsOfATransformPlaceAlike) {
    GltfWriter gltf = threeNodes();
    const double half = std::sqrt(0.5);
    gltf.json["nodes"][0]["translation"] = {5, 6, 7};
    gltf.json["nodes"][0]["rotation"] = {0, 0, 2 * half, 2 * half}; // a quarter, of any length
    gltf.json["nodes"][0]["scale"] = {2, 3, 1};
    gltf.json["nodes"][1]["matrix"] = {0, 2, 0, 0, -3, 0, 0, 0, 0, 0, 1, 0, 5, 6, 7, 1};
    const ImportedModel model = gltf.read();
    ASSERT_THAT(model.meshes, SizeIs(3));
    for (const std::size_t i : {0U, 1U})
        expectCorners(model.meshes[i], {{5, 6, 7}, {5, 8, 7}, {2, 6, 7}}, 1e-5);
}

struct ModeCase {
    int mode;
    std::vector<KM_3dPoint> corners;
};

TEST(GltfScene, StripsAndFansTurnTheirTrianglesToOneSide) {
    const KM_3dPoint a(0, 0, 0);
    const KM_3dPoint b(1, 0, 0);
    const KM_3dPoint c(0, 1, 0);
    const KM_3dPoint d(1, 1, 0);
    for (const ModeCase& wanted :
         {ModeCase{5, {a, b, c, b, d, c}}, ModeCase{6, {b, c, a, c, d, a}}}) {
        GltfWriter gltf;
        gltf.mesh({{"mode", wanted.mode},
                   {"attributes",
                    {{"POSITION", gltf.floats({0, 0, 0, 1, 0, 0, 0, 1, 0, 1, 1, 0}, "VEC3")},
                     {"NORMAL", gltf.floats({0, 0, 1, 0, 0, 1, 0, 0, 1, 0, 0, 1}, "VEC3")}}}});
        const ImportedModel model = gltf.read();
        ASSERT_THAT(model.meshes, SizeIs(1));
        expectCorners(model.meshes[0], wanted.corners);
    }
}

TEST(GltfScene, LinesAndLoopsBecomeCurvesAndPointsPoints) {
    const auto read = [](int mode) {
        GltfWriter gltf;
        gltf.mesh({{"mode", mode},
                   {"attributes",
                    {{"POSITION", gltf.floats({0, 0, 0, 1, 0, 0, 1, 1, 0, 5, 5, 5}, "VEC3")}}}});
        return gltf.read();
    };
    EXPECT_EQ(read(0).points.Count(), 4);
    EXPECT_THAT(read(1).curves, SizeIs(2));
    const ImportedModel loop = read(2);
    ASSERT_THAT(loop.curves, SizeIs(1));
    EXPECT_EQ(loop.curves[0].points.Count(), 5);
    const ImportedModel strip = read(3);
    ASSERT_THAT(strip.curves, SizeIs(1));
    EXPECT_EQ(strip.curves[0].points.Count(), 4);
}

TEST(GltfScene, ThePartsOfAMeshCarryItsNameAndTheirNumber) {
    GltfWriter gltf;
    gltf.triangle();
    gltf.json["meshes"][0]["name"] = "roof";
    EXPECT_EQ(namesIn(gltf.read()), "roof");
    gltf.json["meshes"][0]["primitives"].push_back(gltf.primitive());
    EXPECT_EQ(namesIn(gltf.read()), "roof-0roof-1");
    gltf.node()["name"] = "house";
    EXPECT_EQ(namesIn(gltf.read()), "househouse");
}

TEST(GltfLights, AreReadAndShine) {
    GltfWriter gltf;
    gltf.triangle();
    gltf.json["extensions"]["KHR_lights_punctual"]["lights"] = {
        {{"type", "point"}, {"intensity", 400}, {"color", {1, 0.5, 0}}, {"name", "lamp"}},
        {{"type", "spot"}, {"intensity", 100}},
        {{"type", "directional"}, {"intensity", 5}}};
    for (int i = 0; i < 3; ++i)
        gltf.json["nodes"].push_back({{"translation", {i, 2, 3}},
                                      {"extensions", {{"KHR_lights_punctual", {{"light", i}}}}}});
    const ImportedModel model = gltf.read();
    ASSERT_THAT(model.lights, SizeIs(3));
    const KM_Light& lamp = model.lights[0];
    EXPECT_EQ(lamp.Style(), KM_LightStyle::world_point);
    EXPECT_EQ(lamp.LightName(), L"lamp");
    EXPECT_EQ(lamp.Diffuse(), (KM_Color{255, 188, 0, 255}));
    expectNear(lamp.Location(), {0, -3, 2}, 1e-9);
    EXPECT_DOUBLE_EQ(lamp.Intensity(), 1.0);
    EXPECT_EQ(model.lights[1].Style(), KM_LightStyle::world_spot);
    EXPECT_DOUBLE_EQ(model.lights[1].Intensity(), 0.25); // of the brightest in candela
    EXPECT_EQ(model.lights[2].Style(), KM_LightStyle::world_directional);
    EXPECT_DOUBLE_EQ(model.lights[2].Intensity(), 1.0);    // of the brightest in lux
    EXPECT_NEAR(model.lights[2].Direction().y, 1.0, 1e-9); // -z of the file
    for (const KM_Light& light : model.lights)
        EXPECT_TRUE(light.IsEnabled());
    EXPECT_TRUE(model.warnings.empty());
}

TEST(GltfCamera, TakesItsPlaceFromItsNodeAndItsAngleFromTheHeight) {
    GltfWriter gltf;
    gltf.triangle();
    gltf.json["cameras"] = {
        {{"type", "perspective"},
         {"perspective", {{"yfov", 2 * std::atan(0.5)}, {"aspectRatio", 2.0}, {"znear", 0.1}}}},
        {{"type", "orthographic"},
         {"orthographic", {{"xmag", 3}, {"ymag", 1.5}, {"znear", 0.1}, {"zfar", 9}}}}};
    gltf.json["nodes"].push_back({{"camera", 0}, {"name", "door"}, {"translation", {1, 2, 3}}});
    gltf.json["nodes"].push_back({{"camera", 1}, {"translation", {1, 2, 3}}});
    const ImportedModel model = gltf.read();
    ASSERT_THAT(model.cameras, SizeIs(2));
    const KM_Viewport& door = model.cameras[0].viewport;
    EXPECT_EQ(model.cameras[0].name, L"door");
    expectNear(door.CameraLocation(), {1, -3, 2}, 1e-9);
    double left = 0, right = 0, bottom = 0, top = 0, near = 0, far = 0;
    ASSERT_TRUE(door.GetFrustum(&left, &right, &bottom, &top, &near, &far));
    EXPECT_NEAR(top / near, 0.5, 1e-9);
    EXPECT_NEAR(right / near, 1.0, 1e-9);
    EXPECT_EQ(model.cameras[1].name, L"Camera 2");
    const KM_Viewport& parallel = model.cameras[1].viewport;
    ASSERT_TRUE(parallel.GetFrustum(&left, &right, &bottom, &top, &near, &far));
    EXPECT_TRUE(parallel.IsParallelProjection());
    EXPECT_NEAR(right, 3.0, 1e-9);
    EXPECT_NEAR(top, 1.5, 1e-9);
}

/// A .gltf whose vertices stand in a file of their own.
std::filesystem::path withBuffer(const TemporaryFolder& folder, const std::string& uri) {
    GltfWriter gltf;
    gltf.triangle();
    gltf.json["buffers"] = {{{"uri", uri}, {"byteLength", 36}}};
    return folder.write("model.gltf", gltf.json.dump());
}

std::string vertexBytes() {
    return GltfWriter::bytesOf(std::vector<float>{0, 0, 0, 1, 0, 0, 0, 1, 0});
}

TEST(GltfFiles, AreFoundByNamesWithEscapesAndInFoldersBelow) {
    const TemporaryFolder folder;
    folder.write("my parts/a#1.bin", vertexBytes());
    EXPECT_EQ(readOrFail(withBuffer(folder, "my%20parts/a%231.bin")).triangleCount(), 1U);
}

TEST(GltfFiles, ThatIsMissingIsToldAsMissing) {
    const TemporaryFolder folder;
    const auto path = withBuffer(folder, "gone.bin");
    const auto model = readModelFile(path);
    ASSERT_FALSE(model.ok());
    EXPECT_EQ(model.message(), "Cannot read '" + path.string() +
                                   "': the file 'gone.bin' that belongs to it is missing. Put it "
                                   "beside the model; who passes on a model passes on all its "
                                   "files.");
}

TEST(GltfFiles, WhoseNameDiffersInCaseAloneIsReadAndTold) {
    const TemporaryFolder folder;
    folder.write("Parts.BIN", vertexBytes());
    const ImportedModel model = readOrFail(withBuffer(folder, "parts.bin"));
    EXPECT_EQ(model.triangleCount(), 1U);
    EXPECT_THAT(model.warnings, ElementsAre(HasSubstr("'Parts.BIN' was read for 'parts.bin'")));
}

TEST(GltfFiles, OutsideOfTheFolderAndPipesAreNotRead) {
    const TemporaryFolder folder;
    folder.write("secret.bin", vertexBytes());
    const TemporaryFolder elsewhere;
    const auto path =
        withBuffer(elsewhere, "../" + folder.path().filename().string() + "/secret.bin");
    const auto outside = readModelFile(path);
    ASSERT_FALSE(outside.ok());
    EXPECT_THAT(outside.message(), HasSubstr("which lies outside the model's folder"));
    ASSERT_EQ(mkfifo((elsewhere.path() / "pipe.bin").c_str(), 0600), 0);
    const auto pipe = readModelFile(withBuffer(elsewhere, "pipe.bin"));
    ASSERT_FALSE(pipe.ok());
    EXPECT_THAT(pipe.message(), HasSubstr("'pipe.bin' that belongs to it is missing"));
}

class GivesUp final : public ReadingWatch {
    bool goesOn(ReadingStep, double) override { return false; }
};

TEST(GltfReading, EndsWhenThePersonGivesUp) {
    GltfWriter gltf;
    gltf.triangle();
    GivesUp watch;
    ReadingOptions options;
    options.watch = &watch;
    EXPECT_THAT(gltf.refusal(options), HasSubstr("it was given up"));
}

} // namespace
} // namespace quarn::test
