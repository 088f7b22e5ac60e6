#include "host/app/FormatArguments.h"

#include <gtest/gtest.h>

namespace quarn {
namespace {

TEST(FormatArguments, AreListedInTheirOrder) {
    EXPECT_EQ(formatArguments(L"%s of %d, %zu bytes"), L"sdzu");
    EXPECT_EQ(formatArguments(L"%1 of %2"), L"");
    EXPECT_EQ(formatArguments(L""), L"");
}

TEST(FormatArguments, WidthPrecisionAndFlagsTakeNone) {
    EXPECT_EQ(formatArguments(L"%-08.3f|%5d"), L"fd");
}

TEST(FormatArguments, AStarTakesOne) {
    EXPECT_EQ(formatArguments(L"%*.*f"), L"**f");
}

TEST(FormatArguments, PercentSignsAndUnknownKindsTakeNone) {
    EXPECT_EQ(formatArguments(L"100 %% and 5 %"), L"");
    EXPECT_EQ(formatArguments(L"%n%y"), L"");
}

TEST(FormatArguments, WideTextIsTheSameWithAndWithoutItsLetterAndNarrowTextIsNot) {
    EXPECT_EQ(formatArguments(L"%ls"), formatArguments(L"%s"));
    EXPECT_NE(formatArguments(L"%hs"), formatArguments(L"%s"));
    EXPECT_NE(formatArguments(L"%ld"), formatArguments(L"%d"));
}

} // namespace
} // namespace quarn
