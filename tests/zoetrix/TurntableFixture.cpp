#include "tests/zoetrix/TurntableFixture.h"

#include <cmath>
#include <dlfcn.h>

namespace {

std::filesystem::path dialogPlugIn() {
    return std::filesystem::path(TEST_PLUGIN_DIR) / "dialogs" / "ZEL_VexUI.qnp";
}

bool chooseClockwise(IZoetrixDataUI& lists, KM_3dmAnimationProperties& record) {
    lists.SetDirectionListSelection(0);
    record.SetFrameCount(1);
    record.SetHtmlFilename(L"Walk");
    return true;
}

} // namespace

TurntableFixture::TurntableFixture(const std::string& plug_ins) : PlugInFixture(plug_ins) {}

void TurntableFixture::SetUp() {
    placeCamera(L"Perspective", eye, target);
    // The remembered direction outlives the session; a dialog is what restores it.
    const quarn::PlugInLoad load = session->loadPlugIn(dialogPlugIn());
    ASSERT_TRUE(load.ok()) << load.message;
    ASSERT_EQ(CQuarnCommand::success, runInDialog(chooseClockwise));
    record() = KM_3dmAnimationProperties();
    record().SetHtmlFilename(L"Walk");
    record().SetCaptureMethod(L"Shaded");
    front_end.clearPrinted();
}

void TurntableFixture::answerDialogWith(QnZoetrixVexUiDialog dialog) {
    void* library = dlopen(dialogPlugIn().c_str(), RTLD_NOW | RTLD_NOLOAD);
    ASSERT_TRUE(library);
    using Answering = void (*)(QnZoetrixVexUiDialog);
    const auto answering = reinterpret_cast<Answering>(dlsym(library, "AnswerTurnTableWith"));
    ASSERT_TRUE(answering);
    answering(dialog);
    dlclose(library);
}

CQuarnCommand::result TurntableFixture::runInDialog(QnZoetrixVexUiDialog dialog) {
    answerDialogWith(dialog);
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
