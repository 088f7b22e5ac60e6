#include "desktop/documents/SessionEnd.h"
#include "desktop/command_line/CommandPane.h"
#include "desktop/documents/UnsavedChanges.h"
#include "desktop/documents/WindowClosing.h"
#include "host/session/DocumentState.h"
#include "tests/desktop/WindowParts.h"
#include "tests/desktop/dialogs/DialogDriver.h"

#include <QCloseEvent>
#include <QPushButton>

namespace quarn::desktop::test {
namespace {

/// A window that asks before it closes.
class AskingWindow final : public QWidget {
public:
    std::function<bool()> may_close;

protected:
    void closeEvent(QCloseEvent* event) override { event->setAccepted(may_close()); }
};

class SessionEndTest : public WindowPartsTest {
protected:
    SessionEndTest() {
        window.may_close = [this] {
            ++times_closed;
            return closing.mayClose();
        };
        window.show();
        QObject::connect(&session_end, &SessionEnd::keepsWork, [this] { ++times_kept; });
    }

    void change() { run("_Point 1,2,3"); }
    void willClick(const QString& box, const QString& button) {
        onceShown(box, [this, button](QWidget& shown) {
            was_asked = true;
            part<QPushButton>(shown, button).click();
        });
    }
    /// The desktop tells the program that the session is about to end.
    void prepare(bool may_ask) {
        session_end.prepare({[may_ask] { return may_ask; }, [this] { has_agreed = true; },
                             [this] { is_cancelled = true; }});
    }
    /// The desktop ends its programs.
    void quit() {
        later([] {
            QEvent quit(QEvent::Quit);
            QCoreApplication::sendEvent(qApp, &quit);
        });
        QTimer late;
        late.callOnTimeout([this] {
            has_ended = false;
            QCoreApplication::exit();
        });
        late.start(300);
        has_ended = true;
        QApplication::exec();
    }

    AskingWindow window;
    CommandPane pane{session, &window};
    UnsavedChanges changes{session, starter, window};
    WindowClosing closing{starter, pane, changes, window};
    ProgramEnd end{starter, pane, &window};
    SessionEnd session_end{session, starter, closing, changes, end, &window};
    int times_closed = 0;
    int times_kept = 0;
    bool was_asked = false;
    bool has_agreed = false;
    bool is_cancelled = false;
    bool has_ended = false;
};

TEST_F(SessionEndTest, NobodyIsAskedWhereNothingIsUnsaved) {
    prepare(true);
    EXPECT_FALSE(has_agreed);
    EXPECT_FALSE(is_cancelled);
    EXPECT_EQ(times_kept, 0);
}

TEST_F(SessionEndTest, WhoStaysHasTheSessionGoOn) {
    change();
    willClick("unsavedChanges", "keepDocument");
    prepare(true);
    EXPECT_FALSE(has_agreed);
    EXPECT_TRUE(is_cancelled);
}

TEST_F(SessionEndTest, WhoDoesNotSaveIsNotAskedAgain) {
    change();
    willClick("unsavedChanges", "discardChanges");
    prepare(true);
    EXPECT_TRUE(has_agreed);
    EXPECT_FALSE(is_cancelled);
    quit();
    EXPECT_TRUE(has_ended);
    EXPECT_EQ(times_closed, 0);
    EXPECT_EQ(end.unsavedWork(), UnsavedWork::not_wanted);
}

TEST_F(SessionEndTest, WhoSavesHasItSavedBeforeTheSessionEnds) {
    change();
    run(QString("_SaveAs \"%1\"").arg(qtText(folder / "a.quarn")));
    change();
    willClick("unsavedChanges", "saveChanges");
    prepare(true);
    EXPECT_FALSE(is_cancelled);
    EXPECT_FALSE(isModified(session.document()));
}

TEST_F(SessionEndTest, ASaveThatFailsHasTheSessionGoOn) {
    change();
    usePart([](FrontEndParts& used) {
        used.choose_file = [](QWidget*, const FileQuestion&) {
            return FileChoice{FileChoice::Kind::chosen, "/dev/null/a.quarn"};
        };
    });
    willClick("unsavedChanges", "saveChanges");
    prepare(true);
    EXPECT_TRUE(is_cancelled);
    EXPECT_TRUE(isModified(session.document()));
}

TEST_F(SessionEndTest, WhereNobodyMayBeAskedTheWorkIsKeptAndTheProgramEndsSilently) {
    change();
    prepare(false);
    EXPECT_FALSE(is_cancelled);
    EXPECT_EQ(times_kept, 1);
    quit();
    EXPECT_TRUE(has_ended);
    EXPECT_EQ(times_closed, 0);
    EXPECT_EQ(end.unsavedWork(), UnsavedWork::kept);
}

TEST_F(SessionEndTest, WhatIsChangedAfterwardsIsAskedAboutAgain) {
    change();
    willClick("unsavedChanges", "discardChanges");
    prepare(true);
    starter.start("_Point 4,5,6");
    was_asked = false;
    willClick("unsavedChanges", "keepDocument");
    quit();
    EXPECT_TRUE(was_asked);
    EXPECT_FALSE(has_ended);
}

TEST_F(SessionEndTest, ACommandThatRunsIsStoppedOnlyWhereThePersonAgrees) {
    setUpTurntable(5000);
    QTimer::singleShot(50, [this] {
        willClick("commandRuns", "letGoOn");
        prepare(true);
        EXPECT_TRUE(is_cancelled);
        EXPECT_FALSE(front_end.isInterrupted());
        is_cancelled = false;
        willClick("commandRuns", "stopAndClose");
        prepare(true);
        EXPECT_FALSE(is_cancelled);
        EXPECT_TRUE(front_end.isInterrupted());
    });
    starter.start("_PlayAnimation");
    EXPECT_TRUE(was_asked);
    quit();
    EXPECT_TRUE(has_ended);
    EXPECT_EQ(times_closed, 0);
    EXPECT_EQ(end.unsavedWork(), UnsavedWork::kept);
}

} // namespace
} // namespace quarn::desktop::test
