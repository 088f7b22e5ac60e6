#include "desktop/command_line/CommandPane.h"
#include "desktop/documents/FileDrop.h"
#include "desktop/documents/RecentFiles.h"
#include "desktop/documents/StartedLine.h"
#include "desktop/documents/UnsavedChanges.h"
#include "desktop/documents/WindowClosing.h"
#include "host/session/DocumentState.h"
#include "tests/desktop/WindowParts.h"

#include <QCloseEvent>
#include <QDropEvent>
#include <QMessageBox>
#include <QMimeData>
#include <QSettings>

#include <gmock/gmock.h>

namespace quarn::desktop::test {
namespace {

using quarn::test::writeFile;

/// A triangle as an OBJ file.
constexpr const char* TRIANGLE = "o Gable\nv 0 0 0\nv 1 0 0\nv 0 1 0\nf 1 2 3\n";

/// A window that asks before it closes.
class ClosingWindow final : public QWidget {
public:
    std::function<bool()> may_close;

protected:
    void closeEvent(QCloseEvent* event) override { event->setAccepted(may_close()); }
};

class DocumentsTest : public WindowPartsTest {
protected:
    DocumentsTest() {
        window.may_close = [this] { return closing.mayClose(); };
        window.resize(300, 200);
        window.show();
        QObject::connect(&drop, &FileDrop::refused,
                         [this](const QString& message) { messages.append(message); });
        QObject::connect(&recent, &RecentFiles::missing,
                         [this](const QString& message) { messages.append(message); });
        QObject::connect(&recent, &RecentFiles::lineChosen, &changes, &UnsavedChanges::start);
    }

    void change() { run("_Point 1,2,3"); }
    std::filesystem::path triangle(const char* name) {
        writeFile(folder / name, TRIANGLE);
        return folder / name;
    }
    /// Answers the next message box with the button of this name.
    void willClick(const QString& name) {
        QTimer::singleShot(0, [this, name] {
            auto* const box = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
            ASSERT_TRUE(box) << "nothing was asked";
            asked = box->text();
            EXPECT_EQ(box->textFormat(), Qt::PlainText) << "a file's name may look like a page";
            for (QAbstractButton* button : box->buttons()) {
                if (button->objectName() == name)
                    button->click();
            }
        });
    }
    void willChoose(FileChoice choice) {
        usePart([&](FrontEndParts& used) {
            used.choose_file = [this, choice](QWidget*, const FileQuestion& question) {
                recent.noteChoice(question, choice);
                return choice;
            };
        });
    }

    ClosingWindow window;
    CommandPane pane{session, &window};
    UnsavedChanges changes{session, starter, window};
    WindowClosing closing{starter, pane, changes, window};
    RecentFiles recent{session, starter, window};
    FileDrop drop{starter, changes, window};
    QString asked;
    QStringList messages;
};

TEST_F(DocumentsTest, ACommandsNameIsReadWhateverStandsBeforeIt) {
    EXPECT_EQ(readLine(session, "! _-open \"a b\" ").english_name, "Open");
    EXPECT_EQ(readLine(session, "! _-open \"a b\" ").words, "\"a b\"");
    EXPECT_EQ(readLine(session, "Opener x").english_name, "");
    EXPECT_EQ(quotedPath("/tmp/a b"), "\"/tmp/a b\"");
    EXPECT_EQ(quotedPath("/tmp/a\"b"), "");
}

TEST_F(DocumentsTest, NothingIsAskedWhereNothingWasChanged) {
    changes.start("_New");
    EXPECT_EQ(started, QStringList{"_New"});
    EXPECT_TRUE(window.close());
}

TEST_F(DocumentsTest, OtherCommandsAreStartedWithoutAQuestion) {
    change();
    changes.start("_List");
    EXPECT_EQ(started, QStringList{"_List"});
}

TEST_F(DocumentsTest, WhoStaysLosesNothing) {
    change();
    for (const char* line : {"_New", "open \"x.obj\"", "_-Recover 1", "Exit"}) {
        asked.clear();
        willClick("keepDocument");
        changes.start(line);
        EXPECT_EQ(asked, "Save the changes to the new document?") << line;
    }
    EXPECT_TRUE(started.isEmpty());
    EXPECT_EQ(objectCount(session.document()), 1);
}

TEST_F(DocumentsTest, WhoDoesNotSaveLeavesTheChanges) {
    change();
    willClick("discardChanges");
    changes.start("_New");
    EXPECT_EQ(started, QStringList{"_New"});
    EXPECT_EQ(objectCount(session.document()), 0);
}

TEST_F(DocumentsTest, ANewDocumentIsSavedToAFileThatIsAskedFor) {
    change();
    const std::filesystem::path file = folder / "kept.quarn";
    willChoose({FileChoice::Kind::chosen, file});
    willClick("saveChanges");
    changes.start("_New");
    EXPECT_TRUE(std::filesystem::exists(file)) << printed.toStdString();
    EXPECT_EQ(started, (QStringList{"_Save", "_New"}));
    EXPECT_EQ(objectCount(session.document()), 0);
    EXPECT_EQ(recent.files(), QStringList{qtText(file)});
}

TEST_F(DocumentsTest, GivingUpWhileAFileIsAskedForLosesNothing) {
    change();
    willChoose({FileChoice::Kind::given_up, {}});
    willClick("saveChanges");
    changes.start("_New");
    EXPECT_EQ(started, QStringList{"_Save"});
    EXPECT_EQ(objectCount(session.document()), 1);
    EXPECT_TRUE(isModified(session.document()));
}

TEST_F(DocumentsTest, ClosingTheWindowAsksAndStaysOrGoes) {
    change();
    willClick("keepDocument");
    EXPECT_FALSE(window.close());
    willClick("discardChanges");
    EXPECT_TRUE(window.close());
}

TEST_F(DocumentsTest, AWindowWhoseDocumentCannotBeSavedStaysOpen) {
    change();
    willChoose({FileChoice::Kind::chosen, "/dev/null/kept.quarn"});
    willClick("saveChanges");
    EXPECT_FALSE(window.close());
    EXPECT_TRUE(isModified(session.document()));
    EXPECT_TRUE(printed.contains("kept.quarn")) << printed.toStdString();
}

TEST_F(DocumentsTest, ExitIsRefusedWhileACommandRuns) {
    setUpTurntable(1000);
    QTimer::singleShot(50, [this] {
        changes.start("_Exit");
        EXPECT_TRUE(printed.contains("still running")) << printed.toStdString();
        starter.stop();
    });
    starter.start("_PlayAnimation");
    EXPECT_FALSE(session.isExitRequested());
    EXPECT_EQ(objectCount(session.document()), 1);
}

TEST_F(DocumentsTest, TheCommandThatEndsTheProgramAsksOnce) {
    change();
    willClick("discardChanges");
    changes.start("_Exit");
    EXPECT_TRUE(session.isExitRequested());
    EXPECT_TRUE(window.close());
}

TEST_F(DocumentsTest, WhoStaysWhenAScriptEndsTheProgramIsNotAskedAgain) {
    change();
    starter.start("_Exit");
    EXPECT_TRUE(session.isExitRequested());
    willClick("keepDocument");
    EXPECT_FALSE(window.close());
    EXPECT_FALSE(session.isExitRequested());
}

TEST_F(DocumentsTest, ClosingWhileAQuestionIsAskedCancelsItAndCloses) {
    usePart([this](FrontEndParts& used) {
        used.ask = [this](const Question& question) { return pane.ask(question); };
    });
    later([this] {
        ASSERT_TRUE(pane.isAsking());
        EXPECT_FALSE(window.close());
    });
    starter.start("_Circle");
    EXPECT_EQ(last_result, CQuarnCommand::cancel);
    EXPECT_TRUE(window.isVisible());
    QApplication::processEvents();
    EXPECT_FALSE(window.isVisible());
}

TEST_F(DocumentsTest, ClosingWhileACommandRunsStopsItWhereThePersonWantsThat) {
    setUpTurntable(1000);
    run(QString("_SaveAs \"%1\"").arg(qtText(folder / "turn.quarn")));
    QTimer::singleShot(50, [this] {
        willClick("letGoOn");
        EXPECT_FALSE(window.close());
        EXPECT_TRUE(starter.isRunning());
        willClick("stopAndClose");
        EXPECT_FALSE(window.close());
    });
    starter.start("_PlayAnimation");
    EXPECT_EQ(asked, "_PlayAnimation has not finished.");
    if (isModified(session.document()))
        willClick("discardChanges");
    QApplication::processEvents();
    EXPECT_FALSE(window.isVisible());
}

TEST_F(DocumentsTest, OfSeveralDroppedFilesTheFirstIsOpenedAndTheOthersImported) {
    const QList<QUrl> urls{QUrl::fromLocalFile(qtText(triangle("a b.obj"))),
                           QUrl::fromLocalFile(qtText(triangle("c.obj"))),
                           QUrl("https://quarn.example/d.obj")};
    QMimeData files;
    files.setUrls(urls);
    QDragEnterEvent enter({5, 5}, Qt::CopyAction, &files, Qt::LeftButton, {});
    QApplication::sendEvent(&window, &enter);
    EXPECT_TRUE(enter.isAccepted());
    QDropEvent dropped({5, 5}, Qt::CopyAction, &files, Qt::LeftButton, {});
    QApplication::sendEvent(&window, &dropped);
    QApplication::processEvents();
    EXPECT_EQ(started, (QStringList{"_Open \"" + qtText(folder / "a b.obj") + '"',
                                    "_Import \"" + qtText(folder / "c.obj") + '"'}));
    EXPECT_EQ(objectCount(session.document()), 2) << printed.toStdString();
    EXPECT_EQ(messages.size(), 1);
    EXPECT_EQ(recent.files(), QStringList{qtText(folder / "a b.obj")});
}

TEST_F(DocumentsTest, AFileThatCannotBeReadIsToldAndNothingElseImported) {
    writeFile(folder / "notes.xyz", "nothing that is a model");
    drop.open({QUrl::fromLocalFile(qtText(folder / "notes.xyz")),
               QUrl::fromLocalFile(qtText(triangle("c.obj")))});
    EXPECT_EQ(started.size(), 1);
    EXPECT_TRUE(printed.contains("notes.xyz")) << printed.toStdString();
    EXPECT_TRUE(recent.files().isEmpty());
}

TEST_F(DocumentsTest, DroppingAsksAboutUnsavedChangesFirst) {
    change();
    willClick("keepDocument");
    drop.open({QUrl::fromLocalFile(qtText(triangle("c.obj")))});
    EXPECT_TRUE(started.isEmpty());
    EXPECT_EQ(objectCount(session.document()), 1);
}

TEST_F(DocumentsTest, AQuestionAboutADocumentIsNotOvertakenByADrop) {
    change();
    QMimeData files;
    files.setUrls({QUrl::fromLocalFile(qtText(triangle("c.obj")))});
    QTimer::singleShot(0, [&] {
        QDragEnterEvent enter({5, 5}, Qt::CopyAction, &files, Qt::LeftButton, {});
        QApplication::sendEvent(&window, &enter);
        EXPECT_FALSE(enter.isAccepted());
        willClick("keepDocument");
    });
    changes.start("_New");
    EXPECT_EQ(objectCount(session.document()), 1);
}

TEST_F(DocumentsTest, RecentFilesAreKeptNewestFirstAndEachOnce) {
    for (int i = 0; i < RecentFiles::FILES_KEPT + 2; ++i)
        recent.note(folder / ("f" + std::to_string(i)));
    recent.note(folder / "f5");
    EXPECT_EQ(recent.files().size(), RecentFiles::FILES_KEPT);
    EXPECT_EQ(recent.files()[0], qtText(folder / "f5"));
    EXPECT_EQ(recent.files()[1], qtText(folder / "f11"));
    RecentFiles next_run(session, starter, window);
    EXPECT_EQ(next_run.files(), recent.files());
}

TEST_F(DocumentsTest, AFileChosenInAChooserBecomesRecentOnceItWasOpened) {
    willChoose({FileChoice::Kind::chosen, triangle("c.obj")});
    changes.start("_Open");
    EXPECT_EQ(objectCount(session.document()), 1) << printed.toStdString();
    EXPECT_EQ(recent.files(), QStringList{qtText(folder / "c.obj")});
}

TEST_F(DocumentsTest, ARecentFileIsOpenedFromTheMenuAndAMissingOneTakenFromIt) {
    recent.note(triangle("c.obj"));
    recent.note(folder / "gone.obj");
    EXPECT_TRUE(recent.menu().actions()[0]->text().contains("gone.obj"));
    recent.menu().actions()[0]->trigger();
    EXPECT_THAT(messages[0].toStdString(), testing::HasSubstr("gone.obj"));
    EXPECT_EQ(recent.files(), QStringList{qtText(folder / "c.obj")});
    recent.menu().actions()[0]->trigger();
    EXPECT_EQ(objectCount(session.document()), 1);
}

} // namespace
} // namespace quarn::desktop::test
