#include "ground/PathText.h"

#include "tests/support/AllocationCount.h"

#include <gtest/gtest.h>

namespace quarn {
namespace {

TEST(SystemPath, IsTheTextInUtf8) {
    // One character of each length in UTF-8: 1, 2, 3 and 4 bytes.
    EXPECT_EQ(SystemPath(L"/tmp/a\u00E9\u732B\U0001F3A5.png").view(),
              "/tmp/a\xC3\xA9\xE7\x8C\xAB\xF0\x9F\x8E\xA5.png");
    EXPECT_EQ(SystemPath(L"").view(), "");
}

TEST(SystemPath, CharactersThatAreNoneBecomeTheReplacementCharacter) {
    const std::wstring text{L'a', static_cast<wchar_t>(0xD800), static_cast<wchar_t>(0x110000)};
    EXPECT_EQ(SystemPath(text).view(), "a\xEF\xBF\xBD\xEF\xBF\xBD");
}

TEST(SystemPath, LongestThatTheSystemTakesAsksForNothing) {
    const std::wstring text = L"/" + std::wstring(4094, L'x');
    const AllocationCount before = AllocationCount::now();
    const SystemPath path(text);
    const AllocationCount after = AllocationCount::now();
    EXPECT_EQ(path.view().size(), 4095U);
    EXPECT_EQ(0U, requestsBetween(before, after));
}

TEST(SystemPath, LongerOneIsKeptWhole) {
    const SystemPath path(L"/" + std::wstring(2500, L'\u00E9'));
    EXPECT_EQ(path.view().size(), 5001U);
    EXPECT_EQ(path.view().substr(4999), "\xC3\xA9");
}

} // namespace
} // namespace quarn
