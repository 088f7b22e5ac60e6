#include "sdk/cocoa/QXText.h"

#include <gtest/gtest.h>

namespace {

class CocoaText : public testing::Test {
protected:
    CocoaText() : pool([[NSAutoreleasePool alloc] init]) {}
    ~CocoaText() override { [pool drain]; }

    static std::wstring roundTrip(const wchar_t* text) {
        const KM_wString back = [[NSString stringWithLPCTSTR:text] KMwString];
        return std::wstring(back.View());
    }

    NSAutoreleasePool* pool;
};

TEST_F(CocoaText, GoesToCocoaAndBack) {
    EXPECT_EQ(roundTrip(L"Turn 1"), L"Turn 1");
    EXPECT_EQ(roundTrip(L"\u56DE\u8EE2\u30A2\u30CB\u30E1"), L"\u56DE\u8EE2\u30A2\u30CB\u30E1");
    EXPECT_EQ(roundTrip(L"a\U0001F3A5b\U0010FFFF"), L"a\U0001F3A5b\U0010FFFF");
    EXPECT_EQ(roundTrip(L""), L"");
}

TEST_F(CocoaText, NullIsTheEmptyString) {
    NSString* const text = [NSString stringWithLPCTSTR:nullptr];
    ASSERT_NE(text, nil);
    EXPECT_EQ([text length], 0u);
}

TEST_F(CocoaText, ACharacterOutsideTheBasicPlaneIsTwoUnitsInCocoa) {
    NSString* const text = [NSString stringWithLPCTSTR:L"\U0001F3A5"];
    ASSERT_EQ([text length], 2u);
    // 0x1F3A5 - 0x10000 = 0xF3A5: 0xD800 + (0xF3A5 >> 10), 0xDC00 + (0xF3A5 & 0x3FF).
    EXPECT_EQ([text characterAtIndex:0], 0xD83C);
    EXPECT_EQ([text characterAtIndex:1], 0xDFA5);
}

TEST_F(CocoaText, WhatIsNoCharacterBecomesTheReplacementCharacter) {
    const wchar_t outside[] = {L'a', static_cast<wchar_t>(0x110000), static_cast<wchar_t>(0xD83C),
                               L'b', 0};
    EXPECT_EQ(roundTrip(outside), L"a\uFFFD\uFFFDb");

    // Half of a character that takes two units.
    NSString* const text = [[NSString stringWithLPCTSTR:L"a\U0001F3A5"] substringToIndex:2];
    ASSERT_EQ([text length], 2u);
    const KM_wString back = [text KMwString];
    EXPECT_EQ(back, L"a\uFFFD");
}

} // namespace
