#pragma once

#include "host/app/CommandLine.h"
#include "sdk/qncore/QnCommand.h"

#include <deque>
#include <filesystem>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace quarn {

class Application;

/// Where a command line comes from.
struct CommandOrigin {
    /// The document to work in; not null.
    CQuarnDoc* document = nullptr;
    /// Whether a person started it in a window and may be shown dialogs.
    bool interactive = false;
    /// The line of a script file, as in "turntable.txt, line 3"; empty for every other line.
    std::wstring place;
    /// Whether a person typed it at a command line: words that do not answer are asked again.
    bool typed = false;
};

/// A command that runs now.
struct RunningCommand {
    CQuarnCommand* command;
    KM_wString name;               ///< its English name
    std::wstring place;            ///< as in CommandOrigin
    std::deque<CommandWord> words; ///< the answers that are left
    bool typed = false;            ///< as in CommandOrigin
    int pictures_written = 0;
    KM_wString likely_mistake{}; ///< in its last answer; told when the command fails at it

    /// What messages about its answers begin with: its place and its name.
    std::wstring label() const;
    /// The answers that are left, with blanks between them.
    std::wstring wordsLeft() const;
};

/// Runs command lines. Commands nest only as scripts of the command that runs.
class CommandRunner {
public:
    explicit CommandRunner(Application& application) : m_application(application) {}
    CommandRunner(const CommandRunner&) = delete;
    CommandRunner& operator=(const CommandRunner&) = delete;

    /// Runs one command line while no other command runs. A blank line succeeds.
    /// @return how the command ended; failure, with a message, for a line that cannot be read, an
    ///         unknown command, and while another command runs
    CQuarnCommand::result run(std::wstring_view line, const CommandOrigin& origin);

    /// Runs one command line for the command that runs, which must be a script command.
    /// @return as run; failure, with a message, when the running command may not do so
    CQuarnCommand::result runNested(std::wstring_view line, const CommandOrigin& origin);

    /// Runs a script file; as Session::runScriptFile.
    std::optional<std::string> runFile(const std::filesystem::path& file);

    /// From now on called before each command that a person or a script file starts, while none
    /// runs; an empty one ends that.
    void setBeforeCommand(std::function<void()> look) { m_before_command = std::move(look); }

    /// The command that runs now, or null. Valid until it ends.
    RunningCommand* current() const { return m_running.empty() ? nullptr : m_running.back(); }
    /// The command that a person or a script file started, or null.
    RunningCommand* outermost() const { return m_running.empty() ? nullptr : m_running.front(); }

private:
    CQuarnCommand::result start(std::wstring_view line, const CommandOrigin& origin);
    CQuarnCommand::result execute(RunningCommand& running, const CommandOrigin& origin,
                                  bool interactive);
    void tellUnusedWords(const RunningCommand& running);
    void tellMissingSun(const RunningCommand& running);
    std::optional<std::string> runLines(const std::vector<std::wstring>& lines,
                                        const std::wstring& file_name);

    Application& m_application;
    std::vector<RunningCommand*> m_running;
    std::function<void()> m_before_command;
};

} // namespace quarn
