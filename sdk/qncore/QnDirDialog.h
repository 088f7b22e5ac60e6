#pragma once

#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnDialogResult.h"
#include "sdk/qncore/QnExport.h"
#include "sdk/qncore/QnWnd.h"

/// Lets a person choose a folder.
class QNCORE_API CQuarnUiDirDialog {
public:
    /// @param title         the window's title
    /// @param message       the text above the folders
    /// @param start_folder  the folder shown first
    /// @param parent        the window that owns the dialog; may be null
    CQuarnUiDirDialog(const wchar_t* title, const wchar_t* message, const wchar_t* start_folder,
                      CWnd* parent);

    /// @return QnDialogConfirmed when a folder was chosen; QnDialogGivenUp when not, also where
    ///         nobody can choose one
    int DoModal();

    /// The chosen folder; the start folder before one was chosen.
    const KM_wString& GetPathName() const { return m_path; }

private:
    KM_wString m_title;
    KM_wString m_message;
    KM_wString m_path;
    CWnd* m_parent;
};
