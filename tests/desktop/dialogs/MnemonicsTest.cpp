#include "desktop/dialogs/Mnemonics.h"

#include <gtest/gtest.h>

namespace quarn::desktop {
namespace {

TEST(Mnemonics, TakeTheFirstFreeLetterOfAWord) {
    EXPECT_EQ(withMnemonics({"Latitude", "Longitude", "Last frame"}),
              QStringList({"&Latitude", "L&ongitude", "Last &frame"}));
}

TEST(Mnemonics, KeepALettersOwnChoiceAndGiveItToNobodyElse) {
    EXPECT_EQ(withMnemonics({"Frames", "Folder && &File"}),
              QStringList({"F&rames", "Folder && &File"}));
}

TEST(Mnemonics, LeaveTextsOfOtherScriptsAlone) {
    EXPECT_EQ(withMnemonics({QString::fromUtf8("緯度")}), QStringList({QString::fromUtf8("緯度")}));
}

TEST(Mnemonics, ShowAnAmpersandThatIsOne) {
    const QStringList labels = withMnemonics({"Sun & sky"});
    EXPECT_EQ(labels, QStringList({"&Sun && sky"}));
    EXPECT_EQ(withoutMnemonic(labels.first()), "Sun & sky");
}

} // namespace
} // namespace quarn::desktop
