#pragma once

#include "sdk/vexui/VexUi.h"

/// The lists that a set-up command hands to a dialog of the dialog plug-in, each with the index of
/// its selected entry. It owns copies of the lists; at first all are empty and all selections 0.
class CZoetrixDataUI : public IZoetrixDataUI {
public:
    ~CZoetrixDataUI() override;

    const KM_ClassArray<KM_wString>& FileList() const override;
    void SetFileList(const KM_ClassArray<KM_wString>& list) override;
    int FileListSelection() const override;
    /// The selections are stored as they come: whoever reads one checks it against its list.
    void SetFileListSelection(int selection) override;
    const KM_ClassArray<KM_wString>& CaptureList() const override;
    void SetCaptureList(const KM_ClassArray<KM_wString>& list) override;
    int CaptureListSelection() const override;
    void SetCaptureListSelection(int selection) override;
    const KM_ClassArray<KM_wString>& ViewportList() const override;
    void SetViewportList(const KM_ClassArray<KM_wString>& list) override;
    int ViewportListSelection() const override;
    void SetViewportListSelection(int selection) override;
    const KM_ClassArray<KM_wString>& DirectionList() const override;
    void SetDirectionList(const KM_ClassArray<KM_wString>& list) override;
    int DirectionListSelection() const override;
    void SetDirectionListSelection(int selection) override;

    /// The host's main window; null where there is none.
    HWND Parent() const override;
    /// @return 0: no extension is understood
    int EVF(const wchar_t* name, void* data) override;

private:
    KM_ClassArray<KM_wString> m_file_list;
    int m_file_list_selection = 0;
    KM_ClassArray<KM_wString> m_capture_list;
    int m_capture_list_selection = 0;
    KM_ClassArray<KM_wString> m_viewport_list;
    int m_viewport_list_selection = 0;
    KM_ClassArray<KM_wString> m_direction_list;
    int m_direction_list_selection = 0;
};

/// Makes sure that the dialog plug-in is loaded.
///
/// @param show_message  tell in a message box when it cannot be loaded
/// @return whether it is loaded now
bool LoadVexUi(bool show_message);
