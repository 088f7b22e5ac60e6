#include "host/prompt/NumberText.h"

#include <gtest/gtest.h>

#include <locale>

namespace quarn {
namespace {

TEST(NumberText, NumbersAreReadWithPointSignAndExponent) {
    EXPECT_EQ(readNumber(L"3.5"), 3.5);
    EXPECT_EQ(readNumber(L" -0.25 "), -0.25);
    EXPECT_EQ(readNumber(L"+7"), 7.0);
    EXPECT_EQ(readNumber(L"1e3"), 1000.0);
}

TEST(NumberText, WhatIsNoFiniteNumberIsRefused) {
    for (const wchar_t* text : {L"", L" ", L"+", L"+-3", L"3,5", L"3.5m", L"0x10", L"inf", L"-inf",
                                L"infinity", L"nan", L"1e400", L"three", L"1 2"})
        EXPECT_FALSE(readNumber(text)) << KM_wString(text).ToUtf8();
}

TEST(NumberText, WholeNumbersHaveNoPointAndFitAnInt) {
    EXPECT_EQ(readWholeNumber(L"-12"), -12);
    EXPECT_EQ(readWholeNumber(L"2147483647"), 2147483647);
    for (const wchar_t* text : {L"3.5", L"3.0", L"1e3", L"2147483648", L"-2147483649", L"", L"x"})
        EXPECT_FALSE(readWholeNumber(text)) << KM_wString(text).ToUtf8();
}

TEST(NumberText, TextIsTheShortestThatReadsBack) {
    EXPECT_STREQ(numberText(1.0), L"1");
    EXPECT_STREQ(numberText(0.1), L"0.1");
    EXPECT_EQ(readNumber(numberText(1.0 / 3.0).View()), 1.0 / 3.0);
}

class DecimalComma : public std::numpunct<char> {
    char do_decimal_point() const override { return ','; }
};

TEST(NumberText, NumbersOfCommonSizesAreWrittenWithoutAnExponent) {
    EXPECT_STREQ(numberText(400000.0), L"400000");
    EXPECT_STREQ(numberText(-250000.5), L"-250000.5");
    EXPECT_STREQ(numberText(0.00001), L"0.00001");
    EXPECT_STREQ(numberText(999999999999999.0), L"999999999999999");
    EXPECT_STREQ(numberText(1e15), L"1e+15");
    EXPECT_STREQ(numberText(2e-6), L"2e-06");
    EXPECT_STREQ(numberText(-0.0), L"-0");
}

TEST(NumberText, ALocaleWithADecimalCommaChangesNothing) {
    const std::locale before = std::locale::global(std::locale(std::locale(), new DecimalComma));
    const std::optional<double> number = readNumber(L"3.5");
    const KM_wString text = numberText(3.5);
    std::locale::global(before);
    EXPECT_EQ(number, 3.5);
    EXPECT_STREQ(text, L"3.5");
}

} // namespace
} // namespace quarn
