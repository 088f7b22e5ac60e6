#include "host/commands/CommandEnd.h"
#include "host/commands/HostCommands.h"
#include "host/document/Document.h"
#include "sdk/qncore/QnGet.h"
#include "sdk/qncore/QnLocalize.h"
#include "sdk/qncore/QnZoetrixDynamicAccess.h"

namespace quarn {

namespace {

/// Puts the frames of a later part behind those of the first one. The record keeps when the first
/// part began, and takes when the later one ended.
void append(KM_3dmAnimationProperties& record, const KM_3dmAnimationProperties& later) {
    for (int frame = 0; frame < later.Dates().Count(); ++frame)
        record.Dates().Append(later.Dates()[frame]);
    for (int frame = 0; frame < later.CameraPoints().Count(); ++frame)
        record.CameraPoints().Append(later.CameraPoints()[frame]);
    for (int frame = 0; frame < later.TargetPoints().Count(); ++frame)
        record.TargetPoints().Append(later.TargetPoints()[frame]);
    record.SetFrameCount(record.FrameCount() + later.FrameCount());
    record.SetEndHour(later.EndHour());
    record.SetEndMinutes(later.EndMinutes());
    record.SetEndSeconds(later.EndSeconds());
}

CQuarnCommand::result appendToKept(Document& document, CQuarnDocProperties& properties,
                                   const KM_3dmAnimationProperties& later) {
    std::optional<KM_3dmAnimationProperties>& kept = document.firstPartOfStudy();
    if (!kept)
        return fail("No sun study was kept to put this one behind. Keep the first part with "
                    "JoinSunStudy Keep, then set up the part that follows.");
    if (kept->CaptureType() != later.CaptureType() || kept->Latitude() != later.Latitude() ||
        kept->Longitude() != later.Longitude() || kept->NorthAngle() != later.NorthAngle())
        return fail("The sun study that was kept is of another kind or place than this one: set "
                    "up both for the same.");
    append(*kept, later);
    properties.SetAnimationProperties(*kept);
    return CQuarnCommand::success;
}

} // namespace

/// A study whose frames fall on several dates of the clock that studies reckon in is set up date by
/// date: the first part is kept, and each that follows is put behind what was kept.
CQuarnCommand::result runJoinSunStudy(const CQuarnCommandContext& context) {
    if (!Zoetrix_QuarnDynamicAccess())
        return fail("No plug-in keeps an animation. Load one with LoadPlugIn first.");
    CQuarnDocProperties& properties = context.Document().Properties();
    const KM_3dmAnimationProperties record = properties.AnimationProperties();
    if (!record.IsSunStudy())
        return fail("There is no sun study to keep or to append. Set one up with "
                    "SetOneDaySunAnimation.");
    Document& document = Document::of(context.Document());
    CQuarnGetOption get;
    get.SetCommandPrompt(QnLocalizeString(L"Part of the sun study", 42941));
    const int keep = get.AddCommandOption(QnLocalizeCommandOptionName(L"Keep", 42942));
    get.AddCommandOption(QnLocalizeCommandOptionName(L"Append", 42943));
    if (get.GetOption() != CQuarnGet::option)
        return get.CommandResult();
    if (get.Option()->m_option_index != keep)
        return appendToKept(document, properties, record);
    document.firstPartOfStudy() = record;
    return CQuarnCommand::success;
}

} // namespace quarn
