#include "desktop/menus/CommandMenus.h"

#include "tests/desktop/WindowParts.h"

#include <QFile>
#include <QMainWindow>

#include <gmock/gmock.h>

namespace quarn::desktop::test {
namespace {

class CommandMenusTest : public WindowPartsTest {
protected:
    explicit CommandMenusTest(const std::string& language = "C") : WindowPartsTest(language) {
        QObject::connect(&menus, &CommandMenus::lineChosen, &starter, &CommandStarter::start);
        usePart([](FrontEndParts& used) {
            used.ask = [](const Question&) { return Answer{Answer::Kind::cancel, {}}; };
        });
    }

    /// The visible actions of all menus that start a command.
    QList<QAction*> commandActions() {
        QList<QAction*> found;
        for (const MenuTitle& title : menuTitles()) {
            for (QAction* action : menus.menu(title.place).actions()) {
                if (action->isVisible() && action->data().isValid())
                    found.append(action);
            }
        }
        return found;
    }

    QMainWindow window;
    CommandMenus menus{session, starter, *window.menuBar()};
};

class GermanMenusTest : public CommandMenusTest {
protected:
    GermanMenusTest() : CommandMenusTest("de") {}
};

TEST_F(CommandMenusTest, EveryCommandIsThereOnce) {
    QStringList in_menus;
    for (const QAction* action : commandActions())
        in_menus.append(action->data().toString());
    QStringList of_session;
    for (const CommandName& name : session.commandNames())
        of_session.append(qtText(name.english));
    in_menus.sort();
    of_session.sort();
    EXPECT_EQ(in_menus, of_session);
    EXPECT_TRUE(of_session.contains("SetTurntableAnimation"));
}

TEST_F(CommandMenusTest, EveryCommandOfTheProgramHasAPlaceAmongItsKind) {
    QStringList strangers;
    for (const QAction* action : menus.menu(MenuPlace::plug_ins).actions()) {
        if (action->isVisible() && action->data().isValid())
            strangers.append(action->data().toString());
    }
    EXPECT_EQ(strangers, QStringList{"LoadPlugIn"});
}

TEST_F(CommandMenusTest, EveryCommandIsStartedFromItsMenu) {
    // Commands with a form show it where the forms are installed.
    QTimer giving_up;
    QObject::connect(&giving_up, &QTimer::timeout, [] {
        if (QWidget* const form = QApplication::activeModalWidget())
            form->close();
    });
    giving_up.start(20);
    for (QAction* action : commandActions()) {
        // A new document renders at the usual size again.
        run("_RenderSettings _Size 16 16 _Samples 1 _PreviewSamples 1 _Enter");
        started.clear();
        printed.clear();
        action->trigger();
        ASSERT_EQ(started.size(), 1) << action->text().toStdString();
        EXPECT_EQ(started[0].section(' ', 0, 0), "_" + action->data().toString());
        EXPECT_FALSE(printed.contains("Unknown command")) << printed.toStdString();
    }
    EXPECT_TRUE(session.isExitRequested());
}

TEST_F(CommandMenusTest, NothingButStopIsEnabledWhileACommandRuns) {
    bool was_stop_enabled = false;
    bool was_any_enabled = false;
    usePart([&](FrontEndParts& used) {
        used.ask = [&](const Question&) {
            was_stop_enabled = menus.stopAction().isEnabled();
            for (const QAction* action : commandActions())
                was_any_enabled |= action->isEnabled();
            return Answer{Answer::Kind::cancel, {}};
        };
    });
    menus.action("Circle")->trigger();
    EXPECT_TRUE(was_stop_enabled);
    EXPECT_FALSE(was_any_enabled);
    EXPECT_FALSE(menus.stopAction().isEnabled());
    EXPECT_TRUE(menus.action("Circle")->isEnabled());
}

TEST_F(CommandMenusTest, StopEndsTheCommandThatRuns) {
    setUpTurntable(500);
    later([&] { menus.stopAction().trigger(); });
    QElapsedTimer clock;
    clock.start();
    menus.action("PlayAnimation")->trigger();
    // Every frame waits for at least 10 ms unless it was stopped.
    EXPECT_LT(clock.elapsed(), 5000);
    EXPECT_FALSE(starter.isRunning());
}

TEST_F(CommandMenusTest, TipsTellTheNameAndWhatItDoes) {
    const QAction& action = *menus.action("Hide");
    EXPECT_EQ(action.toolTip(), "Hides objects  (Hide)");
    EXPECT_EQ(action.statusTip(), action.toolTip());
}

TEST_F(CommandMenusTest, RecordingBeginsWithTheFolderWhereThereIsNone) {
    setUpTurntable(2);
    KM_3dmAnimationProperties changed = record();
    changed.SetFolderName(L"");
    session.document().Properties().SetAnimationProperties(changed);
    started.clear();
    menus.action("RecordAnimation")->trigger();
    EXPECT_EQ(started, QStringList{"_RecordAnimation _TargetFolder"});
}

TEST_F(CommandMenusTest, FittingTheViewAsksNothing) {
    setUpTurntable(2);
    menus.action("FitView")->trigger();
    EXPECT_EQ(last_result, CQuarnCommand::success) << printed.toStdString();
}

TEST_F(CommandMenusTest, NoTwoShortcutsOrMnemonicsOfAMenuAreTheSame) {
    QStringList shortcuts;
    for (const MenuTitle& title : menuTitles()) {
        QStringList mnemonics;
        for (const QAction* action : menus.menu(title.place).actions()) {
            if (!action->shortcut().isEmpty())
                shortcuts.append(action->shortcut().toString());
            const QKeySequence mnemonic = QKeySequence::mnemonic(action->text());
            if (!mnemonic.isEmpty())
                mnemonics.append(mnemonic.toString());
        }
        EXPECT_EQ(mnemonics.removeDuplicates(), 0) << mnemonics.join(' ').toStdString();
        EXPECT_GT(mnemonics.size(), 0);
    }
    EXPECT_EQ(shortcuts.removeDuplicates(), 0);
    EXPECT_TRUE(shortcuts.contains("Ctrl+O"));
}

/// Each row of the page's list of keys, but those that are no command's.
TEST_F(CommandMenusTest, PageOfTheWindowNamesKeysThatAreThere) {
    QFile page(QUARN_SOURCE_DIR "/docs/window.md");
    ASSERT_TRUE(page.open(QIODevice::ReadOnly));
    const QString keys = QString::fromUtf8(page.readAll()).section("| key | does |", 1);
    QStringList shortcuts = {"Shift+F5", "Ctrl+M", "Esc", "Up", "Down", "Tab"};
    for (const MenuRow& row : menuRows())
        if (row.shortcut)
            shortcuts.append(row.shortcut);
    int told = 0;
    for (const QString& line : keys.split('\n').mid(2)) {
        if (!line.startsWith('|'))
            continue;
        for (const QString& key : line.section('|', 1, 1).trimmed().split(", ")) {
            EXPECT_TRUE(shortcuts.contains(key)) << key.toStdString();
            ++told;
        }
    }
    EXPECT_GT(told, 20);
}

TEST_F(GermanMenusTest, MenusAreInTheWordsOfTheUser) {
    EXPECT_EQ(menus.menu(MenuPlace::file).title(), "&Datei");
    EXPECT_EQ(menus.action("SetTurntableAnimation")->text(), "&Drehteller …");
    EXPECT_TRUE(menus.action("Hide")->toolTip().startsWith("Blendet Objekte aus"));
}

} // namespace
} // namespace quarn::desktop::test
