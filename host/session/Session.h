#pragma once

#include "host/front_end/FrontEnd.h"
#include "host/front_end/PlugInLoad.h"
#include "host/front_end/SessionOptions.h"
#include "import/ImportedModel.h"
#include "sdk/qncore/QnCommand.h"
#include "sdk/qncore/QnDoc.h"
#include "sdk/qncore/QnExport.h"

#include <filesystem>
#include <memory>
#include <optional>
#include <string_view>
#include <vector>

namespace quarn {

/// What a command is called.
struct CommandName {
    KM_wString english;
    KM_wString local;       ///< the same where the command has no name in the user's language
    KM_wString description; ///< one line in the user's language, as Help prints it
};

/// The running host: the application, its documents and its plug-ins, behind one front end. There
/// is at most one session at a time; it belongs to the main thread.
class QNCORE_API Session {
public:
    /// Starts the host with one new document. The front end must outlive the session.
    Session(FrontEnd& front_end, SessionOptions options);
    /// Closes the documents, then unloads the plug-ins, the last loaded first.
    ~Session();
    Session(const Session&) = delete;
    Session& operator=(const Session&) = delete;

    /// Loads a plug-in file.
    PlugInLoad loadPlugIn(const std::filesystem::path& file);

    /// Registers the plug-in and command objects that are built into the program itself, and loads
    /// that plug-in, as if they had come from a plug-in file.
    PlugInLoad adoptProgramPlugIn();

    /// Runs one command line, or nothing for a blank one.
    ///
    /// @param interactive  true when a person typed it into a window and may be shown dialogs
    /// @return how the command ended; failure, with a message, for an unknown command
    CQuarnCommand::result runCommand(std::wstring_view line, bool interactive = false);

    /// Runs one command line that a person typed where there are no dialogs. As runCommand, but a
    /// word that does not answer its question is told and the question asked of the person; the
    /// words behind it are dropped.
    CQuarnCommand::result runTypedCommand(std::wstring_view line);

    /// The names of the commands that Help lists, in the order of their English names.
    /// @param hidden_too  those as well that Help leaves out
    std::vector<CommandName> commandNames(bool hidden_too = false) const;

    /// Runs a script file: one command line per line; blank lines and lines that start with "#" are
    /// skipped. Stops at the first command that does not succeed.
    /// @return nothing when every command succeeded; else one sentence, not told yet: which line
    ///         ended the script, or why the file is none
    std::optional<std::string> runScriptFile(const std::filesystem::path& file);

    /// Which axis was taken as up in the model file that was read last, and why; none before.
    const std::optional<TakenUpAxis>& lastUpAxis() const;

    /// The active document; there is always one. Valid until another one is opened.
    CQuarnDoc& document();

    /// Closes the view with this name, ignoring case, of the active document. While a command runs,
    /// also while it lets the front end work on events, the view stays until the command has ended.
    /// @return false, with a message, when there is no such view and when no view would be left
    bool closeView(std::wstring_view name);

    /// Whether a command runs now, also while it waits for an answer. Then the session starts no
    /// other one.
    bool isCommandRunning() const;

    /// True once a command asked the program to end.
    bool isExitRequested() const;
    /// For a person who was asked about unsaved changes then, and stays.
    void takeBackExit();

private:
    struct State;
    std::unique_ptr<State> m_state;
};

} // namespace quarn
