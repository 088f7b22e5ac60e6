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

} // namespace
