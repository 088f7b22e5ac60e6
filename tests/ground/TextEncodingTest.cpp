#include "ground/TextEncoding.h"

#include <gtest/gtest.h>

namespace quarn::test {
namespace {

TEST(TextEncoding, TypeTwoIsUtf8AfterAByteOrderMark) {
    EXPECT_EQ(encodeTextFile(L"a\u00E9\u4E2D\U0001F600", TextEncoding::utf8_bom),
              "\xEF\xBB\xBF"
              "a\xC3\xA9\xE4\xB8\xAD\xF0\x9F\x98\x80");
    EXPECT_EQ(encodeTextFile(L"", TextEncoding::utf8_bom), "\xEF\xBB\xBF");
}

TEST(TextEncoding, TypeOneIsUtf8Alone) {
    EXPECT_EQ(encodeTextFile(L"\u00FC\r\n", TextEncoding::utf8), "\xC3\xBC\r\n");
    EXPECT_EQ(encodeTextFile(L"", TextEncoding::utf8), "");
}

TEST(TextEncoding, TypeZeroHasAQuestionMarkForWhatLatin1Lacks) {
    EXPECT_EQ(encodeTextFile(L"\u00FF\u0100x", TextEncoding::latin1), "\xFF?x");
}

TEST(TextEncoding, ZeroCharacterInTheMiddleIsKept) {
    EXPECT_EQ(encodeTextFile(std::wstring_view(L"a\0b", 3), TextEncoding::utf8),
              std::string("a\0b", 3));
}

} // namespace
} // namespace quarn::test
