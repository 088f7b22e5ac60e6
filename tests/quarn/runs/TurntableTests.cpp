#include "tests/quarn/Pictures.h"
#include "tests/quarn/Studio.h"

#include <algorithm>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <tuple>

namespace quarn::test {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::MatchesRegex;
using testing::Not;
using testing::StartsWith;

class FormatOfPictures : public testing::TestWithParam<const char*> {};

TEST_P(FormatOfPictures, IsTheOneThatWasAskedFor) {
    const std::string format = GetParam();
    const Studio studio;
    const Ended ended = run(studio.turntable(3, {"--format", format, "--size", "80x45"}));
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.err, IsEmpty());
    EXPECT_THAT(ended.out, MatchesRegex("3 frames and out/house\\.html in [0-9.]+ s\n"));
    EXPECT_THAT(filesIn(studio / "out"),
                ElementsAre("house.frames.json", "house.html", "house.recording",
                            "house000." + format, "house001." + format, "house002." + format));
    for (int frame = 0; frame < 3; ++frame) {
        const auto header =
            readPictureHeader(studio / ("out/house00" + std::to_string(frame) + "." + format));
        ASSERT_TRUE(header.has_value());
        EXPECT_EQ(header->format, format);
        EXPECT_EQ(header->width_px, 80);
        EXPECT_EQ(header->height_px, 45);
    }
}

INSTANTIATE_TEST_SUITE_P(Turntable, FormatOfPictures, testing::Values("jpg", "png", "bmp", "tga"));

TEST(Turntable, IsRecordedAtTheSizeOfAScreenByDefault) {
    const Studio studio;
    Start start;
    start.folder = studio.path();
    start.arguments = {"turntable", "house.obj", "--frames", "1", "--out", "out"};
    ASSERT_EQ(run(start).exit_code, 0);
    const auto header = readPictureHeader(studio / "out/house000.jpg");
    ASSERT_TRUE(header.has_value());
    EXPECT_EQ(header->width_px, 1280);
    EXPECT_EQ(header->height_px, 720);
}

TEST(Turntable, OfATargetOutOfRangeShowsTheBackgroundAndIsToldOnce) {
    const Studio studio;
    for (const char* mode : {"Rendered", "Wireframe", "RenderPreview"}) {
        const Ended ended =
            run(studio.turntable(3, {"--target", "1e18,0,0", "--mode", mode, "--size", "48x32"}));
        EXPECT_EQ(ended.exit_code, 0) << mode << ended.err;
        EXPECT_THAT(ended.out, HasSubstr("3 frames and out/house.html"));
        EXPECT_THAT(ended.err, StartsWith("quarn: The camera is out of range: the picture shows"));
        EXPECT_EQ(std::ranges::count(ended.err, '\n'), 1) << ended.err;
        EXPECT_EQ(filesIn(studio / "out").size(), 6U);
    }
}

TEST(Turntable, OfAModelWithAnObjectOutOfRangeShowsTheOthersAndTellsIt) {
    const TempFolder folder;
    Start start;
    start.folder = folder.path();
    for (const char* file : {"far_instance.gltf", "extreme_scales.gltf"}) {
        start.arguments = {"turntable", QUARN_SOURCE_DIR "/tests/data/hostile/" + std::string(file),
                           "--frames",  "2",
                           "--size",    "48x32",
                           "--out",     "out"};
        const Ended ended = run(start);
        EXPECT_EQ(ended.exit_code, 0) << ended.err;
        EXPECT_THAT(ended.err, StartsWith("quarn: Not drawn, because it lies beyond 1e12 units or "
                                          "has an extreme scale: "));
    }
}

TEST(Turntable, OfNothingButWhatIsOutOfRangeIsRefused) {
    const TempFolder folder;
    Start start;
    start.folder = folder.path();
    for (const char* file : {"far_camera.quarn", "huge_coordinates.obj"}) {
        start.arguments = {"turntable", QUARN_SOURCE_DIR "/tests/data/hostile/" + std::string(file),
                           "--frames",  "2",
                           "--size",    "48x32",
                           "--out",     "out"};
        const Ended ended = run(start);
        EXPECT_EQ(ended.exit_code, 1);
        EXPECT_THAT(ended.err, HasSubstr("All that is visible lies too far from the origin"));
    }
}

TEST(Turntable, OfOneFrameIsOnePicture) {
    const Studio studio;
    const Ended ended = run(studio.turntable(1));
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.out, HasSubstr("1 frame and out/house.html"));
    EXPECT_THAT(filesIn(studio / "out"),
                ElementsAre("house.frames.json", "house.html", "house.recording", "house000.jpg"));
}

/// The middle of all that is red, from 0 at the left to 1 at the right.
double middleOfRed(const Picture& picture) {
    double sum = 0.0;
    int count = 0;
    const std::size_t row_bytes = static_cast<std::size_t>(picture.width_px) * 3;
    for (std::size_t i = 0; i + 2 < picture.bytes.size(); i += 3) {
        const auto [blue, green, red] =
            std::tuple(picture.bytes[i], picture.bytes[i + 1], picture.bytes[i + 2]);
        if (red < 64 || red < 2 * std::max(blue, green))
            continue;
        sum += static_cast<double>(i % row_bytes) / static_cast<double>(row_bytes);
        ++count;
    }
    return count > 0 ? sum / count : -1.0;
}

/// Seen from above and turning clockwise, what is in front goes to the left: past six o'clock comes
/// seven.
TEST(TurntableDirection, IsTheWayThatTheModelSeemsToTurn) {
    const Studio studio;
    // A grey plate, and a red post on it on the side of the first camera, at (0.5, -0.87).
    writeFile(studio / "post.mtl", "newmtl grey\nKd 0.5 0.5 0.5\nnewmtl red\nKd 1 0 0\n");
    writeFile(studio / "post.obj", "mtllib post.mtl\nv -2 -2 0\nv 2 -2 0\nv 2 2 0\nv -2 2 0\n"
                                   "usemtl grey\nf 1 2 3\nf 1 3 4\n"
                                   "v 0.4 -0.97 0\nv 0.6 -0.77 0\nv 0.5 -0.87 1.5\nv 0.4 -0.77 0\n"
                                   "usemtl red\nf 5 6 7\nf 6 8 7\nf 8 5 7\n");
    for (const std::string direction : {"clockwise", "anticlockwise"}) {
        const Ended ended =
            run(studio.turntableOf("post.obj", 12,
                                   {"--direction", direction, "--mode", "Shaded", "--format", "bmp",
                                    "--size", "160x120", "--out", direction}));
        ASSERT_EQ(ended.exit_code, 0) << ended.err;
        // The first frame is a step on; the last one is where the camera stood.
        const double at_start = middleOfRed(readBitmap(studio / (direction + "/post011.bmp")));
        const double a_step_on = middleOfRed(readBitmap(studio / (direction + "/post000.bmp")));
        ASSERT_GT(at_start, 0.0);
        if (direction == "clockwise")
            EXPECT_LT(a_step_on, at_start - 0.03);
        else
            EXPECT_GT(a_step_on, at_start + 0.03);
    }
    EXPECT_THAT(run({"turntable", "--help"}).out,
                HasSubstr("Way that the model seems to turn, seen from above"));
}

TEST(Turntable, PageListsThePicturesInTheirOrder) {
    const Studio studio;
    ASSERT_EQ(run(studio.turntable(2, {"--name", "Town hall"})).exit_code, 0);
    const std::string page = readFile(studio / "out/Town hall.html");
    EXPECT_THAT(page, HasSubstr("<TITLE>Town hall</TITLE>"));
    EXPECT_THAT(page, HasSubstr("var ImageCount = 2;"));
    EXPECT_THAT(page, HasSubstr("Images[0].src = \"Town hall000.jpg\"\n"
                                "Images[1].src = \"Town hall001.jpg\"\n"));
}

TEST(Turntable, ShowsTheModelFromSidesThatDiffer) {
    const Studio studio;
    ASSERT_EQ(run(studio.turntable(4, {"--format", "bmp"})).exit_code, 0);
    const Picture first = readBitmap(studio / "out/house000.bmp");
    const Picture second = readBitmap(studio / "out/house001.bmp");
    EXPECT_GT(meanDifference(first, second), 0.02);
}

TEST(Turntable, AnticlockwiseIsTheSameCircleTheOtherWayRound) {
    // Both end at the first view. One step before it, clockwise, is one step after it the other
    // way: frame i of one is frame N-2-i of the other.
    const Studio studio;
    const auto record = [&](const std::string& direction) {
        return run(studio.turntable(
            4, {"--direction", direction, "--name", direction, "--format", "bmp"}));
    };
    ASSERT_EQ(record("clockwise").exit_code, 0);
    ASSERT_EQ(record("anticlockwise").exit_code, 0);
    const auto frame = [&](const std::string& direction, int index) {
        return readBitmap(studio / ("out/" + direction + "00" + std::to_string(index) + ".bmp"));
    };
    EXPECT_GT(meanDifference(frame("clockwise", 0), frame("anticlockwise", 0)), 0.02);
    EXPECT_LT(meanDifference(frame("clockwise", 0), frame("anticlockwise", 2)), 0.002);
    EXPECT_LT(meanDifference(frame("clockwise", 1), frame("anticlockwise", 1)), 0.002);
    EXPECT_LT(meanDifference(frame("clockwise", 3), frame("anticlockwise", 3)), 0.002);
}

TEST(Turntable, ModesDrawDifferentPictures) {
    const Studio studio;
    for (const std::string mode : {"Wireframe", "Shaded", "Rendered"})
        ASSERT_EQ(
            run(studio.turntable(1, {"--mode", mode, "--name", mode, "--format", "bmp"})).exit_code,
            0);
    const auto picture = [&](const std::string& mode) {
        return readBitmap(studio / ("out/" + mode + "000.bmp"));
    };
    EXPECT_GT(meanDifference(picture("Wireframe"), picture("Shaded")), 0.02);
    EXPECT_GT(meanDifference(picture("Shaded"), picture("Rendered")), 0.02);
}

TEST(Turntable, NearerCameraShowsTheModelLarger) {
    const Studio studio;
    const auto record = [&](const std::string& name, const std::string& distance) {
        return run(studio.turntable(
            1, {"--name", name, "--distance", distance, "--format", "bmp", "--mode", "Shaded"}));
    };
    ASSERT_EQ(record("near", "1").exit_code, 0);
    ASSERT_EQ(record("far", "4").exit_code, 0);
    // In Shaded mode the background is one smooth area: the more of the picture the model covers,
    // the more pixels differ from the one left of them.
    const auto steps = [&](const std::string& name) {
        const Picture picture = readBitmap(studio / ("out/" + name + "000.bmp"));
        int count = 0;
        for (std::size_t i = 3; i < picture.bytes.size(); ++i)
            count += std::abs(picture.bytes[i] - picture.bytes[i - 3]) > 8;
        return count;
    };
    EXPECT_GT(steps("near"), 2 * steps("far"));
}

TEST(Turntable, RunAgainReplacesItsFilesAndLeavesOthers) {
    const Studio studio;
    std::filesystem::create_directory(studio / "out");
    writeFile(studio / "out/notes.txt", "mine");
    ASSERT_EQ(run(studio.turntable(3, {"--mode", "Shaded"})).exit_code, 0);
    const std::string shaded = readFile(studio / "out/house001.jpg");
    ASSERT_EQ(run(studio.turntable(3, {"--mode", "Rendered"})).exit_code, 0);
    EXPECT_THAT(readFile(studio / "out/house001.jpg"), Not(shaded));
    EXPECT_EQ(readFile(studio / "out/notes.txt"), "mine");
    EXPECT_THAT(filesIn(studio / "out"),
                ElementsAre("house.frames.json", "house.html", "house.recording", "house000.jpg",
                            "house001.jpg", "house002.jpg", "notes.txt"));
}

TEST(Turntable, SameModelGivesTheSamePictures) {
    const Studio studio;
    ASSERT_EQ(run(studio.turntable(2, {"--out", "a"})).exit_code, 0);
    ASSERT_EQ(run(studio.turntable(2, {"--out", "b"})).exit_code, 0);
    EXPECT_EQ(readFile(studio / "a/house001.jpg"), readFile(studio / "b/house001.jpg"));
}

TEST(Turntable, PathsMayHoldBlanksAndLettersOfAnyLanguage) {
    const Studio studio;
    std::filesystem::create_directory(studio / "Bäume und 家");
    writeHouse(studio / "Bäume und 家/mein Häuschen.obj");
    const Ended ended = run(studio.turntableOf("Bäume und 家/mein Häuschen.obj", 2,
                                               {"--out", "neue Bilder/hier drin"}));
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(filesIn(studio / "neue Bilder/hier drin"),
                ElementsAre("mein Häuschen.frames.json", "mein Häuschen.html",
                            "mein Häuschen.recording", "mein Häuschen000.jpg",
                            "mein Häuschen001.jpg"));
    EXPECT_THAT(readFile(studio / "neue Bilder/hier drin/mein Häuschen.html"),
                HasSubstr("<TITLE>mein Häuschen</TITLE>"));
}

TEST(Turntable, NamesThatAnswerPromptsStayNames) {
    const Studio studio;
    writeHouse(studio / "_Enter.obj");
    std::filesystem::create_directory(studio / "_Cancel");
    const Ended ended = run(studio.turntableOf("_Enter.obj", 1, {"--out", "_Cancel"}));
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(filesIn(studio / "_Cancel"), ElementsAre("_Enter.frames.json", "_Enter.html",
                                                         "_Enter.recording", "_Enter000.jpg"));
}

TEST(Turntable, RecordsTheSameInALocaleWithADecimalComma) {
    const Studio studio;
    const std::string make_locale =
        "localedef -i de_DE -f UTF-8 '" + (studio / "de_DE.UTF-8").string() + "' >/dev/null 2>&1";
    ASSERT_EQ(std::system(make_locale.c_str()), 0) << "needs the package `locales`";
    const std::vector<std::string> options = {"--distance",    "1.5",        "--target",
                                              "1.25,0.5,0.75", "--language", "en"};
    Start with_point = studio.turntable(2, options);
    Start with_comma = studio.turntable(2, options);
    with_comma.environment = {{"LOCPATH", studio.path()}, {"LC_ALL", "de_DE.UTF-8"}};
    with_comma.arguments[5] = "comma"; // --out
    ASSERT_EQ(run(with_point).exit_code, 0);
    const Ended ended = run(with_comma);
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.out,
                MatchesRegex("2 frames and comma/house\\.html in [0-9]+(\\.[0-9]+)? s\n"));
    EXPECT_EQ(readFile(studio / "out/house001.jpg"), readFile(studio / "comma/house001.jpg"));
}

TEST(Turntable, VerboseShowsWhatTheHostPrints) {
    const Studio studio;
    const Ended quiet = run(studio.turntable(1));
    const Ended verbose = run(studio.turntable(1, {"--verbose"}));
    ASSERT_EQ(verbose.exit_code, 0) << verbose.err;
    EXPECT_THAT(linesOf(quiet.out), testing::SizeIs(1));
    EXPECT_GT(linesOf(verbose.out).size(), 1U);
}

TEST(Turntable, ShownScriptRunsAsItIs) {
    const Studio studio;
    Start show = studio.turntable(2, {"--format", "png"});
    show.arguments.push_back("--show-script");
    writeFile(studio / "steps.txt", run(show).out);
    std::filesystem::create_directory(studio / "out");
    Start start;
    start.folder = studio.path();
    start.arguments = {"run", "steps.txt"};
    const Ended ended = run(start);
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(filesIn(studio / "out"),
                ElementsAre("house.frames.json", "house.html", "house.recording", "house000.png",
                            "house001.png"));
}

} // namespace
} // namespace quarn::test
