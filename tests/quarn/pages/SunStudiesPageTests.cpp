#include "tests/quarn/Pictures.h"
#include "tests/quarn/Studio.h"
#include "tests/quarn/pages/DocsPage.h"
#include "tests/support/TempFolder.h"

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
        if (line.starts_with("# ") && !line.starts_with("# The folder"))
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
    const std::string page = readFile(std::filesystem::path(QUARN_SOURCE_DIR) / PAGE);
    for (const std::string city : {"Athens", "Berlin", "Kolkata", "Denver"}) {
        const auto notes = notesOf({"day", "house.obj", "--place", city, "--date", "2026-07-01",
                                    "--from", "14:30", "--out", "out"});
        ASSERT_GE(notes.size(), 3U);
        const std::string frame = notes[2].substr(std::string("First frame: ").size());
        EXPECT_THAT(page, testing::HasSubstr("| " + city + " | " + frame + " |"));
    }
}

} // namespace
} // namespace quarn::test
