#include "sdk/qncore/QnDoc.h"
#include "sdk/qncore/QnGet.h"
#include "sdk/qncore/QnLocalize.h"
#include "zoetrix/commands/CommandGuard.h"
#include "zoetrix/commands/EndWith.h"
#include "zoetrix/commands/cmdZoetrix.h"
#include "zoetrix/plugin/ZoetrixPlugIn.h"

#include <cstdlib>
#include <limits>

namespace {

constexpr const wchar_t* nothing_to_view =
    L"No animation is currently set. There is nothing to view\n";
constexpr const wchar_t* no_frame_to_view =
    L"No animation is currently set. There is no frame to view\n";

/// Shows one frame, or all for a negative one, and remembers the frame shown last.
int Show(CQuarnDoc& doc, KM_3dmAnimationProperties& props, int frame) {
    const int shown = PreviewAnimation(doc, props, frame, false);
    if (shown == CQuarnCommand::success)
        doc.Properties().SetAnimationProperties(props);
    return shown;
}

/// Shows the frame that `frame_of` picks for the record; where there is no animation, prints why
/// there is nothing to show.
template <class FrameOf>
int ShowFrame(CQuarnDoc& doc, const wchar_t* no_animation, int no_animation_id,
              FrameOf&& frame_of) {
    KM_3dmAnimationProperties props = ZoetrixPlugIn().AnimationProperties(doc);
    if (!props.IsPlayable())
        return EndWith(no_animation, no_animation_id, CQuarnCommand::failure);
    return Show(doc, props, frame_of(props));
}

/// The frame before the one shown last; before the first comes the last. A stored frame out of
/// range is stepped from as it is.
int FrameBefore(const KM_3dmAnimationProperties& props) {
    const int current = props.CurrentFrame();
    if (current == 0)
        return props.FrameCount() - 1;
    return current == std::numeric_limits<int>::min() ? current : current - 1;
}

/// The frame after the one shown last; after the last comes the first. A stored frame out of range
/// is stepped from as it is.
int FrameAfter(const KM_3dmAnimationProperties& props) {
    const int current = props.CurrentFrame();
    if (current == props.FrameCount() - 1)
        return 0;
    return current == std::numeric_limits<int>::max() ? current : current + 1;
}

/// Asks for a frame.
/// @param frame  receives the answer
/// @return success, or how the prompt ended
int AskFrame(const KM_3dmAnimationProperties& props, int& frame) {
    CQuarnGetInteger prompt;
    prompt.SetCommandPrompt(QnLocalizeString(L"Frame to go to", 16782));
    prompt.SetDefaultInteger(props.CurrentFrame());
    prompt.SetLowerLimit(0, true);
    prompt.SetUpperLimit(props.FrameCount() - 1, true);
    prompt.GetNumber();
    if (prompt.CommandResult() != CQuarnCommand::success)
        return EndWith(L"Invalid number of frames. Nothing done\n", 16783, prompt.CommandResult());
    frame = std::abs(prompt.Number());
    return CQuarnCommand::success;
}

int ShowAskedFrame(CQuarnDoc& doc) {
    KM_3dmAnimationProperties props = ZoetrixPlugIn().AnimationProperties(doc);
    if (!props.IsPlayable())
        return EndWith(no_frame_to_view, 16781, CQuarnCommand::failure);
    int frame = 0;
    if (const int ended = AskFrame(props, frame); ended != CQuarnCommand::success)
        return ended;
    return Show(doc, props, frame);
}

} // namespace

CCommandPlayAnimation::CCommandPlayAnimation() : CQuarnCommand(false, false, nullptr, false) {}

CCommandPlayAnimation::~CCommandPlayAnimation() = default;

KM_UUID CCommandPlayAnimation::CommandUUID() {
    // CDCA99EF-EF0F-4DE3-85A7-C63CB2BD0F15
    return {0xCDCA99EF, 0xEF0F, 0x4DE3, {0x85, 0xA7, 0xC6, 0x3C, 0xB2, 0xBD, 0x0F, 0x15}};
}

const wchar_t* CCommandPlayAnimation::EnglishCommandName() {
    return L"PlayAnimation";
}

const wchar_t* CCommandPlayAnimation::CommandDescription() {
    return QnLocalizeString(L"Shows all frames of the animation", 40101);
}

CQuarnCommand::result CCommandPlayAnimation::RunCommand(const CQuarnCommandContext& context) {
    return RunGuarded([&context] {
        return ShowFrame(context.Document(), nothing_to_view, 16776,
                         [](const KM_3dmAnimationProperties&) { return -1; });
    });
}

CCommandViewFirstFrame::CCommandViewFirstFrame() : CQuarnCommand(false, false, nullptr, false) {}

CCommandViewFirstFrame::~CCommandViewFirstFrame() = default;

KM_UUID CCommandViewFirstFrame::CommandUUID() {
    // 01DC4D43-8287-424B-8E6F-72A4E67BDE55
    return {0x01DC4D43, 0x8287, 0x424B, {0x8E, 0x6F, 0x72, 0xA4, 0xE6, 0x7B, 0xDE, 0x55}};
}

const wchar_t* CCommandViewFirstFrame::EnglishCommandName() {
    return L"ViewFirstFrame";
}

const wchar_t* CCommandViewFirstFrame::CommandDescription() {
    return QnLocalizeString(L"Shows the animation's first frame", 40102);
}

CQuarnCommand::result CCommandViewFirstFrame::RunCommand(const CQuarnCommandContext& context) {
    return RunGuarded([&context] {
        return ShowFrame(context.Document(), no_frame_to_view, 16777,
                         [](const KM_3dmAnimationProperties&) { return 0; });
    });
}

CCommandViewLastFrame::CCommandViewLastFrame() : CQuarnCommand(false, false, nullptr, false) {}

CCommandViewLastFrame::~CCommandViewLastFrame() = default;

KM_UUID CCommandViewLastFrame::CommandUUID() {
    // 1683D016-E18C-475B-BF04-3D119A7042CC
    return {0x1683D016, 0xE18C, 0x475B, {0xBF, 0x04, 0x3D, 0x11, 0x9A, 0x70, 0x42, 0xCC}};
}

const wchar_t* CCommandViewLastFrame::EnglishCommandName() {
    return L"ViewLastFrame";
}

const wchar_t* CCommandViewLastFrame::CommandDescription() {
    return QnLocalizeString(L"Shows the animation's last frame", 40103);
}

CQuarnCommand::result CCommandViewLastFrame::RunCommand(const CQuarnCommandContext& context) {
    return RunGuarded([&context] {
        return ShowFrame(
            context.Document(), no_frame_to_view, 16778,
            [](const KM_3dmAnimationProperties& props) { return props.FrameCount() - 1; });
    });
}

CCommandViewPreviousFrame::CCommandViewPreviousFrame()
    : CQuarnCommand(false, false, nullptr, false) {}

CCommandViewPreviousFrame::~CCommandViewPreviousFrame() = default;

KM_UUID CCommandViewPreviousFrame::CommandUUID() {
    // 2885F440-04BB-44DB-947C-588E7AFA5843
    return {0x2885F440, 0x04BB, 0x44DB, {0x94, 0x7C, 0x58, 0x8E, 0x7A, 0xFA, 0x58, 0x43}};
}

const wchar_t* CCommandViewPreviousFrame::EnglishCommandName() {
    return L"ViewPreviousFrame";
}

const wchar_t* CCommandViewPreviousFrame::CommandDescription() {
    return QnLocalizeString(L"Shows the frame before the one shown last", 40104);
}

CQuarnCommand::result CCommandViewPreviousFrame::RunCommand(const CQuarnCommandContext& context) {
    return RunGuarded(
        [&context] { return ShowFrame(context.Document(), no_frame_to_view, 16779, FrameBefore); });
}

CCommandViewNextFrame::CCommandViewNextFrame() : CQuarnCommand(false, false, nullptr, false) {}

CCommandViewNextFrame::~CCommandViewNextFrame() = default;

KM_UUID CCommandViewNextFrame::CommandUUID() {
    // 4C469EE8-C86C-4360-AF5E-399364C9548C
    return {0x4C469EE8, 0xC86C, 0x4360, {0xAF, 0x5E, 0x39, 0x93, 0x64, 0xC9, 0x54, 0x8C}};
}

const wchar_t* CCommandViewNextFrame::EnglishCommandName() {
    return L"ViewNextFrame";
}

const wchar_t* CCommandViewNextFrame::CommandDescription() {
    return QnLocalizeString(L"Shows the frame after the one shown last", 40105);
}

CQuarnCommand::result CCommandViewNextFrame::RunCommand(const CQuarnCommandContext& context) {
    return RunGuarded(
        [&context] { return ShowFrame(context.Document(), no_frame_to_view, 16780, FrameAfter); });
}

CCommandViewFrameNumber::CCommandViewFrameNumber() : CQuarnCommand(false, false, nullptr, false) {}

CCommandViewFrameNumber::~CCommandViewFrameNumber() = default;

KM_UUID CCommandViewFrameNumber::CommandUUID() {
    // 3C6EDF7C-FBD0-47EE-A399-2E977058E95B
    return {0x3C6EDF7C, 0xFBD0, 0x47EE, {0xA3, 0x99, 0x2E, 0x97, 0x70, 0x58, 0xE9, 0x5B}};
}

const wchar_t* CCommandViewFrameNumber::EnglishCommandName() {
    return L"ViewFrameNumber";
}

const wchar_t* CCommandViewFrameNumber::CommandDescription() {
    return QnLocalizeString(L"Asks for a frame of the animation and shows it", 40106);
}

CQuarnCommand::result CCommandViewFrameNumber::RunCommand(const CQuarnCommandContext& context) {
    return RunGuarded([&context] { return ShowAskedFrame(context.Document()); });
}
