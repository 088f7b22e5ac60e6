#include "quarn/console/Console.h"

#include "quarn/console/HistoryFile.h"
#include "quarn/console/LineEditor.h"
#include "quarn/console/PlainLines.h"
#include "quarn/console/TerminalFrontEnd.h"
#include "quarn/console/UnsavedWork.h"
#include "quarn/session/Interruption.h"

#include <csignal>
#include <unistd.h>

namespace quarn::program {

namespace {

constexpr const wchar_t* IDLE_PROMPT = L"Command: ";
constexpr const wchar_t* WELCOME =
    L"Help lists the commands, Tab completes them, Exit or Ctrl-D leaves.\n";

/// Reads commands and runs them.
class Console {
public:
    Console(HostSession& host, TerminalFrontEnd& front_end, LineSource& lines,
            const std::optional<RecoveryOptions>& recovery)
        : m_session(host.session()), m_front_end(front_end), m_history(historyOf(lines)),
          m_work(m_session, front_end, lines, recovery) {
        if (lines.isTerminal())
            m_work.offer();
        for (const std::wstring& line : m_history.load())
            lines.remember(line, LineUse::command);
    }

    Outcome run() {
        while (!m_session.isExitRequested()) {
            const LineRead read = readCommand();
            if (read.kind == LineRead::Kind::end)
                break;
            if (read.kind == LineRead::Kind::lost)
                return {128 + SIGHUP, m_work.keepForNextStart()};
            if (read.kind == LineRead::Kind::line)
                runLine(read.text);
            if (isInterruptionRequested() && !forgetCtrlC())
                return stopped(m_work.keepForNextStart());
            m_work.look();
        }
        m_front_end.endLine();
        return Outcome::success("");
    }

private:
    /// What a pipe feeds in was not typed by anybody who would call it back.
    static HistoryFile historyOf(const LineSource& lines) {
        return HistoryFile(lines.isTerminal() ? historyPath() : std::filesystem::path());
    }

    LineRead readCommand() {
        // Plug-ins that are loaded meanwhile bring commands.
        const Completer completer = [this](std::wstring_view typed) {
            return completeCommand(typed, m_session.commandNames());
        };
        return m_front_end.readLine(IDLE_PROMPT, LineUse::command, completer);
    }

    void runLine(const std::wstring& line) {
        if (line.empty() || line.starts_with(L'#'))
            return;
        m_history.append(line);
        m_front_end.beginRecording(0);
        const CQuarnCommand::result result = m_session.runTypedCommand(line);
        m_front_end.clearProgress();
        if (isInterruptionRequested())
            m_front_end.print(L"Stopped.\n");
        else if (result == CQuarnCommand::cancel && m_front_end.lastWords().empty())
            m_front_end.print(L"Cancelled.\n");
    }

    Session& m_session;
    TerminalFrontEnd& m_front_end;
    HistoryFile m_history;
    UnsavedWork m_work;
};

/// A person's terminal is edited on only where both ends of it are there.
std::unique_ptr<LineSource> openLines() {
    if (isatty(STDIN_FILENO) == 1 && isatty(STDOUT_FILENO) == 1)
        return std::make_unique<LineEditor>();
    return std::make_unique<PlainLines>(STDIN_FILENO);
}

} // namespace

Outcome runConsole(const std::filesystem::path& model, const CommonOptions& common,
                   const std::optional<RecoveryOptions>& recovery) {
    watchForInterruption();
    const std::unique_ptr<LineSource> lines = openLines();
    // What opening tells is told once, by the outcome, when it fails.
    TerminalFrontEnd front_end(*lines, printsFor(common));
    HostSession host(front_end, common);
    if (const auto trouble = host.loadAnimationPlugIn())
        return *trouble;
    if (!model.empty())
        if (const auto trouble = host.readModel(model))
            return *trouble;
    front_end.showWords();
    if (lines->isTerminal())
        front_end.print(WELCOME);
    return Console(host, front_end, *lines, recovery).run();
}

} // namespace quarn::program
