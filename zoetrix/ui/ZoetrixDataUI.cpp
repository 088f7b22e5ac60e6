#include "zoetrix/ui/ZoetrixDataUI.h"

#include "sdk/qncore/QnApp.h"
#include "sdk/qncore/QnLocalize.h"
#include "sdk/qncore/QnPlugIn.h"

namespace {

/// Flag of QuarnMessageBox.
constexpr unsigned int warning_icon = 48;

} // namespace

CZoetrixDataUI::~CZoetrixDataUI() = default;

const KM_ClassArray<KM_wString>& CZoetrixDataUI::FileList() const {
    return m_file_list;
}

void CZoetrixDataUI::SetFileList(const KM_ClassArray<KM_wString>& list) {
    m_file_list = list;
}

int CZoetrixDataUI::FileListSelection() const {
    return m_file_list_selection;
}

void CZoetrixDataUI::SetFileListSelection(int selection) {
    m_file_list_selection = selection;
}

const KM_ClassArray<KM_wString>& CZoetrixDataUI::CaptureList() const {
    return m_capture_list;
}

void CZoetrixDataUI::SetCaptureList(const KM_ClassArray<KM_wString>& list) {
    m_capture_list = list;
}

int CZoetrixDataUI::CaptureListSelection() const {
    return m_capture_list_selection;
}

void CZoetrixDataUI::SetCaptureListSelection(int selection) {
    m_capture_list_selection = selection;
}

const KM_ClassArray<KM_wString>& CZoetrixDataUI::ViewportList() const {
    return m_viewport_list;
}

void CZoetrixDataUI::SetViewportList(const KM_ClassArray<KM_wString>& list) {
    m_viewport_list = list;
}

int CZoetrixDataUI::ViewportListSelection() const {
    return m_viewport_list_selection;
}

void CZoetrixDataUI::SetViewportListSelection(int selection) {
    m_viewport_list_selection = selection;
}

const KM_ClassArray<KM_wString>& CZoetrixDataUI::DirectionList() const {
    return m_direction_list;
}

void CZoetrixDataUI::SetDirectionList(const KM_ClassArray<KM_wString>& list) {
    m_direction_list = list;
}

int CZoetrixDataUI::DirectionListSelection() const {
    return m_direction_list_selection;
}

void CZoetrixDataUI::SetDirectionListSelection(int selection) {
    m_direction_list_selection = selection;
}

HWND CZoetrixDataUI::Parent() const {
    return QuarnApp().MainWnd();
}

int CZoetrixDataUI::EVF(const wchar_t*, void*) {
    return 0;
}

bool LoadVexUi(bool show_message) {
    if (CQuarnPlugIn::PlugInIsLoaded(ZelVexUiPlugInId))
        return true;
    if (CQuarnPlugIn::LoadPlugIn(ZelVexUiPlugInId, true, true) >= 0)
        return true;
    if (show_message)
        QuarnMessageBox(QnLocalizeString(L"Vex UI (ZEL_VexUI.qnp) cannot be loaded.", 40001),
                        QnLocalizeString(L"Animation", 40002), warning_icon);
    return false;
}
