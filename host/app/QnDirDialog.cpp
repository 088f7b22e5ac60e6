#include "sdk/qncore/QnDirDialog.h"

#include "ground/PathText.h"
#include "host/app/Application.h"

CQuarnUiDirDialog::CQuarnUiDirDialog(const wchar_t* title, const wchar_t* message,
                                     const wchar_t* start_folder, CWnd* parent)
    : m_title(title), m_message(message), m_path(start_folder), m_parent(parent) {}

int CQuarnUiDirDialog::DoModal() {
    quarn::Application* application = quarn::Application::forCall("CQuarnUiDirDialog::DoModal");
    if (!application)
        return QnDialogGivenUp;
    const auto chosen = application->frontEnd().chooseFolder(m_title.View(), m_message.View(),
                                                             quarn::pathFromText(m_path.View()));
    if (!chosen)
        return QnDialogGivenUp;
    m_path = quarn::textFromPath(*chosen);
    return QnDialogConfirmed;
}
