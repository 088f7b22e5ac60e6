#pragma once

#include "kelmar/KM_AnimationProperties.h"
#include "kelmar/KM_Array.h"
#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnExport.h"
#include "sdk/qncore/QnWnd.h"

/// The lists that an animation dialog shows, each with the index of its selected entry. The order
/// of the virtual operations is part of the contract between the animation plug-in and the dialog
/// plug-in.
class QNCORE_API IZoetrixDataUI {
public:
    virtual ~IZoetrixDataUI();

    virtual const KM_ClassArray<KM_wString>& FileList() const = 0;
    virtual void SetFileList(const KM_ClassArray<KM_wString>& list) = 0;
    virtual int FileListSelection() const = 0;
    virtual void SetFileListSelection(int selection) = 0;
    virtual const KM_ClassArray<KM_wString>& CaptureList() const = 0;
    virtual void SetCaptureList(const KM_ClassArray<KM_wString>& list) = 0;
    virtual int CaptureListSelection() const = 0;
    virtual void SetCaptureListSelection(int selection) = 0;
    virtual const KM_ClassArray<KM_wString>& ViewportList() const = 0;
    virtual void SetViewportList(const KM_ClassArray<KM_wString>& list) = 0;
    virtual int ViewportListSelection() const = 0;
    virtual void SetViewportListSelection(int selection) = 0;
    virtual const KM_ClassArray<KM_wString>& DirectionList() const = 0;
    virtual void SetDirectionList(const KM_ClassArray<KM_wString>& list) = 0;
    virtual int DirectionListSelection() const = 0;
    virtual void SetDirectionListSelection(int selection) = 0;

    /// The window that owns the dialog; null where there is none. In the Qt window it is a
    /// `QWidget*`.
    virtual HWND Parent() const = 0;
    /// Extension hook. @return 0 when the named extension is not understood
    virtual int EVF(const wchar_t* name, void* data) = 0;
};

/// The id of the dialog plug-in, whose file is `ZEL_VexUI.qnp`.
QNCORE_API extern const KM_UUID ZelVexUiPlugInId;

/// Runs an animation dialog: shows the lists and the record, and changes both as the person
/// does. Called on the main thread while a command runs.
/// @return true when the person confirmed; on false lists and record are as they were
using QnZoetrixVexUiDialog = bool (*)(IZoetrixDataUI& lists, KM_3dmAnimationProperties& record);

/// The turntable dialog of the dialog plug-in, which exports it as `ZelVexUiTurnTable`; null when
/// the plug-in is not loaded or has no such dialog. Valid until the plug-in is unloaded.
QNCORE_API QnZoetrixVexUiDialog QnZoetrixVexUiTurnTable();

/// The path dialog, exported as `ZelVexUiPathAnimation`; as above.
QNCORE_API QnZoetrixVexUiDialog QnZoetrixVexUiPathAnimation();

/// The dialog of sun studies of one day, exported as `ZelVexUiDay`; as above. It edits the record's
/// place, start and end (date and time) and minutes between frames beside the lists and the name.
QNCORE_API QnZoetrixVexUiDialog QnZoetrixVexUiDay();

/// The dialog of seasonal sun studies, exported as `ZelVexUiSeason`; as above. It edits days
/// between frames instead of minutes.
QNCORE_API QnZoetrixVexUiDialog QnZoetrixVexUiSeason();
