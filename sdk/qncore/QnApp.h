#pragma once

#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnExport.h"
#include "sdk/qncore/QnWnd.h"

class CQuarnDoc;
class CQuarnView;

/// The running application. All calls belong on the main thread.
class QNCORE_API CQuarnApp {
public:
    CQuarnApp(const CQuarnApp&) = delete;
    CQuarnApp& operator=(const CQuarnApp&) = delete;

    /// The document that commands work on, or null while none is open. Owned by the host; valid
    /// until the document is closed, which never happens while a command runs.
    CQuarnDoc* ActiveDoc() const;

    /// The active view of the active document, or null when there is none. Owned by its document;
    /// valid until the view is closed, which never happens while a command runs.
    CQuarnView* ActiveView() const;

    /// Shows text on the command line as it stands (no format codes). Null is an empty text.
    void Print(const wchar_t* text) const;

    /// Runs one command line. Only a CQuarnScriptCommand may call it while it runs.
    ///
    /// @param document_serial_number  the document to run in (CQuarnDoc::RuntimeSerialNumber)
    /// @param script  one command line: "_" before a name asks for the English one, "-" for prompts
    ///                instead of dialogs, "!" ends prompts that are pending inside the script
    /// @param echo    1 shows the line on the command line, 0 does not
    /// @return true when the command succeeded; false when it failed, was cancelled or is unknown,
    ///         or when no such document is open
    bool RunScript(unsigned int document_serial_number, const wchar_t* script, int echo) const;

    /// Lets the front end work on its events for the given time, so that views repaint.
    /// @param milliseconds  0 works on what is pending and returns
    void Wait(unsigned int milliseconds) const;

    /// The main window, or null when the front end has none.
    HWND MainWnd() const;

private:
    friend QNCORE_API CQuarnApp& QuarnApp();
    CQuarnApp() = default;
};

/// The one application object. Lives as long as the program.
QNCORE_API CQuarnApp& QuarnApp();

/// Shows a message and waits until it is confirmed.
///
/// @param flags  0 for a plain message, 48 for a warning icon
/// @return 1 when confirmed (also where there is nobody to confirm it)
QNCORE_API int QuarnMessageBox(const wchar_t* text, const wchar_t* title, unsigned int flags);
