#include "tests/quarn/ProgramRun.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::MatchesRegex;
using testing::SizeIs;
using testing::StartsWith;

/// The program refused its arguments with one message of one line, and said nothing else.
void expectRefusal(const Ended& ended, const std::vector<std::string>& words) {
    EXPECT_EQ(ended.exit_code, 2);
    EXPECT_THAT(ended.out, IsEmpty());
    EXPECT_THAT(linesOf(ended.err), SizeIs(1));
    EXPECT_THAT(ended.err, StartsWith("quarn: "));
    for (const std::string& word : words)
        EXPECT_THAT(ended.err, HasSubstr(word));
}

Ended turntable(const std::vector<std::string>& options) {
    std::vector<std::string> arguments = {"turntable", "house.obj", "--show-script"};
    arguments.insert(arguments.end(), options.begin(), options.end());
    return run(arguments);
}

/// With everything that must be there.
Ended wholeTurntable(std::vector<std::string> options) {
    options.insert(options.begin(), {"--frames", "8", "--out", "out"});
    return turntable(options);
}

TEST(Arguments, NoneShowTheShortHelpAndAreAMistake) {
    const Ended ended = run(std::vector<std::string>{});
    EXPECT_EQ(ended.exit_code, 2);
    EXPECT_THAT(ended.out, IsEmpty());
    EXPECT_THAT(ended.err, HasSubstr("quarn turntable MODEL  "));
    EXPECT_THAT(ended.err, HasSubstr("quarn run SCRIPT [MODEL]"));
    EXPECT_THAT(ended.err, HasSubstr("quarn info MODEL"));
}

TEST(Arguments, HelpNamesTheCommandsOnTheStandardOutput) {
    const Ended ended = run({"--help"});
    EXPECT_EQ(ended.exit_code, 0);
    EXPECT_THAT(ended.err, IsEmpty());
    for (const char* word :
         {"turntable", "day", "season", "places", "run", "info", "Examples:", "Exit codes:"})
        EXPECT_THAT(ended.out, HasSubstr(word));
}

TEST(Arguments, HelpOfTurntableNamesEveryOptionItsDefaultAndTheModes) {
    const Ended ended = run({"turntable", "--help"});
    EXPECT_EQ(ended.exit_code, 0);
    for (const char* word :
         {"--frames",  "--out",       "--size",        "1280x720",   "--mode",
          "Wireframe", "X-Ray",       "--format",      "jpg",        "--direction",
          "clockwise", "--elevation", "--distance",    "--target",   "--hide",
          "--up",      "--name",      "--show-script", "--language", "--verbose",
          "Examples:", "--lens",      "--start-angle", "--quality",  "72"})
        EXPECT_THAT(ended.out, HasSubstr(word));
}

TEST(Arguments, VersionIsPrinted) {
    const Ended ended = run({"--version"});
    EXPECT_EQ(ended.exit_code, 0);
    EXPECT_THAT(ended.out, MatchesRegex("quarn [0-9]+\\.[0-9]+\\.[0-9]+\n"));
}

TEST(Arguments, UnknownCommandIsNamed) {
    expectRefusal(run({"turnip"}), {"unknown command turnip",
                                    "day, season, sun, sunpath, sunhours, places, curves, "});
}

TEST(Arguments, UnknownOptionIsNamed) {
    expectRefusal(run({"--frmaes"}), {"unknown option --frmaes"});
    expectRefusal(wholeTurntable({"--frmaes", "3"}), {"unknown option --frmaes"});
    expectRefusal(run({"info", "house.obj", "--frames", "3"}), {"unknown option --frames"});
}

TEST(Arguments, MisspelledOptionIsNamedBeforeTheOneThatIsMissing) {
    expectRefusal(turntable({"--frame", "3", "--out", "out"}), {"unknown option --frame "});
    expectRefusal(turntable({"--frames", "none", "--uot", "out"}), {"unknown option --uot "});
}

TEST(Arguments, HelpHelpsWhateverElseIsTyped) {
    const std::string help = run({"turntable", "--help"}).out;
    for (const std::vector<std::string>& mistake :
         {std::vector<std::string>{"--frames", "none"}, {"--frame", "3"}, {"--mode", "Cubist"}}) {
        std::vector<std::string> arguments = {"turntable", "--help"};
        arguments.insert(arguments.end(), mistake.begin(), mistake.end());
        const Ended ended = run(arguments);
        EXPECT_EQ(ended.exit_code, 0) << ended.err;
        EXPECT_EQ(ended.out, help);
    }
}

TEST(Arguments, LeftOverWordIsNamed) {
    expectRefusal(wholeTurntable({"tree.obj"}), {"unexpected argument tree.obj"});
    expectRefusal(run({"run", "a.txt", "b.obj", "c.obj"}), {"unexpected argument c.obj"});
}

TEST(Arguments, MissingArgumentIsNamed) {
    expectRefusal(run({"turntable"}), {"MODEL is required", "quarn turntable --help"});
    expectRefusal(run({"camera", "house.quarn"}), {"--out is required", "quarn camera --help"});
    expectRefusal(run({"run"}), {"SCRIPT is required", "quarn run --help"});
    expectRefusal(run({"info"}), {"MODEL is required", "quarn info --help"});
    expectRefusal(turntable({"--frames"}), {"--frames"});
}

TEST(Arguments, FileMayBeNamedLikeACommand) {
    const Ended ended =
        run({"turntable", "run", "--frames", "3", "--out", "info", "--show-script"});
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.out, HasSubstr("_-Import \"run\""));
}

class BadFrameCount : public testing::TestWithParam<const char*> {};

TEST_P(BadFrameCount, IsRefusedBeforeAnythingRuns) {
    expectRefusal(turntable({"--frames", GetParam(), "--out", "out"}),
                  {"--frames must be a whole number from 1", GetParam()});
}

INSTANTIATE_TEST_SUITE_P(Arguments, BadFrameCount,
                         testing::Values("0", "-3", "text", "1.5", "12x", "99999999999", "--out",
                                         "1e3"));

TEST(Arguments, FrameCountsFromOneToAHundredThousandAreTaken) {
    for (const char* frames : {"1", "100000", "2147483647"}) {
        const Ended ended = turntable({"--frames", frames, "--out", "out"});
        EXPECT_EQ(ended.exit_code, 0) << ended.err;
        EXPECT_THAT(ended.out, HasSubstr(std::string("_-SetTurntableAnimation ") + frames + " "));
    }
}

TEST(Arguments, UnknownModeListsTheModes) {
    expectRefusal(wholeTurntable({"--mode", "Cubist"}),
                  {"unknown display mode \"Cubist\"", "Wireframe, Shaded, Rendered, Translucent, "
                                                      "X-Ray, Drawing, Clay, RenderFull, "
                                                      "RenderPreview"});
}

TEST(Arguments, SamplesAreForRenderedPicturesAndFrom1To16384) {
    for (const char* samples : {"0", "-1", "16385", "many", "1.5"})
        expectRefusal(wholeTurntable({"--mode", "RenderFull", "--samples", samples}),
                      {"--samples must be a whole number from 1 to 16384", samples});
    expectRefusal(wholeTurntable({"--mode", "Shaded", "--samples", "64"}),
                  {"--samples is for rendered pictures", "RenderFull or RenderPreview", "Shaded"});
    expectRefusal(wholeTurntable({"--samples", "64"}), {"--samples is for rendered pictures"});
}

TEST(Arguments, LightThatIsNoneIsRefusedWithWhatMayBeGiven) {
    expectRefusal(wholeTurntable({"--light", "moon"}),
                  {"--light must be studio, sky, automatic or a picture that ends in .hdr, not "
                   "\"moon\"."});
    expectRefusal(wholeTurntable({"--light", "nowhere.hdr"}),
                  {"--light: there is no picture nowhere.hdr."});
    for (const char* stops : {"bright", "10.5", "-11", "nan", "1e999", ""})
        expectRefusal(wholeTurntable({"--exposure", stops}),
                      {"--exposure must be automatic or a number of stops from -10 to 10, not \"" +
                       std::string(stops) + "\"."});
    for (const char* color : {"red", "#ff88", "ff88001"})
        expectRefusal(wholeTurntable({"--background", color}),
                      {"--background must be transparent, automatic, black, grey, white or a "
                       "colour such as ff8800, not \"" +
                       std::string(color) + "\"."});
    expectRefusal(wholeTurntable({"--ground", "maybe"}),
                  {"--ground must be on or off, not \"maybe\"."});
}

TEST(Arguments, TransparentPicturesOfAKindWithoutOpacityAreRefusedNamingPng) {
    for (const char* kind : {"jpg", "bmp"})
        expectRefusal(wholeTurntable({"--background", "transparent", "--format", kind}),
                      {"--background transparent needs pictures of the kind png, not " +
                       std::string(kind) + ". Give --format png."});
    expectRefusal(wholeTurntable({"--background", "transparent"}), {"not jpg. Give --format png."});
    EXPECT_EQ(wholeTurntable({"--background", "transparent", "--format", "tga"}).exit_code, 0);
    expectRefusal(run({"frame", "house.quarn", "--number", "0", "--background", "transparent",
                       "--show-script", "--out", "still.JPG"}),
                  {"kind png, not jpg. Give --out a file that ends in .png."});
}

TEST(Arguments, UnknownFormatListsTheFormats) {
    expectRefusal(wholeTurntable({"--format", "gif"}), {"jpg, png, bmp or tga", "gif"});
}

TEST(Arguments, UnknownDirectionListsBoth) {
    expectRefusal(wholeTurntable({"--direction", "left"}), {"clockwise or anticlockwise", "left"});
}

TEST(Arguments, SizeThatIsNoneIsRefused) {
    for (const char* size : {"640", "640x", "0x480", "640x-1", "640x480x2", "99999x10", "axb"})
        expectRefusal(wholeTurntable({"--size", size}), {"--size must be", size});
}

TEST(Arguments, CameraValuesThatAreNoneAreRefused) {
    expectRefusal(wholeTurntable({"--elevation", "90"}), {"--elevation", "90"});
    expectRefusal(wholeTurntable({"--elevation", "high"}), {"--elevation", "high"});
    expectRefusal(wholeTurntable({"--elevation", "nan"}), {"--elevation", "nan"});
    expectRefusal(wholeTurntable({"--distance", "0"}), {"--distance", "from 0.01 to 1000"});
    expectRefusal(wholeTurntable({"--distance", "1001"}), {"--distance", "1001"});
    expectRefusal(wholeTurntable({"--distance", "1,5"}), {"--distance", "1,5"});
    for (const char* target : {"1,2", "1,2,3,4", "1,2,x", "1;2;3", "inf,0,0", "1, 2,3"})
        expectRefusal(wholeTurntable({"--target", target}), {"--target", target});
}

TEST(Arguments, UnknownUpAxisIsRefused) {
    expectRefusal(wholeTurntable({"--up", "x"}), {"--up must be y or z", "x"});
}

TEST(Arguments, NameThatWouldEndItsCommandCannotBeHidden) {
    expectRefusal(wholeTurntable({"--hide", "a\" _Enter"}), {"--hide"});
    expectRefusal(wholeTurntable({"--hide", "a\nExit"}), {"--hide"});
}

TEST(Arguments, ForbiddenCharacterInTheNameIsShown) {
    for (const char character : std::string("\\|/:*?\"<>#%"))
        expectRefusal(wholeTurntable({"--name", std::string("a") + character + "b"}),
                      {std::string("--name must not hold ") + character + ";"});
    for (const char* name : {"a\nb", "a\u009Bb", "a\u2028b"})
        expectRefusal(wholeTurntable({"--name", name}), {"--name must not hold line breaks"});
    expectRefusal(wholeTurntable({"--name", ""}), {"--name must not be empty"});
    expectRefusal(wholeTurntable({"--name", "  "}), {"--name must not be empty"});
    expectRefusal(wholeTurntable({"--name", "a\xFF"}), {"UTF-8"});
}

TEST(Arguments, NameIsTakenUpToTheLengthThatAFileNameHolds) {
    // 255 bytes, less ten digits of a frame number, a point and three letters of an extension.
    EXPECT_EQ(wholeTurntable({"--name", std::string(241, 'n')}).exit_code, 0);
    expectRefusal(wholeTurntable({"--name", std::string(242, 'n')}), {"too long", "241"});
}

TEST(Arguments, PathThatCannotStandInAScriptIsRefused) {
    for (const char* path : {"a\"b.obj", "a\nb.obj", "a\rb.obj", "a\xFF.obj"}) {
        expectRefusal(run({"turntable", path, "--frames", "3", "--out", "out"}),
                      {"the model's path"});
        expectRefusal(run({"turntable", "a.obj", "--frames", "3", "--out", path}),
                      {"the path of --out"});
        expectRefusal(run({"info", path}), {"the model's path"});
    }
}

TEST(Arguments, RefusalRunsNothing) {
    TempFolder folder;
    Start start;
    start.folder = folder.path();
    start.arguments = {"turntable", "house.obj", "--frames", "0", "--out", "out"};
    run(start);
    EXPECT_FALSE(std::filesystem::exists(folder / "out"));
}

} // namespace
} // namespace quarn::test
