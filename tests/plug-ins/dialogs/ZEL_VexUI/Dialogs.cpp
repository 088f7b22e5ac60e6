#include "sdk/vexui/VexUi.h"
#include "tests/plug-ins/TestPlugIn.h"

#include <optional>

// Stands in for the dialog plug-in. The test says in the environment what the person does, and
// reads there what the person was shown:
//   QUARN_DIALOG_CONFIRM    "1" confirms the dialog; anything else closes it
//   QUARN_DIALOG_FRAMES     the frame count to enter
//   QUARN_DIALOG_NAME       the animation name to enter (UTF-8)
//   QUARN_DIALOG_FILE_TYPE, QUARN_DIALOG_CAPTURE, QUARN_DIALOG_VIEWPORT, QUARN_DIALOG_DIRECTION
//                           the index to choose
// What is not set stays as it was shown. Afterwards QUARN_DIALOG_KIND holds "turntable" or "path",
// and QUARN_DIALOG_SHOWN
//   frames=<n>;name=<name>;files=<a,b>@<selected>;captures=...;viewports=...;directions=...

namespace {

class DialogPlugIn final : public TestPlugIn {
public:
    DialogPlugIn() : TestPlugIn("00000000-0000-0000-0000-000000000000") {}
    KM_UUID PlugInID() const override { return ZelVexUiPlugInId; }
};

TestApplication the_application;
DialogPlugIn the_plug_in;

std::optional<std::string> Wish(const std::string& name) {
    const char* value = std::getenv(("QUARN_DIALOG_" + name).c_str());
    return value ? std::optional<std::string>(value) : std::nullopt;
}

std::string Described(const KM_ClassArray<KM_wString>& list, int selection) {
    std::string text;
    for (const KM_wString& entry : list)
        text += (text.empty() ? "" : ",") + entry.ToUtf8();
    return text + "@" + std::to_string(selection);
}

void TellShown(const IZoetrixDataUI& lists, const KM_3dmAnimationProperties& record) {
    const std::string shown =
        "frames=" + std::to_string(record.FrameCount()) +
        ";name=" + record.HtmlFilename().ToUtf8() +
        ";files=" + Described(lists.FileList(), lists.FileListSelection()) +
        ";captures=" + Described(lists.CaptureList(), lists.CaptureListSelection()) +
        ";viewports=" + Described(lists.ViewportList(), lists.ViewportListSelection()) +
        ";directions=" + Described(lists.DirectionList(), lists.DirectionListSelection());
    setenv("QUARN_DIALOG_SHOWN", shown.c_str(), 1);
}

void EnterIntoRecord(KM_3dmAnimationProperties& record) {
    if (const auto frames = Wish("FRAMES"))
        record.SetFrameCount(std::atoi(frames->c_str()));
    if (const auto name = Wish("NAME"))
        record.SetHtmlFilename(KM_wString::FromUtf8(*name));
    // A command that takes more of the edited record than these two finds nonsense there.
    record.SetFileExtension(L"gif");
    record.SetViewportName(L"Nowhere");
    record.SetCaptureMethod(L"Nothing");
    record.SetCaptureType(KM_3dmAnimationProperties::seasonal_sun);
}

void Choose(IZoetrixDataUI& lists) {
    if (const auto index = Wish("FILE_TYPE"))
        lists.SetFileListSelection(std::atoi(index->c_str()));
    if (const auto index = Wish("CAPTURE"))
        lists.SetCaptureListSelection(std::atoi(index->c_str()));
    if (const auto index = Wish("VIEWPORT"))
        lists.SetViewportListSelection(std::atoi(index->c_str()));
    if (const auto index = Wish("DIRECTION"))
        lists.SetDirectionListSelection(std::atoi(index->c_str()));
}

bool RunDialog(const char* kind, IZoetrixDataUI& lists, KM_3dmAnimationProperties& record) {
    setenv("QUARN_DIALOG_KIND", kind, 1);
    TellShown(lists, record);
    EnterIntoRecord(record);
    Choose(lists);
    return Wish("CONFIRM") == "1";
}

} // namespace

QN_PLUGIN_ENTRY bool ZelVexUiTurnTable(IZoetrixDataUI& lists, KM_3dmAnimationProperties& record) {
    return RunDialog("turntable", lists, record);
}

QN_PLUGIN_ENTRY bool ZelVexUiPathAnimation(IZoetrixDataUI& lists,
                                           KM_3dmAnimationProperties& record) {
    return RunDialog("path", lists, record);
}

TEST_PLUGIN_EXPORTS
