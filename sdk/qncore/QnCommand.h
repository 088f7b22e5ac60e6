#pragma once

#include "kelmar/KM_Uuid.h"
#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnExport.h"

class CQuarnDoc;
class CQuarnPlugIn;

/// What a command is told about the run it is asked for.
class QNCORE_API CQuarnCommandContext {
public:
    CQuarnCommandContext(CQuarnDoc& document, bool interactive);

    /// The document to work on. Stays open while the command runs.
    CQuarnDoc& Document() const;

    /// True when a person started the command and may be shown dialogs; false in scripts, after a
    /// leading "-", and in programs without a window: then the command asks at the command line.
    bool IsInteractive() const;

private:
    CQuarnDoc* m_document;
    bool m_interactive;
};

/// The base of every command. One global object per command; constructing it announces the command,
/// and the host registers it together with its plug-in.
class QNCORE_API CQuarnCommand {
public:
    /// How a command, or a prompt, ended.
    enum result : int { success = 0, cancel = 1, nothing = 2, failure = 3 };

    /// @param transparent    may run while another command waits at a prompt
    /// @param do_not_repeat  Enter at the empty command line does not run it again
    /// @param plug_in        the plug-in it belongs to; null: the plug-in of the file being loaded,
    ///                       or the program itself
    /// @param hidden         left out of the list that `Help` prints
    CQuarnCommand(bool transparent = false, bool do_not_repeat = false,
                  const CQuarnPlugIn* plug_in = nullptr, bool hidden = false);
    virtual ~CQuarnCommand();
    CQuarnCommand(const CQuarnCommand&) = delete;
    CQuarnCommand& operator=(const CQuarnCommand&) = delete;

    /// The command's fixed id; never nil.
    virtual KM_UUID CommandUUID() = 0;
    /// The name by which scripts in any language call the command; letters and digits only.
    virtual const wchar_t* EnglishCommandName() = 0;
    /// The name in the user's language. The base returns the English name.
    virtual const wchar_t* LocalCommandName();
    /// One line for the list that `Help` prints, in the user's language. The base returns an empty
    /// text.
    virtual const wchar_t* CommandDescription();
    /// Does the command's work. Called on the main thread, never while another command runs but
    /// from that command's own script.
    virtual result RunCommand(const CQuarnCommandContext& context) = 0;

    bool IsHidden() const { return m_hidden; }
    bool IsTransparent() const { return m_transparent; }
    bool RepeatsOnEnter() const { return !m_do_not_repeat; }
    /// The plug-in it belongs to; null until registered, and for the host's own commands.
    const CQuarnPlugIn* PlugIn() const { return m_plug_in; }
    /// Whether the command may call CQuarnApp::RunScript.
    virtual bool IsScriptCommand() const { return false; }

private:
    friend class CQuarnCommandRegistration;
    const CQuarnPlugIn* m_plug_in;
    bool m_transparent;
    bool m_do_not_repeat;
    bool m_hidden;
};

/// A command that runs other commands: only such a one may call CQuarnApp::RunScript.
class QNCORE_API CQuarnScriptCommand : public CQuarnCommand {
public:
    CQuarnScriptCommand(bool transparent = false, bool do_not_repeat = false,
                        const CQuarnPlugIn* plug_in = nullptr, bool hidden = false);
    ~CQuarnScriptCommand() override;
    bool IsScriptCommand() const override { return true; }
};
