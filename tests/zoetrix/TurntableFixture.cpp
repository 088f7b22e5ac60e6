#include "tests/zoetrix/TurntableFixture.h"

#include <cmath>

TurntableFixture::TurntableFixture(const std::string& plug_ins) : PlugInFixture(plug_ins) {}

void TurntableFixture::SetUp() {
    placeCamera(L"Perspective", eye, target);
    // The remembered direction outlives the session; the dialog is what restores it.
    ASSERT_EQ(CQuarnCommand::success, runInDialog({.direction = 0, .frames = 1}));
    record() = KM_3dmAnimationProperties();
    record().SetHtmlFilename(L"Walk");
    record().SetCaptureMethod(L"Shaded");
    front_end.clearPrinted();
}

CQuarnCommand::result TurntableFixture::runInDialog(const Entered& entered) {
    enterIntoDialog(entered);
    return session->runCommand(L"SetTurntableAnimation", true);
}

CQuarnCommand::result TurntableFixture::runAtCommandLine(const wchar_t* frames,
                                                         const wchar_t* direction) {
    answer({frames, direction, L"_Enter", L"_Enter", L"_Enter", L"_Enter"});
    return run(L"SetTurntableAnimation");
}

double TurntableFixture::angleOf(const KM_3dPoint& point) const {
    const double from = std::atan2(eye.y - centre.y, eye.x - centre.x);
    const double angle = std::atan2(point.y - centre.y, point.x - centre.x) - from;
    return angle < 0.0 ? angle + 2.0 * KM_PI : angle;
}
