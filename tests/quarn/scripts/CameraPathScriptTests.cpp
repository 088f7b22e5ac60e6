#include "tests/quarn/ProgramRun.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::SizeIs;
using testing::StartsWith;

Ended show(const std::string& command, std::vector<std::string> options) {
    options.insert(options.begin(), {command, "town.obj", "--out", "out", "--show-script"});
    return run(options);
}

Ended flythrough(std::vector<std::string> options) {
    options.insert(options.begin(), {"--frames", "8"});
    return show("flythrough", options);
}

Ended path(std::vector<std::string> options) {
    options.insert(options.begin(), {"--frames", "8"});
    return show("path", options);
}

std::vector<std::string> scriptOf(const Ended& ended) {
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    return linesOf(ended.out);
}

void expectRefusal(const Ended& ended, const std::vector<std::string>& words) {
    EXPECT_EQ(ended.exit_code, 2);
    EXPECT_THAT(ended.out, IsEmpty());
    EXPECT_THAT(linesOf(ended.err), SizeIs(1));
    EXPECT_THAT(ended.err, StartsWith("quarn: "));
    for (const std::string& word : words)
        EXPECT_THAT(ended.err, HasSubstr(word));
}

// ---- The scripts

TEST(FlythroughScript, SetsUpAFlightAlongANamedCurve) {
    EXPECT_THAT(scriptOf(flythrough({"--path", "Main street"})),
                ElementsAre("_-Import \"town.obj\"", "_-ViewportSize 1280 720",
                            "_-Camera _Parallel=No _Lens 24 _Enter", "_-AnimationName \"town\"",
                            "_-SetFlythroughAnimation \"Main street\" 8 _jpg _RenderedViewport "
                            "_Enter _Enter",
                            "# The folder must be there before the recording starts.",
                            "_-NextRecording _IfSame _Enter",
                            "_-RecordAnimation _TargetFolder \"out\" _Enter"));
}

TEST(FlythroughScript, ReadsACurveFileAndEvensItBeforeTheSetUp) {
    const auto lines =
        scriptOf(flythrough({"--camera-curve", "my walk.txt", "--even-speed", "--lens", "35.5",
                             "--hide", "Trees", "--up", "z", "--size", "640x360", "--mode", "clay",
                             "--format", "png", "--name", "Tour", "--save", "tour"}));
    EXPECT_THAT(lines,
                ElementsAre("_-Import [Up] _Z \"town.obj\"", "_-Hide \"Trees\"",
                            "_-ViewportSize 640 360",
                            "_-ImportCurve [Replace] \"Camera curve\" \"my walk.txt\"",
                            "_-EvenSpeed \"Camera curve\"",
                            "_-Camera _Parallel=No _Lens 35.5 _Enter", "_-AnimationName \"Tour\"",
                            "_-SetFlythroughAnimation \"Camera curve\" 8 _png _Clay _Enter _Enter",
                            "# The folder must be there before the recording starts.",
                            "_-SaveAs \"tour.quarn\"", "_-NextRecording _IfSame _Enter",
                            "_-RecordAnimation _TargetFolder \"out\" _Enter"));
}

TEST(FlythroughScript, KeepsTheLensOfADocumentUnlessOneIsGiven) {
    const std::vector<std::string> arguments = {"flythrough", "town.quarn", "--path",
                                                "Way",        "--frames",   "8",
                                                "--out",      "out",        "--show-script"};
    EXPECT_THAT(scriptOf(run(arguments)), Contains("_-Camera _Parallel=No _Enter"));
    std::vector<std::string> with_lens = arguments;
    with_lens.insert(with_lens.end(), {"--lens", "50"});
    EXPECT_THAT(scriptOf(run(with_lens)), Contains("_-Camera _Parallel=No _Lens 50 _Enter"));
}

TEST(PathScript, FollowsTwoNamedObjects) {
    EXPECT_THAT(scriptOf(path({"--camera", "Roof line", "--target", "_Enter"})),
                Contains("_-SetPathAnimation \"Roof line\" \"_Enter\" 8 _jpg _RenderedViewport "
                         "_Enter _Enter"));
}

TEST(PathScript, MakesCurvesAndPointsOfFilesAndPlaces) {
    const auto both = scriptOf(path({"--camera-curve", "a.txt", "--target-curve", "b.json"}));
    EXPECT_THAT(both, Contains("_-ImportCurve [Replace] \"Camera curve\" \"a.txt\""));
    EXPECT_THAT(both, Contains("_-ImportCurve [Replace] \"Target curve\" \"b.json\""));
    EXPECT_THAT(both,
                Contains(StartsWith("_-SetPathAnimation \"Camera curve\" \"Target curve\" ")));
    const auto places = scriptOf(path({"--camera-point", "-2,4.5,1e3", "--target-point", "0,0,1"}));
    EXPECT_THAT(places, Contains("_-Point _Replace \"Camera point\" -2,4.5,1000"));
    EXPECT_THAT(places, Contains("_-Point _Replace \"Target point\" 0,0,1"));
    EXPECT_THAT(places,
                Contains(StartsWith("_-SetPathAnimation \"Camera point\" \"Target point\" ")));
}

TEST(PathScript, EvensTheCamerasCurveAlone) {
    const auto lines = scriptOf(path({"--camera", "Arc", "--target", "Frieze", "--even-speed"}));
    EXPECT_THAT(lines, Contains("_-EvenSpeed \"Arc\""));
    EXPECT_THAT(lines, Not(Contains(HasSubstr("EvenSpeed \"Frieze"))));
}

// ---- Refusals

TEST(FlythroughArguments, NeedExactlyOneCurve) {
    expectRefusal(flythrough({}), {"--path or --camera-curve", "quarn curves"});
    expectRefusal(flythrough({"--path", "Way", "--camera-curve", "way.txt"}),
                  {"only one of --path or --camera-curve"});
    expectRefusal(flythrough({"--path", "Way", "--path", "Street"}), {"--path"});
}

TEST(FlythroughArguments, ThatAreNoneAreRefused) {
    for (const char* frames : {"0", "-1", "many", "2.5"})
        expectRefusal(show("flythrough", {"--path", "Way", "--frames", frames}),
                      {"--frames must be a whole number from 1", frames});
    for (const char* lens : {"0", "0.5", "10001", "wide", "nan"})
        expectRefusal(flythrough({"--path", "Way", "--lens", lens}),
                      {"--lens must be a number of millimetres from 1 to 10000", lens});
    expectRefusal(flythrough({"--path", "Way", "--mode", "Cubist"}), {"unknown display mode"});
    expectRefusal(flythrough({"--path", "Way", "--size", "0x9"}), {"--size"});
    expectRefusal(flythrough({"--path", "Way", "--target", "Tower"}), {"--target"});
    expectRefusal(flythrough({"--path", "Way", "--direction", "clockwise"}), {"--direction"});
}

TEST(FlythroughArguments, NamesThatNoScriptCanHoldAreRefused) {
    for (const char* name : {"", "a\"b", "a\nb"}) {
        expectRefusal(flythrough({"--path", name}), {"--path"});
        expectRefusal(flythrough({"--camera-curve", name}), {"--camera-curve"});
    }
}

TEST(PathArguments, NeedOneCameraAndOneTarget) {
    expectRefusal(path({"--target", "Tower"}), {"--camera or --camera-curve or --camera-point"});
    expectRefusal(path({"--camera", "Arc"}), {"--target or --target-curve or --target-point"});
    expectRefusal(path({"--camera", "Arc", "--camera-curve", "a.txt", "--target", "Tower"}),
                  {"only one of --camera or --camera-curve or --camera-point"});
    expectRefusal(path({"--camera", "Arc", "--target", "Tower", "--target-point", "0,0,0"}),
                  {"only one of --target or --target-curve or --target-point"});
}

TEST(PathArguments, CameraAndTargetMustDiffer) {
    expectRefusal(path({"--camera", "Arc", "--target", "arc"}), {"must not be the same"});
    expectRefusal(path({"--camera-curve", "a.txt", "--target-curve", "a.txt"}),
                  {"must not be the same"});
    expectRefusal(path({"--camera-point", "1,2,3", "--target-point", "1,2,3.0"}),
                  {"must not be the same"});
}

TEST(PathArguments, PlacesThatAreNoneAreRefused) {
    for (const char* place : {"1,2", "1,2,x", "nan,0,0", "1, 2,3", ""}) {
        expectRefusal(path({"--camera-point", place, "--target", "Tower"}),
                      {"--camera-point must be three numbers"});
        expectRefusal(path({"--camera", "Arc", "--target-point", place}),
                      {"--target-point must be three numbers"});
    }
}

TEST(PathArguments, EvenSpeedNeedsACurveForTheCamera) {
    expectRefusal(path({"--camera-point", "1,2,3", "--target", "Frieze", "--even-speed"}),
                  {"--even-speed"});
}

// ---- Help

TEST(CameraPathHelp, NamesTheOptionsAndShowsExamples) {
    const std::vector<const char*> shared = {
        "--frames",      "--out",      "--size",    "--mode",       "--format",
        "--hide",        "--up",       "--name",    "--save",       "--lens",
        "--show-script", "--language", "--verbose", "--even-speed", "Examples:"};
    const Ended flight = run({"flythrough", "--help"});
    const Ended path_help = run({"path", "--help"});
    EXPECT_EQ(flight.exit_code, 0);
    EXPECT_EQ(path_help.exit_code, 0);
    for (const char* word : shared) {
        EXPECT_THAT(flight.out, HasSubstr(word));
        EXPECT_THAT(path_help.out, HasSubstr(word));
    }
    EXPECT_THAT(flight.out, HasSubstr("--path"));
    for (const char* word : {"--camera", "--camera-curve", "--camera-point", "--target",
                             "--target-curve", "--target-point"})
        EXPECT_THAT(path_help.out, HasSubstr(word));
    EXPECT_THAT(run({"curves", "--help"}).out, HasSubstr("quarn curves town.obj"));
}

} // namespace
} // namespace quarn::test
