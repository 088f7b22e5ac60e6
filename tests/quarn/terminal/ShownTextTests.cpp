#include "quarn/terminal/ShownText.h"
#include "tests/quarn/Studio.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using program::shownText;
using testing::HasSubstr;
using testing::Not;

TEST(ShownText, ControlCharactersStandAsTheirNumbers) {
    EXPECT_EQ(shownText(std::string_view("a\x1B[2J\x7F\r\bz")), "a\\x1B[2J\\x7F\\x0D\\x08z");
    EXPECT_EQ(shownText(std::string_view("\0", 1)), "\\x00");
    EXPECT_EQ(shownText(std::string_view("\xC2\x9B")), "\\x9B"); // as U+009B
    EXPECT_EQ(shownText(std::wstring_view(L"\u0090")), L"\\x90");
}

TEST(ShownText, OfAnyLanguageWithItsLinesAndTabsStays) {
    for (const std::string text : {"größe\t一\n", "\u00A0🏠 \\x1B"})
        EXPECT_EQ(shownText(text), text);
    EXPECT_EQ(shownText(std::string_view("a\x9B\xFFz")), "a\uFFFD\uFFFDz");
}

/// A house whose tower has a name that would clear the terminal.
void writeWickedHouse(const Studio& studio) {
    std::string house = readFile(studio / "house.obj");
    house.replace(house.find("o tower"), 7, "o tower\x1B[2J\x07");
    writeFile(studio / "wicked.obj", house);
}

TEST(ControlCharacters, OfAModelNeverReachTheTerminal) {
    const Studio studio;
    writeWickedHouse(studio);
    writeFile(studio / "list.txt", "_-List\n");
    for (const std::vector<std::string>& arguments :
         {std::vector<std::string>{"info", "wicked.obj"},
          {"run", "list.txt", "wicked.obj"},
          {"console", "wicked.obj"}}) {
        Start start;
        start.folder = studio.path();
        start.arguments = arguments;
        start.input = "List\n";
        const Ended ended = run(start);
        EXPECT_EQ(ended.exit_code, 0) << ended.err;
        EXPECT_THAT(ended.out, Not(HasSubstr("\x1B")));
        EXPECT_THAT(ended.out, Not(HasSubstr("\x07")));
        EXPECT_THAT(ended.out, HasSubstr("tower\\x1B[2J\\x07")) << arguments[0];
    }
}

TEST(ControlCharacters, OfAModelsFileNameNeverReachTheTerminal) {
    const Studio studio;
    writeFile(studio / "a\u009B2J.obj", "v 0 0 0\nv 1 0 0\nv 0 1 0\nv nan 0 0\nf 1 2 3\nf 1 2 4\n");
    Start start;
    start.folder = studio.path();
    start.arguments = {"turntable", "a\u009B2J.obj", "--frames", "1",
                       "--size",    "8x8",           "--out",    "out"};
    const Ended ended = run(start);
    EXPECT_TRUE(std::filesystem::exists(studio / "out" / "a_2J000.jpg")) << ended.err;
    EXPECT_THAT(ended.err, HasSubstr("quarn: a\\x9B2J.obj: "));
    EXPECT_THAT(ended.err + ended.out, Not(HasSubstr("\u009B")));
}

TEST(ControlCharacters, OfWhatIsTypedNeverReachTheTerminal) {
    const Studio studio;
    Start start;
    start.folder = studio.path();
    start.arguments = {"console"};
    start.input = "Tur\x1B[2Jnip\n";
    const Ended piped = run(start);
    EXPECT_THAT(piped.out, Not(HasSubstr("\x1B")));
    EXPECT_THAT(piped.out, HasSubstr("Tur\\x1B[2Jnip"));
    for (const std::vector<std::string>& arguments :
         {std::vector<std::string>{"turnip\x1B[2J"},
          {"places", "\x1B[2J"},
          {"turntable", "a.obj", "--out", "o", "--frames", "\x1B[2J"},
          {"frame", "\x1B[2J.quarn", "--number", "0", "--out", "a.png"}}) {
        const Ended ended = run(arguments);
        EXPECT_THAT(ended.exit_code, testing::AnyOf(1, 2));
        EXPECT_THAT(ended.err, Not(HasSubstr("\x1B")));
    }
}

} // namespace
} // namespace quarn::test
