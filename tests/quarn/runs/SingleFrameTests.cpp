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
using testing::Not;
using testing::SizeIs;

Start inStudio(const Studio& studio, std::vector<std::string> arguments) {
    Start start;
    start.folder = studio.path();
    start.arguments = std::move(arguments);
    return start;
}

// ---- --save

TEST(SavedDocument, HoldsTheModelAndTheAnimationForANewProcess) {
    const Studio studio;
    const Ended recorded = run(studio.turntable(5, {"--save", "house"}));
    ASSERT_EQ(recorded.exit_code, 0) << recorded.err;
    const Ended info = run(inStudio(studio, {"info", "house.quarn"}));
    EXPECT_EQ(info.exit_code, 0) << info.err;
    EXPECT_THAT(info.out, HasSubstr("tower  mesh"));

    // Recorded again from the document alone, the pictures are the same files.
    writeFile(studio / "again.txt", "_-RecordAnimation _TargetFolder \"again\" _Enter\n");
    std::filesystem::create_directory(studio / "again");
    const Ended again = run(inStudio(studio, {"run", "again.txt", "house.quarn"}));
    ASSERT_EQ(again.exit_code, 0) << again.err << again.out;
    for (const char* name :
         {"house000.jpg", "house001.jpg", "house002.jpg", "house003.jpg", "house004.jpg"})
        EXPECT_EQ(readFile(studio / "again" / name), readFile(studio / "out" / name)) << name;
    EXPECT_GT(readFile(studio / "out/house000.jpg").size(), 500u);
}

TEST(SavedDocument, IsPartOfTheScript) {
    const Studio studio;
    const Ended shown = run(studio.turntable(5, {"--save", "my docs/house", "--show-script"}));
    ASSERT_EQ(shown.exit_code, 0) << shown.err;
    const auto lines = linesOf(shown.out);
    ASSERT_THAT(lines, SizeIs(10));
    EXPECT_EQ(lines[7], "_-SaveAs \"my docs/house.quarn\"");
    EXPECT_THAT(lines[9], HasSubstr("_-RecordAnimation"));
}

TEST(SavedDocument, IsRefusedUnderAnotherExtensionBeforeAnythingRuns) {
    const Studio studio;
    for (const char* document : {"house.obj", "house.", "", "docs/", "a\"b.quarn"}) {
        const Ended ended = run(studio.turntable(5, {"--save", document}));
        EXPECT_EQ(ended.exit_code, 2) << document;
        EXPECT_THAT(linesOf(ended.err), SizeIs(1));
        EXPECT_THAT(ended.err, HasSubstr("--save"));
    }
    EXPECT_THAT(filesIn(studio.path()), ElementsAre("house.obj"));
}

TEST(SavedDocument, ThatCannotBeWrittenEndsTheRunBeforeTheRecording) {
    const Studio studio;
    const Ended ended = run(studio.turntable(5, {"--save", "nowhere/house.quarn"}));
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(linesOf(ended.err), SizeIs(1));
    EXPECT_THAT(ended.err, HasSubstr("nowhere"));
    EXPECT_THAT(filesIn(studio / "out"), IsEmpty());
}

TEST(SavedDocument, IsKeptWhenTheRecordingIsStopped) {
    const Studio studio;
    RunningProgram program(studio.turntable(100000, {"--save", "house.quarn"}));
    ASSERT_TRUE(
        program.waitUntil([&] { return std::filesystem::exists(studio / "out/house002.jpg"); }));
    program.sendSignal(SIGINT);
    EXPECT_EQ(program.wait().exit_code, 130);
    const Ended frame =
        run(inStudio(studio, {"frame", "house.quarn", "--number", "99999", "--out", "last.jpg"}));
    EXPECT_EQ(frame.exit_code, 0) << frame.err;
}

// ---- Documents as models

TEST(Document, IsOpenedWhereAModelIsTaken) {
    const Studio studio;
    ASSERT_EQ(run(studio.turntable(3, {"--save", "house.quarn"})).exit_code, 0);
    writeFile(studio / "list.txt", "_-List\n");
    EXPECT_THAT(run(inStudio(studio, {"run", "list.txt", "house.quarn"})).out,
                HasSubstr("tower  mesh"));
    Start console = inStudio(studio, {"console", "house.quarn"});
    console.input = "List\n";
    EXPECT_THAT(run(console).out, HasSubstr("tower  mesh"));
    const Ended turned = run(studio.turntableOf("house.quarn", 3, {"--out", "turned"}));
    ASSERT_EQ(turned.exit_code, 0) << turned.err;
    EXPECT_EQ(readFile(studio / "turned/house001.jpg"), readFile(studio / "out/house001.jpg"));
    const Ended axis = run(studio.turntableOf("house.quarn", 3, {"--up", "y"}));
    EXPECT_EQ(axis.exit_code, 2);
    EXPECT_THAT(axis.err, HasSubstr("--up"));
}

TEST(Document, ThatIsDamagedIsTold) {
    const Studio studio;
    writeFile(studio / "bad.quarn", "no document at all");
    for (const std::vector<std::string>& arguments :
         {std::vector<std::string>{"info", "bad.quarn"},
          {"frame", "bad.quarn", "--number", "0", "--out", "a.png"},
          {"frame", "missing.quarn", "--number", "0", "--out", "a.png"}}) {
        const Ended ended = run(inStudio(studio, arguments));
        EXPECT_EQ(ended.exit_code, 1);
        EXPECT_THAT(linesOf(ended.err), SizeIs(1));
        EXPECT_THAT(ended.err, HasSubstr(arguments[1]));
    }
}

// ---- quarn frame

/// A document with an animation of five frames, and the frames as they were recorded.
class SingleFrame : public testing::Test {
protected:
    static void SetUpTestSuite() {
        s_studio = new Studio;
        const Ended recorded =
            run(s_studio->turntable(5, {"--save", "house.quarn", "--format", "png"}));
        ASSERT_EQ(recorded.exit_code, 0) << recorded.err;
    }
    static void TearDownTestSuite() {
        delete s_studio;
        s_studio = nullptr;
    }

    static Ended frame(const std::vector<std::string>& options) {
        std::vector<std::string> arguments = {"frame", "house.quarn"};
        arguments.insert(arguments.end(), options.begin(), options.end());
        return run(inStudio(*s_studio, arguments));
    }

    static Studio* s_studio;
};

Studio* SingleFrame::s_studio = nullptr;

TEST_F(SingleFrame, IsTheFileThatTheRecordingWrote) {
    for (const char* number : {"0", "3", "4"}) {
        const Ended ended = frame({"--number", number, "--out", "single.png"});
        ASSERT_EQ(ended.exit_code, 0) << ended.err;
        EXPECT_THAT(linesOf(ended.out), SizeIs(1));
        EXPECT_EQ(readFile(*s_studio / "single.png"),
                  readFile(*s_studio / ("out/house00" + std::string(number) + ".png")))
            << number;
        const Ended sized = frame({"--number", number, "--size", "64x48", "--out", "sized.png"});
        ASSERT_EQ(sized.exit_code, 0) << sized.err;
        EXPECT_EQ(readFile(*s_studio / "sized.png"), readFile(*s_studio / "single.png"));
    }
    EXPECT_NE(readFile(*s_studio / "out/house003.png"), readFile(*s_studio / "out/house004.png"));
    EXPECT_GT(readFile(*s_studio / "out/house003.png").size(), 500u);
}

// ---- What help says of frames that are other pictures than those of the recording

TEST(SingleFrameHelp, NamesTheViewsWhoseFramesAreOtherPictures) {
    const std::string help = run({"frame", "--help"}).out;
    EXPECT_THAT(help, HasSubstr("straight above or below its target"));
    EXPECT_THAT(help, HasSubstr("tilted\nhorizon"));
    EXPECT_THAT(help, HasSubstr("takes no direction for it as pointing up"));
}

/// Which of the frames 0, 1, ... of a document are the files that its recording wrote.
std::vector<bool> sameFrames(const Studio& studio, const std::string& document,
                             const std::vector<std::string>& recorded) {
    std::vector<bool> same;
    for (std::size_t i = 0; i < recorded.size(); ++i) {
        const Ended ended = run(inStudio(
            studio, {"frame", document, "--number", std::to_string(i), "--out", "single.png"}));
        EXPECT_EQ(ended.exit_code, 0) << ended.err;
        same.push_back(readFile(studio / "single.png") == readFile(studio / recorded[i]));
    }
    return same;
}

TEST(SingleFrameOfACamera, StraightAboveItsTargetIsAnotherPictureThanTheRecorded) {
    const Studio studio;
    writeFile(studio / "arc.txt", "-5 0 5\n0 0 8\n5 0 5\n");
    const Ended recorded =
        run(inStudio(studio, {"path", "house.obj", "--camera-curve", "arc.txt", "--target-point",
                              "0,0,0", "--frames", "3", "--size", "64x48", "--format", "png",
                              "--out", "arc", "--save", "arc"}));
    ASSERT_EQ(recorded.exit_code, 0) << recorded.err;
    EXPECT_THAT(sameFrames(studio, "arc.quarn",
                           {"arc/house000.png", "arc/house001.png", "arc/house002.png"}),
                ElementsAre(true, false, true));
}

TEST(SingleFrameOfACamera, WithATiltedHorizonIsAnotherPictureThanTheRecorded) {
    // A camera that is rolled by 30 degrees, at (0, 1, 20) with Y up.
    const std::string tilted =
        R"({"asset":{"version":"2.0"},"scene":0,"scenes":[{"nodes":[0,1]}],)"
        R"("nodes":[{"name":"Roof","mesh":0},{"name":"Tilted","camera":0,)"
        R"("translation":[0,1,20],"rotation":[0,0,0.258819,0.965926]}],)"
        R"("cameras":[{"type":"perspective","perspective":{"yfov":0.8,"znear":0.1}}],)"
        R"("meshes":[{"primitives":[{"attributes":{"POSITION":0}}]}],)"
        R"("accessors":[{"bufferView":0,"componentType":5126,"count":3,"type":"VEC3",)"
        R"("min":[0,0,0],"max":[4,4,3]}],"bufferViews":[{"buffer":0,"byteLength":36}],)"
        R"("buffers":[{"byteLength":36,"uri":"data:application/octet-stream;base64,)"
        R"(AAAAAAAAAAAAAAAAAACAQAAAAAAAAAAAAAAAAAAAgEAAAEBA"}]})";
    const Studio studio;
    writeFile(studio / "tilted.gltf", tilted);
    std::filesystem::create_directory(studio / "tilted");
    writeFile(studio / "steps.txt",
              "_-ViewportSize 64 48\n_-StandardView Tilted\n"
              "_-SetTurntableAnimation 3 _Clockwise _png _Shaded _Enter _Enter\n"
              "_-AnimationName T\n_-SaveAs tilted.quarn\n"
              "_-RecordAnimation _TargetFolder tilted _Enter\n");
    const Ended recorded = run(inStudio(studio, {"run", "steps.txt", "tilted.gltf"}));
    ASSERT_EQ(recorded.exit_code, 0) << recorded.err;
    EXPECT_THAT(sameFrames(studio, "tilted.quarn",
                           {"tilted/T000.png", "tilted/T001.png", "tilted/T002.png"}),
                Not(ElementsAre(true, true, true)));
}

TEST_F(SingleFrame, HasTheSizeThatIsAskedFor) {
    const Ended ended = frame({"--number", "2", "--size", "200x100", "--out", "wide.bmp"});
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    const Picture picture = readBitmap(*s_studio / "wide.bmp");
    EXPECT_EQ(picture.width_px, 200);
    EXPECT_EQ(picture.height_px, 100);
}

TEST_F(SingleFrame, ShowsItsScript) {
    EXPECT_EQ(frame({"--number", "2", "--size", "20x10", "--out", "a b.png", "--show-script"}).out,
              "_-Open \"house.quarn\"\n_-SaveFrame _Size 20 10 2 \"a b.png\"\n");
    EXPECT_EQ(frame({"--number", "+0", "--out", "a.png", "--show-script"}).out,
              "_-Open \"house.quarn\"\n_-SaveFrame 0 \"a.png\"\n");
}

TEST_F(SingleFrame, RefusesNumbersThatAreNoFrame) {
    struct Case {
        const char* number;
        int exit_code;
    };
    for (const auto& [number, exit_code] :
         {Case{"-1", 2}, Case{"two", 2}, Case{"", 2}, Case{"1.5", 2}, Case{"2147483648", 2},
          Case{"-2147483648", 2}, Case{"5", 1}, Case{"2147483647", 1}}) {
        const Ended ended = frame({"--number", number, "--out", "never.png"});
        EXPECT_EQ(ended.exit_code, exit_code) << number;
        EXPECT_THAT(linesOf(ended.err), SizeIs(1)) << ended.err;
        EXPECT_THAT(ended.err, HasSubstr(number));
        EXPECT_THAT(ended.out, IsEmpty());
    }
    EXPECT_THAT(frame({"--number", "5", "--out", "never.png"}).err, HasSubstr("from 0 to 4"));
    EXPECT_THAT(filesIn(s_studio->path()), Not(Contains("never.png")));
}

TEST_F(SingleFrame, RefusesFilesAndSizesThatCannotBe) {
    const std::vector<std::string> before = filesIn(s_studio->path());
    struct Case {
        std::vector<std::string> options;
        const char* told;
    };
    for (const Case& bad :
         {Case{{"--out", "frame.gif"}, ".png"}, Case{{"--out", "frame"}, ".png"},
          Case{{"--out", "nowhere/a.png"}, "nowhere"}, Case{{"--out", "a\"b.png"}, "double quote"},
          Case{{"--out", "a.png", "--size", "0x4"}, "--size"},
          Case{{"--out", "a.png", "--size", "16385x4"}, "--size"},
          Case{{"--out", "a.png", "--size", "4"}, "--size"},
          Case{{"--out", "a.png", "--fast"}, "--fast"}, Case{{}, "--out"}}) {
        std::vector<std::string> options = {"--number", "1"};
        options.insert(options.end(), bad.options.begin(), bad.options.end());
        const Ended ended = frame(options);
        EXPECT_THAT(ended.exit_code, testing::AnyOf(1, 2)) << ended.out;
        EXPECT_THAT(linesOf(ended.err), SizeIs(1)) << ended.err;
        EXPECT_THAT(ended.err, HasSubstr(bad.told));
    }
    EXPECT_EQ(filesIn(s_studio->path()), before);
}

TEST_F(SingleFrame, NeedsADocumentWithAnAnimation) {
    writeFile(*s_studio / "plain.txt", "_-SaveAs \"plain.quarn\"\n");
    ASSERT_EQ(run(inStudio(*s_studio, {"run", "plain.txt", "house.obj"})).exit_code, 0);
    const Ended plain =
        run(inStudio(*s_studio, {"frame", "plain.quarn", "--number", "0", "--out", "a.png"}));
    EXPECT_EQ(plain.exit_code, 1);
    EXPECT_THAT(plain.err, HasSubstr("no animation"));
    EXPECT_THAT(linesOf(plain.err), SizeIs(1));
    const Ended model =
        run(inStudio(*s_studio, {"frame", "house.obj", "--number", "0", "--out", "a.png"}));
    EXPECT_EQ(model.exit_code, 2);
    EXPECT_THAT(model.err, HasSubstr("house.obj is no document"));
}

} // namespace
} // namespace quarn::test
