// What other programs see of an exported camera: read back with the reader of models.
#include "host/share/Base64Text.h"
#include "import/ModelFile.h"
#include "import/gltf/Base64.h"
#include "tests/host/share/camera/CameraFixture.h"

#include <bit>
#include <cmath>

namespace quarn::test {
namespace {

using testing::HasSubstr;

constexpr const char* EMBEDDED = "data:application/octet-stream;base64,";

std::vector<std::uint8_t> bufferOf(const Json& gltf) {
    const std::string uri = gltf.at("buffers").at(0).at("uri");
    EXPECT_TRUE(uri.starts_with(EMBEDDED));
    auto bytes = fromBase64(std::string_view(uri).substr(std::strlen(EMBEDDED)));
    EXPECT_TRUE(bytes.ok());
    EXPECT_EQ(bytes.value().size(), gltf.at("buffers").at(0).at("byteLength"));
    return bytes.value();
}

/// The floats of an accessor, as the format keeps them.
std::vector<float> floatsOf(const Json& gltf, int accessor) {
    const Json& told = gltf.at("accessors").at(static_cast<std::size_t>(accessor));
    const Json& view = gltf.at("bufferViews").at(told.at("bufferView").get<std::size_t>());
    EXPECT_EQ(told.at("componentType"), 5126);
    const std::vector<std::uint8_t> bytes = bufferOf(gltf);
    const auto begin = view.at("byteOffset").get<std::size_t>();
    const auto size = view.at("byteLength").get<std::size_t>();
    std::vector<float> floats;
    for (std::size_t i = begin; i < begin + size; i += 4)
        floats.push_back(std::bit_cast<float>(static_cast<std::uint32_t>(
            bytes.at(i) | bytes.at(i + 1) << 8 | bytes.at(i + 2) << 16 | bytes.at(i + 3) << 24)));
    return floats;
}

/// The keys of what moves a node in this way; the times in `times`.
std::vector<float> keysOf(const Json& gltf, int node, const char* path,
                          std::vector<float>* times = nullptr) {
    const Json& animation = gltf.at("animations").at(0);
    for (const Json& channel : animation.at("channels")) {
        if (channel.at("target") != Json{{"node", node}, {"path", path}})
            continue;
        const Json& sampler = animation.at("samplers").at(channel.at("sampler").get<std::size_t>());
        if (times)
            *times = floatsOf(gltf, sampler.at("input"));
        return floatsOf(gltf, sampler.at("output"));
    }
    ADD_FAILURE() << "nothing moves " << node << " by " << path;
    return {};
}

Json slice(const std::vector<float>& floats, std::size_t frame, std::size_t size) {
    return std::vector<float>(floats.begin() + static_cast<std::ptrdiff_t>(frame * size),
                              floats.begin() + static_cast<std::ptrdiff_t>((frame + 1) * size));
}

/// The file with its nodes where this frame has them, and with a triangle, which a model needs.
Json posed(Json gltf, std::size_t frame, int moving) {
    Json& node = gltf["nodes"][static_cast<std::size_t>(moving)];
    if (node.contains("translation"))
        node["translation"] = slice(keysOf(gltf, moving, "translation"), frame, 3);
    node["rotation"] = slice(keysOf(gltf, moving, "rotation"), frame, 4);
    const float corners[] = {0, 0, 0, 1, 0, 0, 0, 1, 0};
    gltf["buffers"].push_back(
        {{"byteLength", 36}, {"uri", EMBEDDED + base64Text(std::as_bytes(std::span(corners)))}});
    const std::size_t view = gltf["bufferViews"].size(), accessor = gltf["accessors"].size();
    gltf["bufferViews"].push_back({{"buffer", 1}, {"byteOffset", 0}, {"byteLength", 36}});
    gltf["accessors"].push_back(
        {{"bufferView", view}, {"componentType", 5126}, {"count", 3}, {"type", "VEC3"}});
    gltf["meshes"] = {{{"primitives", {{{"attributes", {{"POSITION", accessor}}}}}}}};
    gltf["scenes"][0]["nodes"].push_back(gltf["nodes"].size());
    gltf["nodes"].push_back({{"mesh", 0}});
    return gltf;
}

/// A corner of the picture, at a distance along the view direction.
KM_3dPoint corner(const KM_Viewport& viewport, double distance, int number) {
    double left = 0, right = 0, bottom = 0, top = 0, near = 0;
    viewport.GetFrustum(&left, &right, &bottom, &top, &near, nullptr);
    const double scale = viewport.IsParallelProjection() ? 1.0 : distance / near;
    return viewport.CameraLocation() - distance * viewport.CameraZ() +
           scale * (number % 2 ? right : left) * viewport.CameraX() +
           scale * (number / 2 ? top : bottom) * viewport.CameraY();
}

/// The frustum: at the target, and half as far again behind it. A parallel camera may stand farther
/// back and sees the same.
void expectSameFrustum(const KM_Viewport& drawn, const KM_Viewport& read, double metres) {
    EXPECT_EQ(read.IsParallelProjection(), drawn.IsParallelProjection());
    const double distance = drawn.TargetDistance();
    const double setback =
        (read.CameraLocation() - metres * drawn.CameraLocation()) * drawn.CameraZ();
    const double size = metres * distance;
    if (drawn.IsPerspectiveProjection()) {
        EXPECT_NEAR(setback, 0.0, 1e-5 * size);
    }
    for (const double depth : {distance, 1.5 * distance})
        for (int number = 0; number < 4; ++number)
            EXPECT_TRUE(near(metres * corner(drawn, depth, number),
                             corner(read, metres * depth + setback, number), 1e-5 * size));
}

class GltfCamera : public CameraFixture {
protected:
    Json exportedGltf() { return Json::parse(exported("camera.gltf")); }

    ImportedModel readPosed(const Json& gltf, std::size_t frame, int moving) {
        writeFile(folder / "posed.gltf", posed(gltf, frame, moving).dump());
        auto read = readModelFile(folder / "posed.gltf");
        EXPECT_TRUE(read.ok()) << (read.ok() ? "" : read.message());
        return read.ok() ? std::move(read.value()) : ImportedModel();
    }

    /// Holds the frustum of every key beside the one that the frame is drawn with.
    void expectDrawnFrusta(double metres) {
        const Json gltf = exportedGltf();
        const std::vector<KM_Viewport> drawn = recorded();
        ASSERT_EQ(keysOf(gltf, 0, "translation").size(), 3 * drawn.size());
        for (std::size_t frame = 0; frame < drawn.size(); ++frame) {
            const ImportedModel model = readPosed(gltf, frame, 0);
            ASSERT_EQ(model.cameras.size(), 1U);
            EXPECT_EQ(model.cameras[0].name.ToUtf8(), record().HtmlFilename().ToUtf8());
            expectSameFrustum(drawn[frame], model.cameras[0].viewport, metres);
        }
        EXPECT_EQ(gltf["nodes"][0]["translation"], slice(keysOf(gltf, 0, "translation"), 0, 3));
        EXPECT_EQ(gltf["nodes"][0]["rotation"], slice(keysOf(gltf, 0, "rotation"), 0, 4));
    }
    void takeUnits(UnitSystem units) {
        ImportedModel model;
        model.units = units;
        document().objects().remove(objectId(L"roof"));
        document().addModel(model);
        ASSERT_EQ(document().units(), units);
    }
};

constexpr const wchar_t* TURN = L"SetTurntableAnimation 5 _Clockwise _png _Wireframe _Enter _Enter";

TEST_F(GltfCamera, HasTheFrustumThatEachFrameIsDrawnWith) {
    runAll({L"FitView Turn=Yes _Enter", TURN});
    expectDrawnFrusta(1.0);
}

TEST_F(GltfCamera, OfAParallelViewIsOrthographicAndSeesTheSame) {
    runAll({L"Camera Parallel=Yes _Enter", L"FitView _Enter", TURN});
    expectDrawnFrusta(1.0);
}

TEST_F(GltfCamera, IsInMetres) {
    takeUnits(UnitSystem::centimeters);
    runAll({TURN});
    const std::string told = (exported("camera.glb"), said());
    EXPECT_THAT(told, testing::Not(HasSubstr("no units")));
    expectDrawnFrusta(0.01);
}

TEST_F(GltfCamera, OfADocumentWithoutUnitsTakesThemForMetresAndSaysSo) {
    runAll({TURN});
    (void)exportedGltf();
    EXPECT_THAT(said(), HasSubstr("The document has no units: one unit counts as a metre"));
    EXPECT_THAT(said(), HasSubstr("Wrote the camera of 5 frames, 10 a second, to "));
}

TEST_F(GltfCamera, ThatPassesAboveItsTargetKeepsItsFrustum) {
    setUpCameras({{-6, 0, 8}, {0, 0, 8}, {0.5, 3, 8}, {0, 0, -4}, {0, 0, 5}});
    expectDrawnFrusta(1.0);
}

TEST_F(GltfCamera, GoesTheShortWayRoundFromKeyToKey) {
    runAll({L"FitView Turn=Yes _Enter",
            L"SetTurntableAnimation 24 _Clockwise _png _Wireframe _Enter _Enter"});
    const std::vector<float> turns = keysOf(exportedGltf(), 0, "rotation");
    for (std::size_t k = 4; k < turns.size(); k += 4) {
        const double alike = turns[k] * turns[k - 4] + turns[k + 1] * turns[k - 3] +
                             turns[k + 2] * turns[k - 2] + turns[k + 3] * turns[k - 1];
        EXPECT_GT(alike, 0.9) << k;
    }
}

TEST_F(GltfCamera, HasAKeyAtTheTimeOfEachFrame) {
    runAll({TURN});
    std::vector<float> times;
    keysOf(Json::parse(exported("camera.gltf", L"[FrameRate] 4")), 0, "rotation", &times);
    EXPECT_EQ(times, (std::vector<float>{0.0F, 0.25F, 0.5F, 0.75F, 1.0F}));
    EXPECT_THAT(said(), HasSubstr("4 a second"));
}

TEST_F(GltfCamera, SeesTheWholeModelBetweenItsPlanes) {
    for (const wchar_t* const line :
         {L"Camera Parallel=No Location 3,0,1 Target 0,0,1 _Enter",
          L"Camera Parallel=Yes Location 0.5,0,1 _Enter"}) { // within the model
        runAll({line, TURN});
        const Json gltf = exportedGltf();
        const Json& camera = gltf["cameras"][0];
        const Json& planes = camera[camera["type"].get<std::string>()];
        EXPECT_GE(planes["znear"].get<double>(), 0.0);
        for (std::size_t frame = 0; frame < 5; ++frame) {
            const KM_Viewport seen = readPosed(gltf, frame, 0).cameras.at(0).viewport;
            for (int number = 0; number < 8; ++number) {
                const KM_3dPoint end =
                    KM_BoundingBox(KM_3dPoint(-1, -1, 0), KM_3dPoint(1, 1, 2)).Corner(number);
                const double depth = (seen.CameraLocation() - end) * seen.CameraZ();
                EXPECT_GT(depth, planes["znear"].get<double>());
                EXPECT_LT(depth, planes["zfar"].get<double>());
            }
        }
    }
}

TEST_F(GltfCamera, OfASunStudyStandsStillUnderALightThatTurns) {
    runAll({L"SetOneDaySunAnimation 51 0 0 21 12 2026 6 0 18 0 60 _png _RenderedViewport _Enter "
            L"_Enter"});
    const Json gltf = exportedGltf();
    EXPECT_EQ(gltf["animations"][0]["channels"].size(), 1U) << "the camera does not move";
    EXPECT_EQ(gltf["extensionsUsed"], Json({"KHR_lights_punctual"}));
    for (std::size_t frame = 0; frame < 13; ++frame) {
        const ImportedModel model = readPosed(gltf, frame, 1);
        ASSERT_EQ(model.lights.size(), 1U);
        const KM_3dPoint sun = record().CameraPoints()[static_cast<int>(frame)];
        EXPECT_EQ(model.lights[0].Style(), KM_LightStyle::world_directional);
        EXPECT_TRUE(near(-KM_3dVector(sun), model.lights[0].Direction(), 1e-6)) << frame;
        expectSameFrustum(perspective().viewport(), model.cameras.at(0).viewport, 1.0);
    }
    EXPECT_THAT(said(), HasSubstr("Wrote the camera and the sun of 13 frames"));
}

TEST_F(GltfCamera, OfASunBetweenTwoKeysIsAboutWhereThatSunIs) {
    setUpSunFrames(9);
    for (int k = 0; k < 9; ++k) // in steps of 20 degrees round a cone about the Y axis
        record().CameraPoints()[k] = {std::cos(k * KM_PI / 9), 0.5, std::sin(k * KM_PI / 9)};
    const double step = 2.0 * std::asin(std::sin(KM_PI / 18) / std::hypot(1.0, 0.5));
    const std::vector<float> turns = keysOf(exportedGltf(), 1, "rotation");
    ASSERT_EQ(turns.size(), 36U);
    for (std::size_t k = 4; k < turns.size(); k += 4) {
        const double half = turns[k] * turns[k - 4] + turns[k + 1] * turns[k - 3] +
                            turns[k + 2] * turns[k - 2] + turns[k + 3] * turns[k - 1];
        EXPECT_LT(2.0 * std::acos(half), 1.05 * step) << "it turns hardly more than the sun does";
    }
}

TEST_F(GltfCamera, InABinaryFileIsTheSame) {
    runAll({TURN});
    Json text = exportedGltf();
    const std::vector<std::uint8_t> buffer = bufferOf(text);
    const std::string binary = exported("camera.glb");
    const auto number = [&](std::size_t at) {
        std::uint32_t value = 0;
        std::memcpy(&value, binary.data() + at, 4);
        return value;
    };
    ASSERT_EQ(binary.substr(0, 4), "glTF");
    EXPECT_EQ(number(4), 2U);
    EXPECT_EQ(number(8), binary.size());
    const std::size_t json_size = number(12);
    EXPECT_EQ(json_size % 4, 0U);
    EXPECT_EQ(binary.substr(16, 4), "JSON");
    text["buffers"][0].erase("uri");
    EXPECT_EQ(Json::parse(binary.substr(20, json_size)), text);
    EXPECT_EQ(number(20 + json_size), buffer.size());
    EXPECT_EQ(binary.substr(24 + json_size, 4), std::string("BIN\0", 4));
    EXPECT_EQ(binary.substr(28 + json_size), std::string(buffer.begin(), buffer.end()));
}

TEST_F(GltfCamera, ThatLooksAskewIsStraightenedAndThatIsTold) {
    KM_Viewport askew = perspective().viewport();
    ASSERT_TRUE(askew.SetFrustum(-0.03, 0.05, -0.02, 0.04, 0.1, 100.0));
    perspective().setViewport(askew, true, true);
    setUpCameras({{-6, 0, 8}});
    const Json gltf = exportedGltf();
    EXPECT_THAT(said(), HasSubstr("looks askew, which glTF cannot tell"));
    EXPECT_NEAR(gltf["cameras"][0]["perspective"]["yfov"].get<double>(), 2 * std::atan(0.3), 1e-12);
    EXPECT_NEAR(gltf["cameras"][0]["perspective"]["aspectRatio"].get<double>(), 4.0 / 3.0, 1e-12);
    runAll({L"Camera Parallel=Yes _Enter"});
    expectDrawnFrusta(1.0);
}

TEST_F(GltfCamera, FarOutSaysHowExactlyItIsKept) {
    setUpCameras({{4e6, 5e6, 0}});
    record().TargetPoints()[0] = {4e6, 5e6 + 10.0, 0};
    (void)exportedGltf();
    EXPECT_THAT(said(), HasSubstr("glTF keeps places to 0.2 m only")); // half of 2^-1 m, to a digit
}

TEST_F(GltfCamera, FartherOutThanItsNumbersGoIsRefused) {
    setUpCameras({{1, 0, 0}, {1e300, 0, 0}});
    for (const char* const name : {"camera.gltf", "camera.glb"}) {
        EXPECT_EQ(exportTo(folder / name), CQuarnCommand::failure);
        EXPECT_THAT(said(), HasSubstr("The camera of frame 1 stands too far away for glTF"));
        EXPECT_FALSE(std::filesystem::exists(folder / name));
    }
    EXPECT_EQ(pointOf(exportedJson()["frames"][1]["place"]).x, 1e300);
}

} // namespace
} // namespace quarn::test
