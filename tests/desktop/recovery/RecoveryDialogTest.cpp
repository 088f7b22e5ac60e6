#include "desktop/recovery/RecoveryDialog.h"

#include "desktop/recovery/RecoveryRow.h"
#include "tests/desktop/WindowParts.h"
#include "tests/desktop/dialogs/DialogDriver.h"

#include <QBuffer>
#include <QDir>
#include <QListWidget>
#include <QPushButton>

namespace quarn::desktop::test {
namespace {

using namespace std::chrono_literals;

std::vector<std::byte> pngOf(const QImage& image) {
    QByteArray bytes;
    QBuffer buffer(&bytes);
    image.save(&buffer, "PNG");
    const auto* const begin = reinterpret_cast<const std::byte*>(bytes.constData());
    return {begin, begin + bytes.size()};
}

RecoverableDocument document(const std::string& file) {
    RecoverableDocument made;
    made.recovery = "/state/" + file;
    if (!file.empty())
        made.document = "/data/models/" + file;
    made.kept_at = std::chrono::system_clock::time_point(1700000000s); // 2023-11-14 22:13:20 UTC
    QImage green(32, 20, QImage::Format_RGB32);
    green.fill(Qt::green);
    made.picture = pngOf(green);
    return made;
}

class RecoveryDialogTest : public WindowPartsTest {
protected:
    RecoveryDialog dialog{
        {document("house.quarn"), document("")},
        {[this](const RecoverableDocument& chosen) {
             recovered.push_back(chosen.document);
             return trouble;
         },
         [this](const RecoverableDocument& chosen) { discarded.push_back(chosen.document); }},
        nullptr};
    QListWidget& list() { return part<QListWidget>(dialog, "recoverable"); }
    void press(const char* button) { part<QPushButton>(dialog, button).click(); }

    std::vector<std::filesystem::path> recovered;
    std::vector<std::filesystem::path> discarded;
    std::optional<std::string> trouble;
};

TEST_F(RecoveryDialogTest, EachDocumentIsShownWithNamePlaceTimeAndPicture) {
    const QListWidgetItem& house = *list().item(0);
    EXPECT_EQ(house.text(), "house.quarn");
    EXPECT_EQ(house.data(RecoveryRow::PLACE).toString(), "/data/models");
    EXPECT_TRUE(house.data(RecoveryRow::TIME).toString().contains("2023"));
    EXPECT_EQ(house.data(RecoveryRow::PICTURE).value<QImage>().pixelColor(3, 3), Qt::green);
    EXPECT_EQ(list().item(1)->text(), "New document");
    EXPECT_EQ(list().item(1)->data(RecoveryRow::PLACE).toString(), "Never saved to a file");
}

TEST_F(RecoveryDialogTest, ARowReadsAloudAsAllThatItShows) {
    const QString aloud = list().item(0)->data(Qt::AccessibleTextRole).toString();
    EXPECT_TRUE(aloud.startsWith("house.quarn, /data/models, Kept on")) << aloud.toStdString();
}

TEST_F(RecoveryDialogTest, AFolderOfThePersonIsShownFromTheirOwnOn) {
    RecoverableDocument mine = document("house.quarn");
    mine.document = nativePath(QDir::homePath()) / "models" / "house.quarn";
    const RecoveryDialog offer({mine}, {}, nullptr);
    const QListWidgetItem& row = *part<QListWidget>(offer, "recoverable").item(0);
    EXPECT_EQ(row.data(RecoveryRow::PLACE).toString(), "~/models");
}

TEST_F(RecoveryDialogTest, WhatIsOlderThanItsFileSaysSo) {
    RecoverableDocument older = document("");
    older.document = folder / "saved.quarn";
    quarn::test::writeFile(older.document, "saved in this year");
    const RecoveryDialog offer({older}, {}, nullptr);
    const QListWidgetItem& row = *part<QListWidget>(offer, "recoverable").item(0);
    EXPECT_TRUE(row.data(RecoveryRow::TIME).toString().contains("saved later"));
    EXPECT_FALSE(list().item(0)->data(RecoveryRow::TIME).toString().contains("saved later"));
}

TEST_F(RecoveryDialogTest, ThePictureIsDrawnInItsRow) {
    dialog.show();
    QTest::qWait(20);
    const QRect row = list().visualItemRect(list().item(0));
    const QImage drawn = list().viewport()->grab(row).toImage();
    EXPECT_EQ(drawn.pixelColor(80, row.height() / 2), QColor(Qt::green));
}

TEST_F(RecoveryDialogTest, EnterRecoversTheOneThatWasChosenWithTheArrowKeys) {
    dialog.show();
    QTest::keyClick(&list(), Qt::Key_Down);
    QTest::keyClick(&list(), Qt::Key_Return);
    EXPECT_EQ(recovered, (std::vector<std::filesystem::path>{{}}));
    EXPECT_EQ(dialog.result(), QDialog::Accepted);
}

TEST_F(RecoveryDialogTest, WhatCannotBeRecoveredIsToldAndStillOffered) {
    trouble = "The file is damaged.";
    dialog.show();
    QString told;
    onceShown("message", [&](QWidget& box) {
        told = box.property("text").toString();
        part<QPushButton>(box, "ok").click();
    });
    press("recover");
    EXPECT_EQ(told, "The file is damaged.");
    EXPECT_TRUE(dialog.isVisible());
    EXPECT_EQ(list().count(), 2);
}

TEST_F(RecoveryDialogTest, NothingIsDiscardedWithoutASecondWord) {
    onceShown("message", [](QWidget& box) { part<QPushButton>(box, "cancel").click(); });
    press("discard");
    EXPECT_TRUE(discarded.empty());
    EXPECT_EQ(list().count(), 2);
}

TEST_F(RecoveryDialogTest, TheDialogClosesWhenAllIsDiscarded) {
    dialog.show();
    for (int count = 2; count > 0; --count) {
        EXPECT_TRUE(dialog.isVisible());
        onceShown("message", [](QWidget& box) { part<QPushButton>(box, "yes").click(); });
        press("discard");
    }
    EXPECT_EQ(discarded, (std::vector<std::filesystem::path>{"/data/models/house.quarn", {}}));
    EXPECT_FALSE(dialog.isVisible());
    EXPECT_EQ(dialog.result(), QDialog::Rejected);
}

TEST_F(RecoveryDialogTest, EscapeLeavesEverythingForLater) {
    dialog.show();
    QTest::keyClick(&dialog, Qt::Key_Escape);
    EXPECT_FALSE(dialog.isVisible());
    EXPECT_TRUE(recovered.empty());
    EXPECT_TRUE(discarded.empty());
}

} // namespace
} // namespace quarn::desktop::test
