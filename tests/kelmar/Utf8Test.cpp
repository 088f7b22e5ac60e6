#include "kelmar/KM_wString.h"

#include <gtest/gtest.h>

#include <string>

namespace {

std::wstring fromUtf8(std::string_view bytes) {
    return std::wstring(KM_wString::FromUtf8(bytes).View());
}

} // namespace

TEST(Utf8, CharactersOfEveryLengthSurviveTheRoundTrip) {
    const std::wstring text = L"A\u007F\u0080\u07FF\u0800\uFFFD\uFFFF\U00010000\U0010FFFF";
    const std::string bytes =
        "A\x7F\xC2\x80\xDF\xBF\xE0\xA0\x80\xEF\xBF\xBD\xEF\xBF\xBF\xF0\x90\x80"
        "\x80\xF4\x8F\xBF\xBF";
    EXPECT_EQ(KM_wString(text).ToUtf8(), bytes);
    EXPECT_EQ(fromUtf8(bytes), text);
}

TEST(Utf8, EveryScalarValueSurvivesTheRoundTrip) {
    for (char32_t code = 0; code <= 0x10FFFF; ++code) {
        if (code >= 0xD800 && code <= 0xDFFF)
            continue;
        const std::wstring text(1, static_cast<wchar_t>(code));
        ASSERT_EQ(fromUtf8(KM_wString(text).ToUtf8()), text) << static_cast<unsigned>(code);
    }
}

TEST(Utf8, ZeroInTheMiddleIsACharacter) {
    EXPECT_EQ(fromUtf8(std::string_view("a\0b", 3)), std::wstring(L"a\0b", 3));
    EXPECT_EQ(KM_wString(std::wstring_view(L"a\0b", 3)).ToUtf8(), std::string("a\0b", 3));
}

TEST(Utf8, OverlongFormsAreReplaced) {
    EXPECT_EQ(fromUtf8("\xC0\xAF"), L"\uFFFD\uFFFD");
    EXPECT_EQ(fromUtf8("\xE0\x80\xAF"), L"\uFFFD\uFFFD\uFFFD");
    EXPECT_EQ(fromUtf8("\xF0\x80\x80\xAF"), L"\uFFFD\uFFFD\uFFFD\uFFFD");
}

TEST(Utf8, SurrogatesAndTooLargeValuesAreReplaced) {
    EXPECT_EQ(fromUtf8("\xED\xA0\x80"), L"\uFFFD\uFFFD\uFFFD");
    EXPECT_EQ(fromUtf8("\xF4\x90\x80\x80"), L"\uFFFD\uFFFD\uFFFD\uFFFD");
    EXPECT_EQ(fromUtf8("\xF8\xFF"), L"\uFFFD\uFFFD");
}

// The Unicode Standard, section 3.9, table 3-8 (ill-formed sequences and their replacements).
TEST(Utf8, EachMaximalPartGivesOneReplacement) {
    EXPECT_EQ(fromUtf8("\x61\xF1\x80\x80\xE1\x80\xC2\x62\x80\x63\x80\xBF\x64"),
              L"a\uFFFD\uFFFD\uFFFDb\uFFFDc\uFFFD\uFFFDd");
}

TEST(Utf8, CutSequenceAtTheEndGivesOneReplacement) {
    EXPECT_EQ(fromUtf8("a\xE2\x82"), L"a\uFFFD");
    EXPECT_EQ(fromUtf8("a\xF0\x9F\x98"), L"a\uFFFD");
}

TEST(Utf8, WideTextThatIsNoUnicodeIsReplaced) {
    const std::wstring text = {L'a', static_cast<wchar_t>(0xD800), static_cast<wchar_t>(0x110000),
                               static_cast<wchar_t>(-1)};
    EXPECT_EQ(KM_wString(text).ToUtf8(), "a\xEF\xBF\xBD\xEF\xBF\xBD\xEF\xBF\xBD");
}
