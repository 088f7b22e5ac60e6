#include "sdk/vexui/VexUi.h"

#include "host/app/Application.h"

namespace {

QnZoetrixVexUiDialog findDialog(const char* call, const char* entry) {
    quarn::Application* application = quarn::Application::forCall(call);
    if (!application)
        return nullptr;
    return reinterpret_cast<QnZoetrixVexUiDialog>(
        application->plugIns().findEntry(ZelVexUiPlugInId, entry));
}

} // namespace

const KM_UUID ZelVexUiPlugInId = {
    0x7C41E8D2, 0x95B3, 0x4F06, {0xA1, 0x6D, 0x3E, 0x58, 0xC0, 0x27, 0xF9, 0x14}};

IZoetrixDataUI::~IZoetrixDataUI() = default;

QnZoetrixVexUiDialog QnZoetrixVexUiTurnTable() {
    return findDialog("QnZoetrixVexUiTurnTable", "ZelVexUiTurnTable");
}

QnZoetrixVexUiDialog QnZoetrixVexUiPathAnimation() {
    return findDialog("QnZoetrixVexUiPathAnimation", "ZelVexUiPathAnimation");
}

QnZoetrixVexUiDialog QnZoetrixVexUiDay() {
    return findDialog("QnZoetrixVexUiDay", "ZelVexUiDay");
}

QnZoetrixVexUiDialog QnZoetrixVexUiSeason() {
    return findDialog("QnZoetrixVexUiSeason", "ZelVexUiSeason");
}
