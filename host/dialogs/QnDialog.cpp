#include "sdk/qncore/QnDialog.h"

#include "host/app/Application.h"
#include "host/dialogs/DialogState.h"

using quarn::DialogState;

const CQnRuntimeClass CDialog::ClassRecord = {"CDialog", nullptr};
const CQnRuntimeClass CQuarnDialog::ClassRecord = {"CQuarnDialog", &CDialog::ClassRecord};

bool CQnRuntimeClass::IsDerivedFrom(const CQnRuntimeClass& other) const {
    for (const CQnRuntimeClass* record = this; record; record = record->m_base)
        if (record == &other)
            return true;
    return false;
}

// ---- CDialog

CDialog::CDialog(int template_id, CWnd* parent)
    : m_state(std::make_unique<DialogState>(*this, template_id, parent)) {}

CDialog::~CDialog() {
    if (IsOpen())
        quarn::reportBreach("CDialog::~CDialog", "the dialog is open");
}

const CQnRuntimeClass* CDialog::GetRuntimeClass() const {
    return &ClassRecord;
}

int CDialog::DoModal() {
    return m_state->show();
}

int CDialog::TemplateId() const {
    return m_state->template_id;
}

CWnd* CDialog::Parent() const {
    return m_state->parent;
}

bool CDialog::IsOpen() const {
    return m_state->window != nullptr;
}

void CDialog::SetDlgItemText(int control, const wchar_t* text) {
    if (quarn::isOnMainThread("CDialog::SetDlgItemText") && m_state->window)
        m_state->window->setText(control, text ? text : L"");
}

KM_wString CDialog::GetDlgItemText(int control) const {
    if (!quarn::isOnMainThread("CDialog::GetDlgItemText") || !m_state->window)
        return {};
    return std::wstring_view(m_state->window->text(control));
}

bool CDialog::UpdateData(bool store) {
    if (!quarn::isOnMainThread("CDialog::UpdateData") || !m_state->window)
        return false;
    CQnDialogExchange exchange(*this, store);
    DoDataExchange(exchange);
    return !exchange.HasFailed();
}

void CDialog::AttachComboBox(int control, CComboBox& combo_box) {
    m_state->combo_boxes.emplace_back(control, &combo_box);
}

void CDialog::DoDataExchange(CQnDialogExchange&) {}

int CDialog::OnInitDialog() {
    UpdateData(false);
    return 1;
}

void CDialog::OnOK() {
    if (UpdateData(true))
        EndDialog(QnDialogConfirmed);
}

void CDialog::OnCancel() {
    EndDialog(QnDialogGivenUp);
}

void CDialog::OnButton(int) {}

void CDialog::EndDialog(int result) {
    if (quarn::isOnMainThread("CDialog::EndDialog"))
        m_state->end(result);
}

// ---- CQuarnDialog

CQuarnDialog::CQuarnDialog(int template_id, CWnd* parent) : CDialog(template_id, parent) {}

CQuarnDialog::~CQuarnDialog() = default;

const CQnRuntimeClass* CQuarnDialog::GetRuntimeClass() const {
    return &ClassRecord;
}

const wchar_t* CQuarnDialog::ControllerName() const {
    return nullptr;
}

int CQuarnDialog::DoModalIn(quarn::DialogWindow& window) {
    return DialogState::of(*this).showIn(window);
}
