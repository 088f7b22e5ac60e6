#include "ground/Checksum.h"
#include "tests/quarn/Studio.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

namespace quarn::test {
namespace {

using nlohmann::json;
using testing::HasSubstr;

json manifestOf(const std::filesystem::path& file) {
    return json::parse(readFile(file));
}

TEST(RecordedManifestTest, TellsOfEachFrameItsFileAndItsCamera) {
    const Studio studio;
    ASSERT_EQ(run(studio.turntable(4)).exit_code, 0);
    const json manifest = manifestOf(studio / "out/house.frames.json");
    EXPECT_EQ(manifest["kind"], "turntable");
    EXPECT_EQ(manifest["frames"], 4);
    EXPECT_EQ(manifest["width_px"], 64);
    ASSERT_EQ(manifest["images"].size(), 4U);
    for (const json& image : manifest["images"]) {
        const auto file = studio / "out" / image["file"].get<std::string>();
        const auto sum = checksumOfFile(file);
        ASSERT_TRUE(sum);
        EXPECT_EQ(image["bytes"], sum.value().bytes);
        EXPECT_EQ(image["xxh64"], checksumText(sum.value().xxh64));
    }
    // A quarter turn apart, at one height.
    const json& first = manifest["images"][0]["camera"];
    const json& third = manifest["images"][2]["camera"];
    for (int axis = 0; axis < 2; ++axis) {
        const double middle = first["target"][axis];
        EXPECT_NEAR(first["place"][axis].get<double>() - middle,
                    middle - third["place"][axis].get<double>(), 1e-9);
    }
    EXPECT_EQ(first["place"][2], third["place"][2]);
    EXPECT_FALSE(manifest["images"][0].contains("sun"));
}

TEST(RecordedManifestTest, OfASunStudyTellsWhenAFrameIsAndWhereItsSunStands) {
    const Studio studio;
    Start start;
    start.folder = studio.path();
    // Zone, azimuth and altitude of the published worked example of the solar position algorithm
    // (I. Reda and A. Andreas, NREL/TP-560-34302, table A5.1), half a minute from it.
    start.arguments = {"day",       "house.obj", "--latitude", "39.742476", "--longitude",
                       "-105.1786", "--date",    "2003-10-17", "--from",    "12:30",
                       "--to",      "12:31",     "--every",    "1",         "--size",
                       "64x48",     "--out",     "out",        "--zone",    "-7"};
    const Ended ended = run(start);
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    const json manifest = manifestOf(studio / "out/house.frames.json");
    ASSERT_EQ(manifest["images"].size(), 2U);
    const json& first = manifest["images"][0]["sun"];
    const json& second = manifest["images"][1]["sun"];
    EXPECT_EQ(first["time"], "2003-10-17T12:30:00");
    EXPECT_EQ(first["zone"], "UTC-7");
    const auto between = [&](const char* field) {
        return (first[field].get<double>() + second[field].get<double>()) / 2.0;
    };
    EXPECT_NEAR(between("azimuth_deg"), 194.34024, 0.002);
    EXPECT_NEAR(between("altitude_deg"), 90.0 - 50.11162, 0.02) << "without refraction";
}

TEST(RecordedManifestTest, KnowsTheSameModelAndSettingsAgain) {
    const Studio studio;
    ASSERT_EQ(run(studio.turntable(2)).exit_code, 0);
    ASSERT_EQ(run(studio.turntable(2, {"--out", "again"})).exit_code, 0);
    ASSERT_EQ(run(studio.turntable(2, {"--out", "other", "--size", "64x50"})).exit_code, 0);
    writeFile(studio / "house.obj",
              readFile(studio / "house.obj") + "o Pole\nv 9 9 0\nv 9 9 1\nv 9 8 1\nf -1 -2 -3\n");
    ASSERT_EQ(run(studio.turntable(2, {"--out", "larger"})).exit_code, 0);
    const auto field = [&](const char* folder, const char* name) {
        return manifestOf(studio / folder / "house.frames.json")[name].get<std::string>();
    };
    EXPECT_EQ(field("out", "document"), field("again", "document"));
    EXPECT_EQ(field("out", "settings"), field("again", "settings"));
    EXPECT_EQ(field("out", "document"), field("other", "document"));
    EXPECT_NE(field("out", "settings"), field("other", "settings"));
    EXPECT_NE(field("out", "document"), field("larger", "document"));
}

TEST(RecordedManifestTest, OfRenderedFramesTellsWhatThePictureSpansAndNotTheView) {
    const Studio studio;
    writeFile(studio / "steps.txt",
              "_-ViewportSize 64 32\n_-StandardView _Front\n_-FitView _Enter\n"
              "_-RenderSettings _Size 40 40 _PreviewSamples 1 _Enter\n_-AnimationName house\n"
              "_-SetTurntableAnimation 1 _Clockwise _jpg _RenderPreview _Enter _Enter\n"
              "_-RecordAnimation _TargetFolder out _Enter\n");
    std::filesystem::create_directory(studio / "out");
    Start start;
    start.folder = studio.path();
    start.arguments = {"run", "steps.txt", "house.obj"};
    const Ended ended = run(start);
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    const json manifest = manifestOf(studio / "out/house.frames.json");
    EXPECT_EQ(manifest["width_px"], 40);
    const json& extent = manifest["images"][0]["camera"]["extent"];
    EXPECT_NEAR(extent[0].get<double>(), extent[1].get<double>(), 1e-9);
}

TEST(RecordedManifestTest, OfOthersIsNotReplaced) {
    const Studio studio;
    std::filesystem::create_directory(studio / "out");
    writeFile(studio / "out/house.frames.json", "mine");
    const Ended ended = run(studio.turntable(2));
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.err, HasSubstr("house.frames.json is not replaced"));
    EXPECT_EQ(readFile(studio / "out/house.frames.json"), "mine");
    EXPECT_FALSE(std::filesystem::exists(studio / "out/house000.jpg"));
    EXPECT_EQ(run(studio.turntable(2, {"--overwrite"})).exit_code, 0);
    EXPECT_EQ(manifestOf(studio / "out/house.frames.json")["frames"], 2);
}

} // namespace
} // namespace quarn::test
