#include "host/share/Base64Text.h"
#include "import/ImportedModel.h"
#include "tests/host/share/camera/CameraFixture.h"

#include <chrono>

namespace quarn::test {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;

using Table = std::vector<std::vector<std::string>>;

/// The fields of a table in RFC 4180's form.
Table tableOf(const std::string& csv) {
    Table table(1);
    std::string field;
    bool is_quoted = false;
    for (std::size_t i = 0; i < csv.size(); ++i) {
        const char c = csv[i];
        if (c == '"' && is_quoted && csv[i + 1] == '"')
            field += csv[++i];
        else if (c == '"')
            is_quoted = !is_quoted;
        else if (is_quoted || (c != ',' && c != '\r' && c != '\n'))
            field += c;
        else if (c != '\r')
            table.back().push_back(std::exchange(field, {}));
        if (c == '\n' && !is_quoted)
            table.emplace_back();
    }
    EXPECT_TRUE(table.back().empty()) << "the last line ends too";
    table.pop_back();
    return table;
}

class ExportCamera : public CameraFixture {
protected:
    void expectRefused(const std::string& name, const char* reason) {
        EXPECT_EQ(exportTo(folder / name), CQuarnCommand::failure) << name;
        EXPECT_THAT(said(), HasSubstr(reason)) << name;
        EXPECT_FALSE(std::filesystem::exists(folder / name)) << name;
    }
};

TEST_F(ExportCamera, WritesATableOfWhatTheJsonHolds) {
    runAll({L"SetTurntableAnimation 3 _Clockwise _png _Wireframe _Enter _Enter"});
    const Json track = exportedJson();
    const Table table = tableOf(exported("camera.CSV"));
    ASSERT_EQ(table.size(), 4U);
    const auto field = [&](std::size_t row, const std::string& column) {
        const auto at = std::ranges::find(table[0], column);
        EXPECT_NE(at, table[0].end()) << column;
        return table[row].at(static_cast<std::size_t>(at - table[0].begin()));
    };
    for (std::size_t frame = 0; frame < 3; ++frame) {
        const Json& told = track["frames"][frame];
        ASSERT_EQ(table[frame + 1].size(), table[0].size());
        EXPECT_EQ(field(frame + 1, "frame"), std::to_string(frame));
        EXPECT_EQ(std::stod(field(frame + 1, "time_s")), told["time_s"]);
        const char* const axes[] = {"_x", "_y", "_z"};
        for (const std::string point : {"place", "target", "direction", "up"})
            for (std::size_t axis = 0; axis < 3; ++axis)
                EXPECT_EQ(std::stod(field(frame + 1, point + axes[axis])), told[point][axis]);
        EXPECT_EQ(std::stod(field(frame + 1, "lens_mm")), track["lens_mm"]);
        EXPECT_EQ(field(frame + 1, "units"), "");
        EXPECT_EQ(field(frame + 1, "width") + field(frame + 1, "sun_x"), "");
    }
}

TEST_F(ExportCamera, TellsTheSunOfEachFrameInTheTable) {
    runAll({L"SetOneDaySunAnimation 40 20 10 21 6 2026 9 0 10 0 30 _png _RenderedViewport _Enter "
            L"_Enter"});
    const Json track = exportedJson();
    const Table table = tableOf(exported("camera.csv"));
    ASSERT_EQ(table.size(), 4U);
    for (std::size_t frame = 0; frame < 3; ++frame) {
        const std::vector<std::string>& row = table[frame + 1];
        const Json& sun = track["frames"][frame]["sun"];
        ASSERT_EQ(row.size(), table[0].size());
        EXPECT_EQ(row[row.size() - 4], sun["time"]);
        EXPECT_EQ(row[row.size() - 3], "UTC+1");
        EXPECT_EQ(std::stod(row[row.size() - 1]), sun["altitude_deg"]);
        EXPECT_EQ(std::stod(row[row.size() - 7]), sun["direction"][0]);
    }
}

TEST_F(ExportCamera, KeepsHostileNamesInEveryForm) {
    setUpCameras({{-6, 0, 8}});
    record().SetHtmlFilename(L"</script>, \"roof\"\r\nover\u202Eall");
    const std::string name = "</script>, \"roof\"\r\nover\u202Eall";
    EXPECT_EQ(exportedJson()["name"], name);
    EXPECT_EQ(tableOf(exported("camera.csv")).at(1).at(0), name);
    EXPECT_EQ(Json::parse(exported("camera.gltf"))["nodes"][0]["name"], name);
}

TEST_F(ExportCamera, NamesUnitsAndTheWayUp) {
    setUpCameras({{-6, 0, 8}});
    const Json none = exportedJson();
    EXPECT_TRUE(none["units"].is_null());
    EXPECT_TRUE(none["metres_per_unit"].is_null());
    ImportedModel model;
    model.units = UnitSystem::feet;
    document().objects().remove(objectId(L"roof"));
    document().addModel(model);
    const Json feet = exportedJson();
    EXPECT_EQ(feet["units"], "feet");
    EXPECT_EQ(feet["metres_per_unit"], 0.3048);
    EXPECT_EQ(feet["up_axis"], "z");
    EXPECT_EQ(pointOf(feet["frames"][0]["place"]).z, 8.0) << "in the model's units";
}

TEST_F(ExportCamera, WithoutAnAnimationNamesACommandThatSetsOneUp) {
    expectRefused("camera.json", "The document has no animation. Set one up, such as with "
                                 "SetTurntableAnimation");
}

TEST_F(ExportCamera, OfAViewThatIsGoneSaysWhichOne) {
    setUpCameras({{-6, 0, 8}});
    runAll({L"RemoveView Perspective"});
    expectRefused("camera.json", "made for the view \"Perspective\", which the document does not");
}

TEST_F(ExportCamera, RefusesAnExtensionThatItDoesNotKnow) {
    setUpCameras({{-6, 0, 8}});
    for (const char* const name : {"camera.fbx", "camera", "camera.", "json"})
        expectRefused(name, "Give a file that ends in .glb, .gltf, .json or .csv");
}

TEST_F(ExportCamera, OfASunWithoutDirectionSaysWhichFrameLacksIt) {
    setUpSunFrames(3);
    for (const KM_3dPoint& nowhere : {KM_3dPoint::Origin, KM_3dPoint(HUGE_VAL, 0, 0)}) {
        record().CameraPoints()[1] = nowhere;
        expectRefused("camera.json", "The sun of frame 1 has no direction");
    }
}

TEST_F(ExportCamera, IntoAFolderThatIsNotThereSaysSo) {
    setUpCameras({{-6, 0, 8}});
    expectRefused("nowhere/camera.json", "nowhere");
}

TEST_F(ExportCamera, LeavesAProtectedFileAsItIs) {
    setUpCameras({{-6, 0, 8}});
    const std::string old = exported("camera.json");
    setUpCameras({{-7, 0, 8}});
    std::filesystem::permissions(folder / "camera.json", std::filesystem::perms::owner_read);
    EXPECT_EQ(exportTo(folder / "camera.json"), CQuarnCommand::failure);
    EXPECT_THAT(said(), HasSubstr("write-protected"));
    EXPECT_EQ(readFile(folder / "camera.json"), old);
}

TEST_F(ExportCamera, ReplacesItsOwnFilesAndNoOthers) {
    setUpCameras({{-6, 0, 8}});
    for (const char* const name : {"camera.gltf", "camera.glb", "camera.json", "camera.csv"}) {
        writeFile(folder / name, "a model");
        EXPECT_EQ(exportTo(folder / name), CQuarnCommand::failure) << name;
        EXPECT_THAT(said(), HasSubstr("is not replaced: it holds something else than a camera"));
        EXPECT_EQ(readFile(folder / name), "a model");
        std::filesystem::remove(folder / name);
        (void)exported(name);
        const std::string again = exported(name);
        EXPECT_THAT(again, testing::Not(testing::IsEmpty())) << name;
    }
}

TEST_F(ExportCamera, NamesWithBlanksThatLackQuotesAreToldAndNothingIsWritten) {
    setUpCameras({{-6, 0, 8}});
    EXPECT_EQ(run(L"-ExportCamera " + wide(folder / "my.json") + L" camera.json"),
              CQuarnCommand::failure);
    EXPECT_FALSE(std::filesystem::exists(folder / "my.json"));
}

TEST_F(ExportCamera, TakesTenThousandFramesInItsStride) {
    KM_3dPointArray cameras;
    for (int k = 0; k < 10000; ++k)
        cameras.Append({6 * std::cos(0.01 * k), 6 * std::sin(0.01 * k), 1 + 0.001 * k});
    setUpCameras(cameras);
    const auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(exportedJson()["frames"].size(), 10000U);
    EXPECT_EQ(tableOf(exported("camera.csv")).size(), 10001U);
    EXPECT_EQ(Json::parse(exported("camera.gltf"))["accessors"][2]["count"], 10000);
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(10));
}

TEST(Base64Text, IsThatOfThePublishedExamples) { // RFC 4648, section 10
    const auto text = [](std::string_view bytes) {
        return base64Text(std::as_bytes(std::span(bytes)));
    };
    EXPECT_EQ(text(""), "");
    EXPECT_EQ(text("f"), "Zg==");
    EXPECT_EQ(text("fo"), "Zm8=");
    EXPECT_EQ(text("foo"), "Zm9v");
    EXPECT_EQ(text("foob"), "Zm9vYg==");
    EXPECT_EQ(text("fooba"), "Zm9vYmE=");
    EXPECT_EQ(text("foobar"), "Zm9vYmFy");
}

} // namespace
} // namespace quarn::test
