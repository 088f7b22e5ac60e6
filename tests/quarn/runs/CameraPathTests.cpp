#include "tests/quarn/Pictures.h"
#include "tests/quarn/Studio.h"

#include <csignal>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::SizeIs;

/// A house with two curves beside it: "Front walk" passes it, "Ring" goes round it.
class Street {
public:
    Street() {
        writeFile(m_studio / "street.obj",
                  readFile(m_studio / "house.obj") +
                      "o Front_walk\nv -6 -4 1\nv 0 -5 1\nv 6 -4 1\nv 7 -3 1\nl 17 18 19 20\n"
                      "o Ring\nv -5 -5 3\nv 9 -5 3\nv 9 7 3\nv -5 7 3\nl 21 22 23 24 21\n");
    }

    Ended run(std::vector<std::string> arguments) const {
        return test::run(start(std::move(arguments)));
    }

    /// `quarn COMMAND street.obj` with small bitmaps.
    Ended record(const std::string& command, int frames, const std::vector<std::string>& options,
                 const std::string& folder = "out") const {
        std::vector<std::string> arguments = {
            command, "street.obj", "--out", folder,     "--size",
            "96x64", "--format",   "bmp",   "--frames", std::to_string(frames)};
        arguments.insert(arguments.end(), options.begin(), options.end());
        return run(arguments);
    }

    Start start(std::vector<std::string> arguments) const {
        Start start;
        start.folder = m_studio.path();
        start.arguments = std::move(arguments);
        return start;
    }

    Picture picture(const std::string& name) const { return readBitmap(m_studio / name); }
    std::filesystem::path operator/(const std::filesystem::path& name) const {
        return m_studio / name;
    }

private:
    Studio m_studio;
};

void expectFailure(const Ended& ended, const std::vector<std::string>& words) {
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.out, IsEmpty());
    EXPECT_THAT(linesOf(ended.err), SizeIs(1)) << ended.err;
    for (const std::string& word : words)
        EXPECT_THAT(ended.err, HasSubstr(word));
}

// ---- quarn curves

TEST(Curves, AreListedWithKindLengthAndPoints) {
    const Street street;
    const Ended ended = street.run({"curves", "street.obj", "--language", "en"});
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    // sqrt(37) + sqrt(37) + sqrt(2); twice 14 and twice 12
    EXPECT_THAT(linesOf(ended.out),
                ElementsAre("Front_walk  polyline, length 13.5797, open, 4 points",
                            "Ring  polyline, length 52, closed, 4 points"));
    const Ended none = street.run({"curves", "house.obj"});
    EXPECT_EQ(none.exit_code, 0);
    EXPECT_EQ(none.out, "There is no curve and no point.\n");
    expectFailure(street.run({"curves", "missing.obj"}), {"missing.obj"});
}

// ---- Recordings

TEST(Flythrough, WritesEveryFrameAndThePage) {
    const Street street;
    const Ended ended = street.record("flythrough", 6, {"--path", "Front_walk"});
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.out, HasSubstr("6 frames and out/street.html in "));
    EXPECT_THAT(filesIn(street / "out"),
                ElementsAre("street.frames.json", "street.html", "street.recording",
                            "street000.bmp", "street001.bmp", "street002.bmp", "street003.bmp",
                            "street004.bmp", "street005.bmp"));
    EXPECT_GT(
        meanDifference(street.picture("out/street000.bmp"), street.picture("out/street003.bmp")),
        0.01);
}

TEST(Flythrough, AlongACurveFileIsTheOneAlongTheSameCurveInTheModel) {
    const Street street;
    writeFile(street / "walk.txt", "-6 -4 1\n0,-5,1\n6 -4 1\n7 -3 1\n");
    ASSERT_EQ(street.record("flythrough", 4, {"--path", "front_walk", "--hide", "Ring"}).exit_code,
              0);
    // What the camera follows is not in the pictures; every other curve is.
    const Ended ended = street.record(
        "flythrough", 4, {"--camera-curve", "walk.txt", "--hide", "Ring", "--hide", "Front_walk"},
        "filed");
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    for (const char* name : {"street000.bmp", "street001.bmp", "street003.bmp"})
        EXPECT_TRUE(readFile(street / "out" / name) == readFile(street / "filed" / name)) << name;
    EXPECT_GT(readFile(street / "out/street001.bmp").size(), 1000u);
}

/// Three points in a row, of which the first two lie close together: by its parameter the camera
/// needs as long for the first tenth of the way as for the rest.
TEST(Flythrough, AtEvenSpeedTakesEquallyLongSteps) {
    const Street street;
    writeFile(street / "uneven.txt", "degree 1\n-8 -6 1\n-7 -6 1\n2 -6 1\n");
    writeFile(street / "even.txt", "-8 -6 1\n-3 -6 1\n2 -6 1\n");
    const auto record = [&](const char* folder, std::vector<std::string> options) {
        options.insert(options.begin(), "--camera-curve");
        return street.record("flythrough", 2, options, folder).exit_code;
    };
    ASSERT_EQ(record("wanted", {"even.txt"}), 0);
    ASSERT_EQ(record("evened", {"uneven.txt", "--even-speed"}), 0);
    ASSERT_EQ(record("uneven", {"uneven.txt"}), 0);
    const Picture wanted = street.picture("wanted/street001.bmp");
    EXPECT_LT(meanDifference(wanted, street.picture("evened/street001.bmp")), 0.001);
    EXPECT_GT(meanDifference(wanted, street.picture("uneven/street001.bmp")), 0.005);
}

TEST(CameraPath, RoundARingLooksAtOnePoint) {
    const Street street;
    const Ended ended = street.record("path", 4, {"--camera", "Ring", "--target-point", "2,1,1"});
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(filesIn(street / "out"), SizeIs(7));
    EXPECT_GT(
        meanDifference(street.picture("out/street000.bmp"), street.picture("out/street002.bmp")),
        0.01);
}

TEST(CameraPath, FromOnePlaceLooksAlongACurve) {
    const Street street;
    writeFile(street / "eaves.json", R"({"degree": 2, "points": [[0,2,1],[2,2,3],[4,2,1]]})");
    const Ended ended = street.record(
        "path", 3, {"--camera-point", "2,-8,2", "--target-curve", "eaves.json", "--save", "look"});
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(filesIn(street / "out"), SizeIs(6));
    EXPECT_EQ(street.run({"curves", "look.quarn"}).out,
              "Front_walk  polyline, length 13.5797, open, 4 points\n"
              "Ring  polyline, length 52, closed, 4 points\n"
              "Camera point  point at 2,-8,2\n"
              "Target curve  NURBS curve, length 4.59117, open, 3 points\n");
    const Ended frame = street.run({"frame", "look.quarn", "--number", "2", "--out", "again.bmp"});
    ASSERT_EQ(frame.exit_code, 0) << frame.err;
    EXPECT_TRUE(readFile(street / "again.bmp") == readFile(street / "out/street002.bmp"));
    EXPECT_EQ(street.picture("again.bmp").width_px, 96);
}

TEST(CameraPath, OfASavedDocumentIsSetUpAnewWithOtherFiles) {
    const Street street;
    writeFile(street / "near.txt", "0 -5 1\n4 -5 1\n");
    writeFile(street / "far.txt", "0 -9 1\n8 -9 1\n8 -3 1\n");
    const auto record = [&](const char* model, const char* file, const char* target) {
        return street.run({"path", model, "--camera-curve", file, "--target-point", target,
                           "--frames", "2", "--out", "out", "--size", "64x48", "--save", "way"});
    };
    ASSERT_EQ(record("street.obj", "near.txt", "2,1,1").exit_code, 0);
    const Ended again = record("way.quarn", "far.txt", "1,1,3");
    ASSERT_EQ(again.exit_code, 0) << again.err;
    const std::string curves = street.run({"curves", "way.quarn"}).out;
    EXPECT_THAT(curves, HasSubstr("Camera curve  polyline, length 14, open, 3 points\n"));
    EXPECT_THAT(curves, HasSubstr("Target point  point at 1,1,3\n"));
    EXPECT_THAT(linesOf(curves), SizeIs(4));
}

TEST(CameraPath, FollowsNamesWithBlanks) {
    const Street street;
    writeFile(street / "rename.txt", "_-Rename Ring \"The long ring\"\n"
                                     "_-Rename Front_walk \"Walk at the front\"\n"
                                     "_-SaveAs \"named.quarn\"\n");
    ASSERT_EQ(street.run({"run", "rename.txt", "street.obj"}).exit_code, 0);
    const Ended ended =
        street.run({"path", "named.quarn", "--camera", "The long ring", "--target",
                    "Walk at the front", "--frames", "2", "--out", "out", "--size", "64x48"});
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(filesIn(street / "out"), SizeIs(5));
}

TEST(CameraPath, OfOneFrameIsAPicture) {
    const Street street;
    const Ended ended = street.record("flythrough", 1, {"--path", "Front_walk"});
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(filesIn(street / "out"), ElementsAre("street.frames.json", "street.html",
                                                     "street.recording", "street000.bmp"));
}

TEST(CameraPath, IsStoppedAfterAWholePicture) {
    const Street street;
    RunningProgram program(street.start({"flythrough", "street.obj", "--path", "Ring", "--frames",
                                         "100000", "--out", "out", "--size", "64x48"}));
    ASSERT_TRUE(
        program.waitUntil([&] { return std::filesystem::exists(street / "out/street002.jpg"); }));
    program.sendSignal(SIGINT);
    const Ended ended = program.wait();
    EXPECT_EQ(ended.exit_code, 130);
    EXPECT_THAT(ended.err, HasSubstr("of 100000 frames; out/street.html plays what is there."));
    EXPECT_THAT(filesIn(street / "out"), Contains("street.html"));
}

// ---- What cannot be followed

TEST(CameraPath, NamesWhatIsNotThere) {
    const Street street;
    expectFailure(street.record("flythrough", 4, {"--path", "Back walk"}), {"Back walk"});
    expectFailure(street.record("path", 4, {"--camera", "Ring", "--target", "Moon"}), {"Moon"});
    EXPECT_FALSE(std::filesystem::exists(street / "out"));
}

TEST(CameraPath, DoesNotFollowAMesh) {
    const Street street;
    expectFailure(street.record("flythrough", 4, {"--path", "tower"}), {"tower", "mesh"});
    expectFailure(street.record("path", 4, {"--camera", "Ring", "--target", "tower"}),
                  {"tower", "mesh"});
}

TEST(CameraPath, FlythroughDoesNotFollowAPoint) {
    const Street street;
    writeFile(street / "point.txt", "_-Point _Name \"Here\" 1,2,3\n_-SaveAs \"p.quarn\"\n");
    ASSERT_EQ(street.run({"run", "point.txt", "street.obj"}).exit_code, 0);
    expectFailure(
        street.run({"flythrough", "p.quarn", "--path", "Here", "--frames", "3", "--out", "out"}),
        {"Here", "point"});
}

TEST(CameraPath, TellsWhatIsWrongWithACurveFile) {
    const Street street;
    writeFile(street / "nan.txt", "0 0 0\n1 nan 0\n");
    writeFile(street / "one.txt", "0 0 0\n");
    writeFile(street / "empty.txt", "");
    writeFile(street / "still.txt", "1 1 1\n1 1 1\n");
    writeFile(street / "cut.json", "{\"points\": [[0,0,0],");
    for (const char* file :
         {"nan.txt", "one.txt", "empty.txt", "still.txt", "cut.json", "missing.txt"})
        expectFailure(street.record("flythrough", 4, {"--camera-curve", file}), {file});
    expectFailure(street.record("path", 4, {"--camera", "Ring", "--target-curve", "nan.txt"}),
                  {"nan.txt", "line 2"});
    EXPECT_FALSE(std::filesystem::exists(street / "out"));
}

} // namespace
} // namespace quarn::test
