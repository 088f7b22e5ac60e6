#include "desktop/command_line/CommandStarter.h"

#include "desktop/front_end/DesktopFrontEnd.h"
#include "desktop/texts/Texts.h"

namespace quarn::desktop {

CommandStarter::CommandStarter(Session& session, DesktopFrontEnd& front_end, QObject* parent)
    : QObject(parent), m_session(session), m_front_end(front_end) {}

/// Between two lines of a script no command runs.
bool CommandStarter::isRunning() const {
    return m_is_started || m_session.isCommandRunning();
}

void CommandStarter::start(const QString& line) {
    const QString trimmed = line.trimmed();
    if (trimmed.isEmpty())
        return;
    startWork(trimmed, [&] { return m_session.runCommand(wideText(trimmed).View(), true); });
}

bool CommandStarter::startScript(const QString& file) {
    bool has_succeeded = false;
    startWork(file, [&] {
        const std::optional<std::string> trouble = m_session.runScriptFile(nativePath(file));
        has_succeeded = !trouble;
        if (trouble)
            m_front_end.print(KM_wString::FromUtf8(*trouble + "\n").View());
        return has_succeeded ? CQuarnCommand::success : CQuarnCommand::failure;
    });
    return has_succeeded;
}

void CommandStarter::startWork(const QString& name,
                               const std::function<CQuarnCommand::result()>& work) {
    if (m_is_over)
        return;
    if (isRunning()) {
        refuse();
        return;
    }
    m_front_end.commandStarts();
    m_line = name;
    m_is_started = true;
    emit started(m_line);
    const CQuarnCommand::result result = work();
    m_is_started = false;
    m_line.clear();
    m_front_end.commandEnded();
    emit ended(result);
}

void CommandStarter::stop() {
    if (isRunning())
        m_front_end.requestStop();
}

void CommandStarter::stopForGood() {
    m_is_over = true;
    stop();
}

void CommandStarter::refuse() {
    const QString reason =
        localized(L"%1 is still running. End it first, with Stop (Shift+F5).", 45001)
            .arg(m_line.section(' ', 0, 0));
    m_front_end.print(wideText(reason + '\n').View());
    emit refused(reason);
}

} // namespace quarn::desktop
