#pragma once

#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnComboBox.h"
#include "sdk/qncore/QnDateTime.h"
#include "sdk/qncore/QnDialogResult.h"
#include "sdk/qncore/QnExport.h"
#include "sdk/qncore/QnWnd.h"

#include <memory>

class CQnDialogExchange;
namespace quarn {
class DialogWindow;
struct DialogState;
} // namespace quarn

/// What a dialog is at run time: its class, and the class it stands on.
struct CQnRuntimeClass {
    const char* m_class_name;
    const CQnRuntimeClass* m_base; ///< null for the first of a line

    /// Whether this is `other` or stands on it.
    QNCORE_API bool IsDerivedFrom(const CQnRuntimeClass& other) const;
};

/// A modal dialog: a window made from a template, whose controls are addressed by their ids. The
/// template with id N is the file `N.dialog.json` of the plug-in that the dialog's class is part
/// of, see docs/dialogs.md. All calls belong on the main thread. A dialog must live until DoModal
/// has returned. What an overridden operation throws ends there: it is told, and the dialog is
/// closed.
class QNCORE_API CDialog {
public:
    static const CQnRuntimeClass ClassRecord;

    /// @param template_id  the template's number
    /// @param parent       the window that owns the dialog; may be null
    CDialog(int template_id, CWnd* parent);
    virtual ~CDialog();
    CDialog(const CDialog&) = delete;
    CDialog& operator=(const CDialog&) = delete;

    /// The run-time class record of the dialog's class. Lives as long as the plug-in is loaded.
    virtual const CQnRuntimeClass* GetRuntimeClass() const;

    /// Shows the dialog and waits until it is closed.
    /// @return as EndDialog was told, by the base QnDialogConfirmed or QnDialogGivenUp;
    ///         QnDialogNotShown, after a message, when it cannot be shown: there is nobody to show
    ///         it to, the template is missing or wrong, another dialog of this host is open
    ///         already, or an operation of it threw
    int DoModal();

    int TemplateId() const;
    /// The window that owns the dialog; may be null.
    CWnd* Parent() const;
    /// Whether its window is there now.
    bool IsOpen() const;

    /// Writes into a control; a control that the dialog does not have, or a closed dialog, does
    /// nothing. @param text  null is an empty text
    void SetDlgItemText(int control, const wchar_t* text);
    /// What stands in a control; empty for one that the dialog does not have and when it is closed.
    KM_wString GetDlgItemText(int control) const;

    /// Exchanges every member with its control through DoDataExchange.
    /// @param store  true reads the controls into the members, false shows the members
    /// @return false when a control holds what its member cannot take: the person is told and the
    ///         control has the keyboard then; members exchanged before it have their new values.
    ///         False, with nothing exchanged, when the dialog is closed.
    bool UpdateData(bool store);

protected:
    /// Names the combo box that stands for a control of the template. To be called before the
    /// window is made, as a rule in the constructor. The combo box must live as long as the dialog.
    /// It forgets the control before the window goes. In a window without such a combo box it keeps
    /// the control that it has.
    void AttachComboBox(int control, CComboBox& combo_box);

    /// Exchanges members with controls, one after the other (DDX_Text and its like). The base does
    /// nothing.
    virtual void DoDataExchange(CQnDialogExchange& exchange);
    /// Called once the window is made and before it is shown. The base shows the members.
    /// @return 1 to let the window give the keyboard to its first control; 0 where the operation
    ///         gave it to one itself. The base returns 1.
    virtual int OnInitDialog();
    /// Called when the person confirms. The base reads the controls and closes the dialog when all
    /// of them could be taken.
    virtual void OnOK();
    /// Called when the person gives up: the Cancel button, Escape, or the window's own button. The
    /// base closes the dialog.
    virtual void OnCancel();
    /// Called when a button of the template other than OK and Cancel is clicked. The base does
    /// nothing.
    virtual void OnButton(int control);

    /// Closes the dialog; in OnInitDialog: does not show it at all. The first call counts.
    /// @param result  what DoModal returns
    void EndDialog(int result);

private:
    friend struct quarn::DialogState;
    friend class CQuarnDialog;
    friend class CQnDialogExchange;
    std::unique_ptr<quarn::DialogState> m_state;
};

/// A dialog of a plug-in.
class QNCORE_API CQuarnDialog : public CDialog {
public:
    static const CQnRuntimeClass ClassRecord;

    CQuarnDialog(int template_id, CWnd* parent);
    ~CQuarnDialog() override;
    const CQnRuntimeClass* GetRuntimeClass() const override;

    /// The name of the class that shows the dialog where windows are made with Cocoa; null, as the
    /// base has it, for a dialog that is made from its template there too.
    virtual const wchar_t* ControllerName() const;

    // ---- For whoever shows the dialog in a window of its own making

    /// Runs the dialog in this window instead of one that the front end makes from the template, of
    /// which only the title is taken, for messages; there need be none. The window stays the
    /// caller's.
    /// @return as DoModal
    int DoModalIn(quarn::DialogWindow& window);
};

// ---- Data exchange

/// One exchange between the members of a dialog and its controls. After a control was refused the
/// rest of the exchange does nothing; so does the exchange of a closed dialog. A control that the
/// window does not have is passed over, and its member keeps its value.
class QNCORE_API CQnDialogExchange {
public:
    CQnDialogExchange(CDialog& dialog, bool store);
    /// Whether controls are read into members; else members are shown.
    bool IsStoring() const { return m_store; }
    bool HasFailed() const { return m_failed; }
    CDialog& Dialog() const { return m_dialog; }

    /// The window; one without controls when the dialog is closed. Valid during the exchange.
    quarn::DialogWindow& Window() const;
    /// The control that was exchanged last, which a range check speaks of.
    int LastControl() const { return m_last_control; }
    void SetLastControl(int control) { m_last_control = control; }

    /// Refuses what stands in a control: tells the person why and gives the control the keyboard.
    void Fail(int control, const wchar_t* why);

private:
    CDialog& m_dialog;
    bool m_store;
    bool m_failed = false;
    int m_last_control = 0;
};

/// Exchanges a number with a control, in the user's notation: digits with a point or a comma.
/// A text that is no number is refused: "Enter a number".
QNCORE_API void DDX_Text(CQnDialogExchange& exchange, int control, double& value);
/// Exchanges a whole number. A text that is none, or one that no int holds, is refused: "Enter a
/// whole number".
QNCORE_API void DDX_Text(CQnDialogExchange& exchange, int control, int& value);
/// Exchanges a text as it stands.
QNCORE_API void DDX_Text(CQnDialogExchange& exchange, int control, KM_wString& value);
/// Exchanges a date or a time, as the control of the template shows them: of a date the time of day
/// stays, of a time the date. In a window of another making both are exchanged. What is no date of
/// the calendar is refused: "Enter a date". A value that is not valid is not shown; the control
/// keeps its own.
QNCORE_API void DDX_DateTimeCtrl(CQnDialogExchange& exchange, int control, COleDateTime& value);
/// Refuses a number of the control exchanged last that lies outside the limits, which belong to the
/// range: "Enter a number between -90 and 90". Only when controls are read.
QNCORE_API void DDV_MinMaxDouble(CQnDialogExchange& exchange, double value, double least,
                                 double greatest);
