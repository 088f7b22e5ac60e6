#include "sdk/qncore/QnAnimationName.h"

#include <gtest/gtest.h>

namespace {

TEST(AnimationName, ForbidsTheNineCharactersThatNoFileHolds) {
    int forbidden = 0;
    for (wchar_t character = 0; character < 0x300; ++character)
        forbidden += QnIsForbiddenInNames(character) ? 1 : 0;
    EXPECT_EQ(forbidden, 9);
    for (const wchar_t character : {L'\\', L'|', L'/', L':', L'*', L'?', L'"', L'<', L'>'})
        EXPECT_TRUE(QnIsForbiddenInNames(character)) << static_cast<char>(character);
}

TEST(AnimationName, ControlCharactersSteerAndAreNotSeen) {
    int controls = 0;
    for (wchar_t character = 0; character < 0x3000; ++character)
        controls += QnIsControlCharacter(character) ? 1 : 0;
    EXPECT_EQ(controls, 32 + 33 + 2);
    for (const wchar_t character : {L'\0', L'\n', L'\x1B', L'\x7F', L'\x9B', L'\u2028', L'\u2029'})
        EXPECT_TRUE(QnIsControlCharacter(character)) << static_cast<int>(character);
    for (const wchar_t character : {L' ', L'~', L'\xA0', L'é', L'日'})
        EXPECT_FALSE(QnIsControlCharacter(character)) << static_cast<int>(character);
}

} // namespace
