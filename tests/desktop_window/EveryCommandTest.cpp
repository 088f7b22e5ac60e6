#include "host/front_end/ScriptedFrontEnd.h"
#include "host/session/Session.h"
#include "tests/desktop_window/HouseDesk.h"

#include <gtest/gtest.h>

namespace quarn::test {

namespace {

/// The commands of a session with the plug-in, as Help lists them; Exit comes last.
QStringList commandNames() {
    ScriptedFrontEnd front_end;
    Session session(front_end, {});
    const PlugInLoad load = session.loadPlugIn(ZOETRIX_PLUGIN_PATH);
    EXPECT_TRUE(load.ok()) << load.message;
    QStringList names;
    for (const CommandName& command : session.commandNames())
        names.append(QString::fromStdWString(std::wstring(command.english.View())));
    names.removeOne("Exit");
    return names;
}

/// Starts a command from its menu and sees its line in the output, or what is asked before.
void startFromMenu(HouseDesk& desk, const QString& name) {
    const QString line = "_" + name;
    const auto started = [&](const Windows& seen) {
        const SeenWidget* const output = seen.widget("output");
        return output ? output->text.count(line) : 0;
    };
    const qsizetype before = started(desk.look());
    desk.chooseInMenu("command_" + name);
    desk.lookUntil(name.toStdString() + " started", [&](const Windows& seen) {
        return started(seen) > before || !seen.modalWindows().isEmpty();
    });
}

class EveryCommand : public testing::TestWithParam<const char*> {
protected:
    void giveUp(const Windows& seen) {
        const QString way = GetParam();
        const QList<const SeenWidget*> modal = seen.modalWindows();
        if (way == "Cancel")
            m_desk.cancel(seen);
        else if (way == "WindowButton" && !modal.isEmpty())
            m_desk.display().askToClose(modal.first()->window_id);
        else
            m_desk.escape();
    }

    HouseDesk m_desk;
};

TEST_P(EveryCommand, StartsFromItsMenuAndIsGivenUp) {
    m_desk.startWithHouse();
    m_desk.setUpTurntable();
    const QStringList names = commandNames();
    ASSERT_GT(names.size(), 50);
    for (const QString& name : names) {
        SCOPED_TRACE(name.toStdString());
        startFromMenu(m_desk, name);
        m_desk.giveUp([this](const Windows& seen) { giveUp(seen); });
    }
    m_desk.chooseInMenu("command_Exit");
    m_desk.click("discardChanges");
    const Ended ended = m_desk.waitForEnd();
    EXPECT_EQ(ended.exit_code, 0) << ended.killed_by << ended.err;
}

INSTANTIATE_TEST_SUITE_P(Ways, EveryCommand, testing::Values("Escape", "Cancel", "WindowButton"),
                         [](const auto& way) { return std::string(way.param); });

} // namespace

} // namespace quarn::test
