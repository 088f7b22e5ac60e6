#include "tests/quarn/Pictures.h"
#include "tests/quarn/Studio.h"
#include "tests/quarn/pages/DocsPage.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::Contains;
using testing::PrintToString;
using testing::SizeIs;

constexpr const char* PAGE = "docs/sun-studies.md";

std::vector<std::string> shownScript(std::vector<std::string> arguments) {
    arguments.push_back("--show-script");
    const Ended ended = run(arguments);
    EXPECT_EQ(ended.exit_code, 0) << PrintToString(arguments) << "\n" << ended.err;
    return linesOf(ended.out);
}

/// The notes that a recording tells first, as a block of the page has them.
std::vector<std::string> notesOf(const std::vector<std::string>& arguments) {
    std::vector<std::string> notes;
    for (const std::string& line : shownScript(arguments))
        if (line.starts_with("# ") && notes.size() < 3)
            notes.push_back(line.substr(2));
    return notes;
}

TEST(SunStudiesPage, PlacesOnItAreThoseThatAreListed) {
    const auto questions = commandsOn(PAGE, {"places"});
    ASSERT_THAT(questions, SizeIs(1));
    std::vector<std::string> block = linesOf(run(questions.front()).out);
    block.insert(block.begin(), "$ quarn places greece");
    EXPECT_THAT(fencedBlocks(PAGE), Contains(block));
}

TEST(SunStudiesPage, NotesOnItAreThoseThatAreTold) {
    EXPECT_THAT(fencedBlocks(PAGE), Contains(notesOf(commandsOn(PAGE, {"day"}).front())));
    EXPECT_THAT(
        fencedBlocks(PAGE),
        Contains(notesOf({"season", "house.obj", "--latitude", "39.74", "--longitude", "-105.18",
                          "--from", "2026-03-22", "--to", "2026-12-22", "--out", "west"})));
}

TEST(SunStudiesPage, ClocksOnItAreThoseThatAreTold) {
    // City, and what the page says to give for 14:30 on the wall in summer: the universal time
    // of that is 11:30 in Athens, 12:30 in Berlin and Madrid, 13:30 in London, 20:30 in Denver.
    const std::vector<std::vector<std::string>> clocks = {{"Athens", "12:30", "11:30"},
                                                          {"Berlin", "12:30", "12:30"},
                                                          {"Madrid", "12:30", "12:30"},
                                                          {"London", "13:30", "13:30"},
                                                          {"Denver", "14:30", "20:30"}};
    for (const auto& clock : clocks)
        EXPECT_THAT(notesOf({"day", "house.obj", "--place", clock[0], "--date", "2026-07-01",
                             "--from", clock[1], "--out", "out"}),
                    Contains("First frame: 2026-07-01 " + clock[1] + " = " + clock[2] + " UTC"));
}

} // namespace
} // namespace quarn::test
