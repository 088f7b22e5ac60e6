#include "tests/quarn/ProgramRun.h"

#include <cmath>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <numbers>

namespace quarn::test {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::SizeIs;
using testing::StartsWith;

std::vector<std::string> scriptOf(std::vector<std::string> arguments) {
    arguments.insert(arguments.begin(), "turntable");
    arguments.push_back("--show-script");
    const Ended ended = run(arguments);
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.err, IsEmpty());
    return linesOf(ended.out);
}

std::vector<std::string> scriptWith(std::vector<std::string> options) {
    options.insert(options.begin(), {"house.obj", "--frames", "8", "--out", "out"});
    return scriptOf(options);
}

struct CameraLine {
    double location[3];
    double target[3];
};

CameraLine readCameraLine(const std::string& line) {
    CameraLine camera{};
    EXPECT_EQ(std::sscanf(line.c_str(), "_-Camera _Location %lf,%lf,%lf _Target %lf,%lf,%lf _Enter",
                          &camera.location[0], &camera.location[1], &camera.location[2],
                          &camera.target[0], &camera.target[1], &camera.target[2]),
              6)
        << line;
    return camera;
}

double elevation_deg(const CameraLine& camera) {
    const double x = camera.location[0] - camera.target[0];
    const double y = camera.location[1] - camera.target[1];
    const double z = camera.location[2] - camera.target[2];
    return std::atan2(z, std::hypot(x, y)) * 180.0 / std::numbers::pi;
}

TEST(ShowScript, IsTheWholeScriptOfTheDefaults) {
    const auto lines = scriptOf({"models/house.obj", "--frames", "120", "--out", "out/house"});
    ASSERT_THAT(lines, SizeIs(9));
    EXPECT_EQ(lines[0], "_-Import \"models/house.obj\"");
    EXPECT_EQ(lines[1], "_-ViewportSize 1280 720");
    EXPECT_THAT(lines[2], StartsWith("_-Camera _Location "));
    EXPECT_EQ(lines[3], "_-FitView _Turn=Yes _Enter");
    EXPECT_EQ(lines[4], "_-AnimationName \"house\"");
    EXPECT_EQ(lines[5],
              "_-SetTurntableAnimation 120 _Clockwise _jpg _RenderedViewport _Enter _Enter");
    EXPECT_EQ(lines[6], "# The folder must be there before the recording starts.");
    EXPECT_EQ(lines[7], "_-NextRecording _IfSame _Enter");
    EXPECT_EQ(lines[8], "_-RecordAnimation _TargetFolder \"out/house\" _Enter");
}

TEST(ShowScript, NeedsNoMoreThanAModel) {
    const auto lines = scriptOf({"models/house.obj"});
    EXPECT_THAT(lines[5], StartsWith("_-SetTurntableAnimation 72 "));
    EXPECT_EQ(lines[8], "_-RecordAnimation _TargetFolder \"models/house\" _Enter");
    EXPECT_EQ(scriptOf({"house.obj"})[8], "_-RecordAnimation _TargetFolder \"house\" _Enter");
    EXPECT_EQ(scriptOf({"/a b/old.house.glb"})[8],
              "_-RecordAnimation _TargetFolder \"/a b/old.house\" _Enter");
}

TEST(ShowScript, LensIsChosenBeforeTheModelIsFitted) {
    const auto lines = scriptWith({"--lens", "85.5"});
    EXPECT_THAT(lines[2], testing::EndsWith(" _Parallel=No _Lens 85.5 _Enter"));
    EXPECT_THAT(lines[3], StartsWith("_-FitView"));
    EXPECT_THAT(scriptWith({})[2], Not(HasSubstr("_Lens")));
}

TEST(ShowScript, GoesOnWithTheSameRecordingAloneWhereThatIsAskedFor) {
    EXPECT_EQ(scriptWith({"--resume"})[7], "_-NextRecording _Resume _Enter");
    EXPECT_EQ(scriptWith({"--resume", "--overwrite"})[7], "_-NextRecording _IfSame _Enter");
}

TEST(ShowScript, QualityIsSetBeforeTheRecording) {
    const auto lines = scriptWith({"--quality", "75"});
    ASSERT_THAT(lines, SizeIs(10));
    EXPECT_EQ(lines[6], "_-JpegQuality 75");
}

TEST(ShowScript, QualityIsForJpgAlone) {
    for (const char* format : {"png", "bmp", "tga"}) {
        const Ended ended = run({"turntable", "house.obj", "--quality", "75", "--format", format});
        EXPECT_EQ(ended.exit_code, 2);
        EXPECT_EQ(ended.err,
                  std::string("quarn: --quality is for jpg pictures, not for ") + format + ".\n");
    }
    for (const char* quality : {"0", "101", "good"})
        EXPECT_THAT(run({"turntable", "house.obj", "--quality", quality}).err,
                    HasSubstr("--quality must be a whole number from 1 to 100"));
}

TEST(ShowScript, ReadsTheModelWithTheAxisThatPointsUp) {
    EXPECT_EQ(scriptWith({"--up", "y"})[0], "_-Import [Up] _Y \"house.obj\"");
    EXPECT_EQ(scriptWith({"--up", "Z"})[0], "_-Import [Up] _Z \"house.obj\"");
}

TEST(ShowScript, HidesObjectsBeforeTheModelIsFitted) {
    const auto lines = scriptWith({"--hide", "Walk", "--hide", "North gate"});
    ASSERT_THAT(lines, SizeIs(11));
    EXPECT_EQ(lines[1], "_-Hide \"Walk\"");
    EXPECT_EQ(lines[2], "_-Hide \"North gate\"");
    EXPECT_EQ(lines[5], "_-FitView _Turn=Yes _Enter");
}

TEST(ShowScript, TakesEveryOption) {
    const auto lines =
        scriptOf({"house.obj", "--frames", "36", "--out", "my out", "--size", "640x480", "--mode",
                  "x-ray", "--format", "PNG", "--direction", "anticlockwise", "--distance", "1.25",
                  "--target", "-1,2.5,1e3", "--name", "Town hall"});
    ASSERT_THAT(lines, SizeIs(9));
    EXPECT_EQ(lines[1], "_-ViewportSize 640 480");
    EXPECT_THAT(lines[2], HasSubstr(" _Target -1,2.5,1000 _Enter"));
    EXPECT_EQ(lines[3], "_-FitView _Turn=Yes _KeepTarget=Yes _Distance 1.25 _Enter");
    EXPECT_EQ(lines[4], "_-AnimationName \"Town hall\"");
    EXPECT_EQ(lines[5], "_-SetTurntableAnimation 36 _AntiClockwise _png _XRay _Enter _Enter");
    EXPECT_EQ(lines[8], "_-RecordAnimation _TargetFolder \"my out\" _Enter");
}

TEST(ShowScript, CameraStandsAtItsElevationToTheFrontAndTheRight) {
    const CameraLine by_default = readCameraLine(scriptWith({})[2]);
    EXPECT_NEAR(elevation_deg(by_default), 22.0, 1e-9);
    EXPECT_GT(by_default.location[0], 0.0);
    EXPECT_LT(by_default.location[1], 0.0);
    const CameraLine below = readCameraLine(scriptWith({"--elevation", "-30.5"})[2]);
    EXPECT_NEAR(elevation_deg(below), -30.5, 1e-9);
}

TEST(ShowScript, CameraKeepsItsElevationBesideATargetFarAway) {
    const CameraLine far_away =
        readCameraLine(scriptWith({"--target", "7e12,-3,2", "--elevation", "45"})[2]);
    EXPECT_EQ(far_away.target[0], 7e12);
    EXPECT_NEAR(elevation_deg(far_away), 45.0, 1e-6);
}

TEST(ShowScript, NumbersReadBackExactly) {
    const auto lines = scriptWith({"--target", "0.1,0.30000000000000004,12345678.000000002"});
    const CameraLine camera = readCameraLine(lines[2]);
    EXPECT_EQ(camera.target[0], 0.1);
    EXPECT_EQ(camera.target[1], 0.30000000000000004);
    EXPECT_EQ(camera.target[2], 12345678.000000002);
}

TEST(ShowScript, ModeIsTheOptionThatTheCapturePromptKnows) {
    const std::vector<std::pair<const char*, const char*>> cases = {
        {"Rendered", "_RenderedViewport"},
        {"renderedviewport", "_RenderedViewport"},
        {"X-Ray", "_XRay"},
        {"xray", "_XRay"},
        {"_XRay", "_XRay"},
        {"WIREFRAME", "_Wireframe"},
        {"Shaded", "_Shaded"},
        {"RenderFull", "_RenderFull"},
        {"render_preview", "_RenderPreview"}};
    for (const auto& [mode, option] : cases)
        EXPECT_THAT(scriptWith({"--mode", mode})[5], HasSubstr(std::string(" ") + option + " "))
            << mode;
}

TEST(ShowScript, RenderedPicturesGetTheSizeToo) {
    for (const char* mode : {"RenderFull", "RenderPreview"})
        EXPECT_EQ(scriptWith({"--mode", mode, "--size", "640x480"})[6],
                  "_-RenderSettings _Size 640 480 _Enter");
    EXPECT_THAT(scriptWith({"--mode", "Rendered"})[6], testing::StartsWith("#"));
}

TEST(ShowScript, SamplesAreThoseOfTheRenderMethod) {
    const auto settings = [](const char* mode, const char* samples) {
        return scriptWith({"--mode", mode, "--samples", samples})[6];
    };
    EXPECT_EQ(settings("RenderFull", "200"), "_-RenderSettings _Size 1280 720 _Samples 200 _Enter");
    EXPECT_EQ(settings("RenderPreview", "1"),
              "_-RenderSettings _Size 1280 720 _PreviewSamples 1 _Enter");
    EXPECT_EQ(settings("RenderFull", "16384"),
              "_-RenderSettings _Size 1280 720 _Samples 16384 _Enter");
}

TEST(ShowScript, LightIsSetAsItIsAskedForAndElseLeftAsTheDocumentHasIt) {
    EXPECT_EQ(scriptWith({"--light", "Studio"})[6], "_-RenderSettings _Light _Studio _Enter");
    EXPECT_EQ(scriptWith({"--exposure", "-1.50", "--ground", "off"})[6],
              "_-RenderSettings _Exposure -1.5 _Ground=No _Enter");
    EXPECT_EQ(scriptWith({"--background", "FF8800", "--ground", "on"})[6],
              "_-RenderSettings _Background _Colour \"#ff8800\" _Ground=Yes _Enter");
    EXPECT_EQ(scriptWith({"--light", "automatic", "--exposure", "automatic", "--background",
                          "automatic", "--mode", "RenderPreview", "--samples", "4"})[6],
              "_-RenderSettings _Size 1280 720 _PreviewSamples 4 _Light _Automatic _Exposure "
              "_Automatic _Background _Automatic _Enter");
    EXPECT_EQ(scriptWith({"--background", "transparent", "--format", "png"})[6],
              "_-RenderSettings _Background _Transparent _Enter");
}

TEST(ShowScript, NameComesFromTheModelWithoutForbiddenCharacters) {
    const auto name_of = [](const std::string& model) {
        return scriptOf({model, "--frames", "8", "--out", "out"})[4];
    };
    EXPECT_EQ(name_of("a/b/Grand Hall.v2.glb"), "_-AnimationName \"Grand Hall.v2\"");
    EXPECT_EQ(name_of("a:b*c?d<e>f|g\\h#i%j.obj"), "_-AnimationName \"a_b_c_d_e_f_g_h_i_j\"");
    EXPECT_EQ(name_of("größe.obj"), "_-AnimationName \"größe\"");
    EXPECT_EQ(name_of("_Enter.obj"), "_-AnimationName \"_Enter\"");
}

TEST(ShowScript, LongNameOfAModelIsCutBetweenTwoCharacters) {
    std::string model;
    for (int i = 0; i < 125; ++i)
        model += "ä"; // two bytes each; 241 bytes hold 120 of them
    std::string expected;
    for (int i = 0; i < 120; ++i)
        expected += "ä";
    EXPECT_EQ(scriptOf({model, "--frames", "8", "--out", "out"})[4],
              "_-AnimationName \"" + expected + "\"");
}

TEST(ShowScript, ReadsCurvedSurfacesAsNearAsWasAsked) {
    const auto lines = scriptOf(
        {"gear.step", "--frames", "8", "--out", "out", "--tolerance", "0.05", "--up", "y"});
    EXPECT_EQ(lines[0], "_-Import [Up] _Y [Tolerance] 0.05 \"gear.step\"");
}

TEST(ShowScript, ToleranceIsOfModelFilesAlone) {
    const Ended ended = run({"turntable", "house.quarn", "--frames", "8", "--out", "out",
                             "--tolerance", "0.05", "--show-script"});
    EXPECT_EQ(ended.exit_code, 2);
    EXPECT_THAT(ended.err, HasSubstr("--tolerance is for model files"));
}

TEST(ShowScript, RunsNothing) {
    TempFolder folder;
    Start start;
    start.folder = folder.path();
    start.arguments = {"turntable", "missing.obj", "--frames",     "8",
                       "--out",     "out",         "--show-script"};
    EXPECT_EQ(run(start).exit_code, 0);
    EXPECT_TRUE(std::filesystem::is_empty(folder.path()));
}

} // namespace
} // namespace quarn::test
