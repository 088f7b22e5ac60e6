#include "zoetrix/commands/CameraSetUp.h"

#include "sdk/qncore/QnDoc.h"
#include "sdk/qncore/QnGet.h"
#include "sdk/qncore/QnLocalize.h"
#include "zoetrix/commands/EndWith.h"
#include "zoetrix/commands/cmdZoetrix.h"

#include <cstdlib>

int AskFrameCount(int& frame_count) {
    CQuarnGetInteger prompt;
    prompt.SetCommandPrompt(QnLocalizeString(L"Number of frames", 40005));
    prompt.SetDefaultInteger(frame_count);
    prompt.SetLowerLimit(1.0, true);
    prompt.GetNumber();
    if (prompt.CommandResult() != CQuarnCommand::success)
        return EndWith(L"Invalid number of frames. Nothing done\n", 40006, prompt.CommandResult());
    frame_count = std::abs(prompt.Number());
    return CQuarnCommand::success;
}

int AskForPath(const wchar_t* prompt, unsigned int filter, const KM_UUID& last_id,
               CQuarnObjRef& path) {
    CQuarnGetObject pick;
    pick.EnablePreSelect(false, true);
    pick.SetCommandPrompt(prompt);
    pick.AcceptNothing(true);
    pick.SetGeometryFilter(filter);
    pick.GetObjects(1, 1);
    if (pick.CommandResult() == CQuarnCommand::success)
        path = pick.Result() == CQuarnGet::nothing ? CQuarnObjRef(last_id) : pick.Object(0);
    return pick.CommandResult();
}

NameRepair RepairName(KM_wString& name) {
    if (IsValidFileName(name))
        return NameRepair::not_needed;
    return ReplaceInvalidFileChar(name) > 0 ? NameRepair::done : NameRepair::impossible;
}

int EndWithoutCameraPoints() {
    return EndWith(L"Failed to divide camera path. Nothing done\n", 40014, CQuarnCommand::failure);
}

void StoreAnimation(CQuarnDoc& doc, KM_3dmAnimationProperties& props,
                    KM_3dmAnimationProperties::CaptureTypes type, int frame_count) {
    props.SetCaptureType(type);
    props.SetCurrentFrame(0);
    props.SetFrameCount(frame_count);
    doc.Properties().SetAnimationProperties(props);
}
