#include "sdk/vexui/VexUi.h"
#include "vexui/DialogRun.h"
#include "vexui/forms/CameraAnimationForm.h"
#include "vexui/forms/DayForm.h"
#include "vexui/forms/SeasonForm.h"

// The dialogs that the host looks up by name.

using vexui::CameraAnimationForm;

QN_PLUGIN_ENTRY bool ZelVexUiTurnTable(IZoetrixDataUI& lists, KM_3dmAnimationProperties& record) {
    const auto make = [&](QWidget* owner) {
        return new CameraAnimationForm(CameraAnimationForm::Kind::turntable, lists, record, owner);
    };
    return vexui::runForm(make, lists, record);
}

QN_PLUGIN_ENTRY bool ZelVexUiPathAnimation(IZoetrixDataUI& lists,
                                           KM_3dmAnimationProperties& record) {
    const auto make = [&](QWidget* owner) {
        return new CameraAnimationForm(CameraAnimationForm::Kind::path, lists, record, owner);
    };
    return vexui::runForm(make, lists, record);
}

QN_PLUGIN_ENTRY bool ZelVexUiDay(IZoetrixDataUI& lists, KM_3dmAnimationProperties& record) {
    const auto make = [&](QWidget* owner) { return new vexui::DayForm(lists, record, owner); };
    return vexui::runForm(make, lists, record);
}

QN_PLUGIN_ENTRY bool ZelVexUiSeason(IZoetrixDataUI& lists, KM_3dmAnimationProperties& record) {
    const auto make = [&](QWidget* owner) { return new vexui::SeasonForm(lists, record, owner); };
    return vexui::runForm(make, lists, record);
}
