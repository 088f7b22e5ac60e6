#include "tests/quarn/Pictures.h"
#include "tests/quarn/Studio.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

const std::filesystem::path PAGE = std::filesystem::path(QUARN_SOURCE_DIR) / "docs/farm.md";

/// The block of the page in this language, with its tabs.
std::string block(const std::string& language) {
    const std::string text = readFile(PAGE);
    const std::string start = "```" + language + "\n";
    const std::size_t from = text.find(start);
    EXPECT_NE(from, std::string::npos) << language;
    return text.substr(from + start.size(),
                       text.find("```", from + start.size()) - from - start.size());
}

Start program(const std::string& name, const Studio& studio, std::vector<std::string> words) {
    Start start;
    start.program = name;
    start.folder = studio.path();
    start.arguments = std::move(words);
    return start;
}

TEST(FarmPage, LinesForTheShellAreWellFormed) {
    const Studio studio;
    writeFile(studio / "lines.sh", block("bash"));
    const Ended ended = run(program("/bin/bash", studio, {"-n", "lines.sh"}));
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
}

TEST(FarmPage, MakefileOnItMakesTheSameFilesAsOneRecording) {
    if (!std::filesystem::exists("/usr/bin/make"))
        GTEST_SKIP() << "there is no make here";
    const Studio studio;
    ASSERT_EQ(run(studio.turntable(4, {"--save", "house", "--out", "whole"})).exit_code, 0);
    writeFile(studio / "Makefile", block("make"));
    const Ended made = run(program(
        "/usr/bin/make", studio, {"-j2", std::string("QUARN=") + QUARN_PROGRAM, "PARTS=0-1 2-3"}));
    EXPECT_EQ(made.exit_code, 0) << made.out << made.err;
    for (const char* const name : {"house000.jpg", "house003.jpg", "house.html"})
        EXPECT_EQ(readFile(studio / "out" / name), readFile(studio / "whole" / name)) << name;
    EXPECT_GT(readFile(studio / "out/house003.jpg").size(), 500u);
}

} // namespace
} // namespace quarn::test
