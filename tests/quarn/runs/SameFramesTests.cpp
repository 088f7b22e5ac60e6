#include "tests/quarn/Pictures.h"
#include "tests/quarn/Studio.h"
#include "tests/quarn/models/CaptureWays.h"

#include <cstdlib>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::SizeIs;

constexpr int frames = 4;

/// The bytes of the frames, of their list and of the page of a turntable, one file after the other.
std::vector<std::string> recorded(const Start& start, const std::filesystem::path& folder) {
    const Ended ended = run(start);
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    std::vector<std::string> contents;
    for (const std::string& name : filesIn(folder))
        if (!name.ends_with(".recording"))
            contents.push_back(readFile(folder / name));
    EXPECT_THAT(contents, SizeIs(frames + 2));
    return contents;
}

/// Turntables of one model in a display mode, or rendered.
class SameFrames : public testing::TestWithParam<const char*> {
protected:
    Start turntable(const std::string& out) const {
        const bool is_rendered =
            std::string(GetParam()).starts_with("Render") && std::string(GetParam()) != "Rendered";
        return studio.turntable(frames, {"--mode", GetParam(), "--format", "png", "--size",
                                         is_rendered ? "61x40" : "160x100", "--out", out});
    }
    std::vector<std::string> recordedInto(const std::string& out) const {
        return recorded(turntable(out), studio / out);
    }
    /// The same command by way of a shell.
    static Start byShell(Start start, const std::string& before) {
        std::string line = before + " '" + start.program.string() + "'";
        for (const std::string& argument : start.arguments)
            line += " '" + argument + "'";
        start.program = "/bin/sh";
        start.arguments = {"-c", line};
        return start;
    }

    const Studio studio;
};

TEST_P(SameFrames, ComeFromASecondRun) {
    EXPECT_EQ(recordedInto("a"), recordedInto("b"));
}

TEST_P(SameFrames, ComeFromOneProcessorAndFromAll) {
    const Start alone = byShell(turntable("alone"), "taskset -c 0");
    EXPECT_EQ(recorded(alone, studio / "alone"), recordedInto("together"));
}

TEST_P(SameFrames, ComeWhereverTheProgramIsStarted) {
    const TempFolder elsewhere;
    Start start = turntable((studio / "far").string());
    start.folder = elsewhere.path();
    start.arguments[1] = (studio / "house.obj").string();
    EXPECT_EQ(recorded(start, studio / "far"), recordedInto("near"));
}

TEST_P(SameFrames, ComeWhereNumbersHaveADecimalComma) {
    const std::string make_locale =
        "localedef -i de_DE -f UTF-8 '" + (studio / "de_DE.UTF-8").string() + "' >/dev/null 2>&1";
    ASSERT_EQ(std::system(make_locale.c_str()), 0);
    // The page is in the language of the person, the frames are not.
    Start with_comma = turntable("comma");
    with_comma.arguments.insert(with_comma.arguments.end(), {"--language", "en"});
    with_comma.environment = {{"LOCPATH", studio.path()}, {"LC_ALL", "de_DE.UTF-8"}};
    EXPECT_EQ(recorded(with_comma, studio / "comma"), recordedInto("point"));
}

INSTANTIATE_TEST_SUITE_P(Modes, SameFrames, everyWayOfCapture(), nameOfWay);

} // namespace
} // namespace quarn::test
