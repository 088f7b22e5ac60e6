#include "desktop/dialogs/Choosers.h"
#include "tests/desktop/dialogs/DialogDriver.h"
#include "tests/support/TempFolder.h"

#include <gtest/gtest.h>

#include <QDialogButtonBox>
#include <QFileDialog>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QTest>

#include <fstream>

namespace quarn::desktop {
namespace {

namespace fs = std::filesystem;
using test::onceShown;
using test::part;

QFileDialog& browserOf(QWidget& window) {
    return dynamic_cast<QFileDialog&>(window);
}

/// Puts a name in and confirms. Typed letter by letter it would be completed meanwhile.
void enter(QWidget& window, const fs::path& name) {
    auto& edit = part<QLineEdit>(window, "fileNameEdit");
    edit.setFocus();
    edit.setText(QString::fromStdString(name.string()));
    QTest::keyClick(&edit, Qt::Key_Return);
}

class ChoosersTest : public testing::Test {
protected:
    fs::path write(const char* name) {
        const fs::path file = m_folder.path() / name;
        std::ofstream(file) << "text";
        return file;
    }

    FileQuestion saving() const {
        return {FileQuestion::Kind::save,
                L"Save",
                {{L"Quarn documents", {"quarn"}}, {L"OBJ models", {"obj"}}},
                m_folder.path() / "site.quarn"};
    }

    quarn::test::TempFolder m_folder;
};

TEST_F(ChoosersTest, FolderThatIsThereIsChosen) {
    fs::create_directory(m_folder.path() / "out");
    onceShown("chooser", [&](QWidget& window) {
        EXPECT_EQ(window.windowTitle(), "Record");
        EXPECT_EQ(part<QLabel>(window, "message").text(), "Choose a folder for the pictures");
        EXPECT_TRUE(part<QLabel>(window, "message").isVisible());
        enter(window, m_folder.path() / "out");
    });
    const auto folder =
        askFolder(nullptr, L"Record", L"Choose a folder for the pictures", m_folder.path());
    EXPECT_EQ(folder, m_folder.path() / "out");
}

TEST_F(ChoosersTest, FolderThatIsNotThereYetIsMade) {
    const fs::path wanted = m_folder.path() / "walks" / "evening";
    onceShown("chooser", [&](QWidget& window) { enter(window, wanted); });
    EXPECT_EQ(askFolder(nullptr, L"Record", L"", m_folder.path()), wanted);
    EXPECT_TRUE(fs::is_directory(wanted));
}

TEST_F(ChoosersTest, FolderThatIsOfferedIsChosenByTheMouseAlone) {
    const fs::path offered = m_folder.path() / "walk";
    onceShown("chooser", [&](QWidget& window) {
        EXPECT_EQ(part<QLineEdit>(window, "fileNameEdit").text(), "walk");
        auto& buttons = part<QDialogButtonBox>(window, "buttonBox");
        QPushButton* const choose = buttons.button(QDialogButtonBox::Open);
        ASSERT_TRUE(choose);
        EXPECT_TRUE(choose->isEnabled());
        QTest::mouseClick(choose, Qt::LeftButton);
        window.close();
    });
    EXPECT_EQ(askFolder(nullptr, L"Record", L"", offered), offered);
    EXPECT_TRUE(fs::is_directory(offered));
}

TEST_F(ChoosersTest, FolderThatCannotBeMadeIsToldAndTheChooserStaysOpen) {
    const fs::path file = write("file");
    onceShown("chooser", [&](QWidget& window) {
        onceShown("message", [](QWidget& box) { box.close(); });
        enter(window, file / "below");
        EXPECT_TRUE(window.isVisible());
        window.close();
    });
    EXPECT_FALSE(askFolder(nullptr, L"Record", L"", m_folder.path()));
}

TEST_F(ChoosersTest, FolderChooserBeginsAtTheNearestFolderThatIsThere) {
    onceShown("chooser", [&](QWidget& window) {
        EXPECT_EQ(fs::path(browserOf(window).directory().absolutePath().toStdString()),
                  m_folder.path());
        QTest::keyClick(&window, Qt::Key_Escape);
    });
    EXPECT_FALSE(askFolder(nullptr, L"Record", L"", m_folder.path() / "not" / "there"));
}

TEST_F(ChoosersTest, FileToOpenIsChosenAmongItsKinds) {
    const fs::path file = write("house.obj");
    write("notes.txt");
    onceShown("chooser", [&](QWidget& window) {
        const QStringList filters = browserOf(window).nameFilters();
        ASSERT_EQ(filters.size(), 2);
        EXPECT_EQ(filters[0], "All models (*.obj *.OBJ *.glb *.GLB)");
        EXPECT_EQ(filters[1], "OBJ models (*.obj *.OBJ)");
        enter(window, file);
    });
    const FileChoice choice =
        askFile(nullptr, {FileQuestion::Kind::open,
                          L"Open",
                          {{L"All models", {"obj", "glb"}}, {L"OBJ models", {"obj"}}},
                          m_folder.path()});
    EXPECT_EQ(choice.kind, FileChoice::Kind::chosen);
    EXPECT_EQ(choice.file, file);
}

TEST_F(ChoosersTest, GivingUpChoosesNoFile) {
    onceShown("chooser", [](QWidget& window) { window.close(); });
    EXPECT_EQ(askFile(nullptr, saving()).kind, FileChoice::Kind::given_up);
}

TEST_F(ChoosersTest, FileToSaveOffersItsNameAndGetsTheExtensionOfItsKind) {
    onceShown("chooser", [](QWidget& window) {
        EXPECT_EQ(part<QLineEdit>(window, "fileNameEdit").text(), "site.quarn");
        enter(window, "evening");
    });
    EXPECT_EQ(askFile(nullptr, saving()).file, m_folder.path() / "evening.quarn");
    onceShown("chooser", [](QWidget& window) {
        browserOf(window).selectNameFilter(browserOf(window).nameFilters()[1]);
        enter(window, "evening.v2");
    });
    EXPECT_EQ(askFile(nullptr, saving()).file, m_folder.path() / "evening.v2.obj");
}

TEST_F(ChoosersTest, FileThatIsThereIsReplacedOnlyWhenThePersonAgrees) {
    const fs::path file = write("site.quarn");
    onceShown("chooser", [&](QWidget& window) {
        onceShown("message",
                  [&](QWidget& box) { QTest::mouseClick(&part(box, "yes"), Qt::LeftButton); });
        enter(window, "site");
    });
    const FileChoice agreed = askFile(nullptr, saving());
    EXPECT_EQ(agreed.kind, FileChoice::Kind::chosen);
    EXPECT_EQ(agreed.file, file);

    onceShown("chooser", [&](QWidget& window) {
        onceShown("message", [&](QWidget& box) {
            onceShown("chooser", [](QWidget& again) { again.close(); });
            box.close();
        });
        enter(window, "site");
    });
    EXPECT_EQ(askFile(nullptr, saving()).kind, FileChoice::Kind::given_up);
}

TEST(WithExtension, AddsOneOnlyWhereNoneOfTheKindsIsThere) {
    const std::vector<FileKind> kinds = {{L"JPEG", {"jpg", "jpeg"}}, {L"PNG", {"png"}}};
    EXPECT_EQ(withExtension("a", kinds, 0), "a.jpg");
    EXPECT_EQ(withExtension("a", kinds, 1), "a.png");
    EXPECT_EQ(withExtension("a.JPEG", kinds, 1), "a.JPEG");
    EXPECT_EQ(withExtension("a.b", kinds, 0), "a.b.jpg");
    EXPECT_EQ(withExtension("a.b", {{L"All files", {}}}, 0), "a.b");
    EXPECT_EQ(withExtension("a", kinds, 9), "a");
}

} // namespace
} // namespace quarn::desktop
