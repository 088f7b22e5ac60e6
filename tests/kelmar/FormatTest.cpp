#include "kelmar/KM_wString.h"

#include <gtest/gtest.h>

#include <clocale>
#include <cmath>
#include <cstdint>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <limits>
#include <locale>
#include <regex>
#include <string>

namespace {

template <class... Arguments> std::string format(const wchar_t* text, Arguments... arguments) {
    return KM_wString::FormatToString(text, arguments...).ToUtf8();
}

class CommaDecimals : public std::numpunct<char> {
    char do_decimal_point() const override { return ','; }
    char do_thousands_sep() const override { return '.'; }
    std::string do_grouping() const override { return "\3"; }
};

class WideCommaDecimals : public std::numpunct<wchar_t> {
    wchar_t do_decimal_point() const override { return L','; }
    wchar_t do_thousands_sep() const override { return L'.'; }
    std::string do_grouping() const override { return "\3"; }
};

} // namespace

TEST(Format, StringsAreWideUnderBothSpellings) {
    EXPECT_EQ(format(L"(%s) to (%ls)", L"old", L"n\u00E9w"), "(old) to (n\xC3\xA9w)");
    EXPECT_EQ(format(L"%hs", "\xC3\xA9"), "\xC3\xA9");
    EXPECT_EQ(format(L"%s", static_cast<const wchar_t*>(nullptr)), "(null)");
}

TEST(Format, StringsTakeWidthAndPrecision) {
    EXPECT_EQ(format(L"[%5s][%-5s][%.2s][%*s]", L"abc", L"abc", L"abc", 4, L"x"),
              "[  abc][abc  ][ab][   x]");
    const wchar_t unterminated[2] = {L'o', L'k'};
    EXPECT_EQ(format(L"%.2s", unterminated), "ok");
}

TEST(Format, IntegersFollowTheirFlags) {
    EXPECT_EQ(format(L"%d %i %u", -5, 7, 4000000000U), "-5 7 4000000000");
    EXPECT_EQ(format(L"%03d|%03d|%03d", 7, 1234, -7), "007|1234|-07");
    EXPECT_EQ(format(L"%5d|%-5d|%+d|% d", 42, 42, 42, 42), "   42|42   |+42| 42");
    EXPECT_EQ(format(L"%.3d|%6.3d|%06.3d|%.0d|", 5, 5, 5, 0), "005|   005|   005||");
    EXPECT_EQ(format(L"%x %X %#x %#X %o %#o", 255U, 255U, 255U, 255U, 8U, 8U),
              "ff FF 0xff 0XFF 10 010");
}

TEST(Format, IntegersOfEverySizeKeepTheirValue) {
    EXPECT_EQ(format(L"%lld", std::numeric_limits<long long>::min()), "-9223372036854775808");
    EXPECT_EQ(format(L"%llu", std::numeric_limits<unsigned long long>::max()),
              "18446744073709551615");
    EXPECT_EQ(format(L"%ld %lu", -3L, 3UL), "-3 3");
    EXPECT_EQ(format(L"%d", std::numeric_limits<int>::min()), "-2147483648");
    EXPECT_EQ(format(L"%hhd %hd %hhu %hu", 300, 70000, 300, 70000), "44 4464 44 4464");
    EXPECT_EQ(format(L"%zu %jd", std::size_t{7}, std::intmax_t{-7}), "7 -7");
}

TEST(Format, FloatingNumbersPrintAsInC) {
    EXPECT_EQ(format(L"%f %.2f %.0f %8.3f|", 1.5, 2.675, 2.5, -3.14159),
              "1.500000 2.67 2   -3.142|");
    EXPECT_EQ(format(L"%g %g %g %g", 0.0001, 0.00001, 123456.0, 1234567.0),
              "0.0001 1e-05 123456 1.23457e+06");
    EXPECT_EQ(format(L"%e %E %.0e", 12345.678, 12345.678, 5.0), "1.234568e+04 1.234568E+04 5e+00");
    EXPECT_EQ(format(L"%+.1f|% .1f|%08.2f|%-8.2f|", 1.0, 1.0, -1.5, 1.5),
              "+1.0| 1.0|-0001.50|1.50    |");
    EXPECT_EQ(format(L"%a %.1a", 1.0, 1.5), "0x1p+0 0x1.8p+0");
    EXPECT_EQ(format(L"%.2Lf", 1.25L), "1.25");
    EXPECT_EQ(format(L"%.17g", 0.1), "0.10000000000000001");
    EXPECT_EQ(format(L"%.1f", -0.0), "-0.0");
}

TEST(Format, NumbersThatAreNoneAreNamed) {
    const double infinity = std::numeric_limits<double>::infinity();
    EXPECT_EQ(format(L"%f %F %g", infinity, -infinity, std::abs(std::nan(""))), "inf -INF nan");
    EXPECT_EQ(format(L"%05f|", infinity), "  inf|");
}

TEST(Format, TheLargestNumberIsNotCut) {
    const std::string text = format(L"%.3f", std::numeric_limits<double>::max());
    EXPECT_EQ(text.size(), 309U + 4U);
    EXPECT_EQ(text.substr(0, 17), "17976931348623157");
    EXPECT_EQ(format(L"%.5000f", 0.5).size(), 2U + 4096U) << "precision is cut to 4096";
    EXPECT_EQ(format(L"%99999999999d", 1).size(), 4096U) << "width is cut to 4096";
}

TEST(Format, TextOfAnyLengthFits) {
    const std::wstring text(100000, L'x');
    EXPECT_EQ(format(L"<%s>", text.c_str()).size(), 100002U);
}

TEST(Format, CharactersAndPercentSigns) {
    EXPECT_EQ(format(L"%c%c %3c|%lc", L'a', L'\u00E9', L'b', L'c'), "a\xC3\xA9   b|c");
    EXPECT_EQ(format(L"100%%"), "100%");
}

TEST(Format, WhatIsNoConversionIsCopied) {
    EXPECT_EQ(format(L"100%"), "100%");
    EXPECT_EQ(format(L"50%y %5.2! %d", 3), "50%y %5.2! 3");
    EXPECT_EQ(format(L"%n", nullptr), "%n");
}

TEST(Format, ArgumentsMayPointIntoTheResult) {
    KM_wString text(L"frame");
    text.Format(L"%s_%s.%03d", text.Array(), text.Array(), 12);
    EXPECT_TRUE(text == L"frame_frame.012");
    text.Format(nullptr);
    EXPECT_TRUE(text.IsEmpty());
}

TEST(Format, DecimalMarkIsAPointInACommaLocale) {
    const std::locale before = std::locale::global(
        std::locale(std::locale(std::locale::classic(), new CommaDecimals), new WideCommaDecimals));
    // The C library's own locale too, where this machine has one with a comma.
    for (const char* name : {"de_DE.UTF-8", "de_DE.utf8", "fr_FR.UTF-8", "ru_RU.UTF-8"}) {
        if (std::setlocale(LC_ALL, name))
            break;
    }
    const std::string text = format(L"%.2f %g %d", 1234567.25, 0.5, 1234567);
    std::setlocale(LC_ALL, "C");
    std::locale::global(before);
    EXPECT_EQ(text, "1234567.25 0.5 1234567");
}

// Not every machine has a locale with a decimal comma to try, so the sources are read as well.
TEST(Format, NoSourceOfTheToolkitCallsWhatFollowsTheLocale) {
    const std::regex locale_call(
        R"(\b(v?[fsn]*w?printf|strto[dfl]+|wcsto[dfl]+|sto[dfil]+|tow(lower|upper)|isw?(space|alpha|digit)|to_w?string|w?[io]?stringstream|setlocale|localeconv)\s*[(<])");
    ASSERT_TRUE(std::regex_search("x = towlower(c)", locale_call));
    ASSERT_TRUE(std::regex_search("vswprintf(a, b)", locale_call));
    int read = 0;
    for (const auto& entry : std::filesystem::directory_iterator(QUARN_SOURCE_DIR "/kelmar")) {
        if (entry.path().extension() != ".cpp" && entry.path().extension() != ".h")
            continue;
        std::ifstream file(entry.path());
        const std::string source{std::istreambuf_iterator<char>(file), {}};
        EXPECT_FALSE(std::regex_search(source, locale_call)) << entry.path();
        ++read;
    }
    EXPECT_GT(read, 20);
}
