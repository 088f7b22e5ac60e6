#include "vexui/forms/FirstChoices.h"

#include "sdk/qncore/QnApp.h"
#include "sdk/qncore/QnView.h"

#include <QComboBox>

namespace vexui {

namespace {

/// Capture methods begin with the two renderers; display modes follow in the host's order.
constexpr int first_mode_entry = 2;

int entryOfView(const KM_ClassArray<KM_wString>& viewports, CQuarnView& view) {
    const KM_wString name = view.ActiveViewport().Name();
    for (int i = 0; i < viewports.Count(); ++i)
        if (viewports[i] == name)
            return i;
    return -1;
}

/// The entry of the mode that the view is drawn in; where the list has not all modes, as that of a
/// sun study, its first one.
int entryOfMode(int entries, const CQuarnView& view) {
    KM_SimpleArray<const CDisplayPipelineAttributes*> modes;
    CQuarnDisplayAttrsMgr::GetDisplayAttrsList(modes);
    const CDisplayPipelineAttributes* const shown = view.DisplayAttributes();
    for (int i = 0; shown && entries == first_mode_entry + modes.Count() && i < modes.Count(); ++i)
        if (modes[i]->Id() == shown->Id())
            return first_mode_entry + i;
    return first_mode_entry;
}

} // namespace

void offerWhatIsSeen(const RecordingFields& fields, const IZoetrixDataUI& lists,
                     const KM_3dmAnimationProperties& record) {
    CQuarnView* const view = QuarnApp().ActiveView();
    if (!view || !record.ViewportName().IsEmpty() || lists.ViewportListSelection() != 0)
        return;
    const int entry = entryOfView(lists.ViewportList(), *view);
    if (entry < 0)
        return;
    fields.viewports->setCurrentIndex(entry);
    const int mode = entryOfMode(fields.capture_methods->count(), *view);
    if (mode < fields.capture_methods->count())
        fields.capture_methods->setCurrentIndex(mode);
}

} // namespace vexui
