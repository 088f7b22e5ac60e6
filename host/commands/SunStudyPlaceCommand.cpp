#include "host/clock/Zone.h"
#include "host/commands/CommandEnd.h"
#include "host/commands/HostCommands.h"
#include "host/document/Document.h"
#include "sdk/qncore/QnGet.h"
#include "sdk/qncore/QnLocalize.h"
#include "sdk/qncore/QnZoetrixDynamicAccess.h"

namespace quarn {

/// Names the place of the document's sun study, and the clocks that its frames are told by.
CQuarnCommand::result runSunStudyPlace(const CQuarnCommandContext& context) {
    if (!Zoetrix_QuarnDynamicAccess())
        return fail("No plug-in keeps an animation. Load one with LoadPlugIn first.");
    const KM_3dmAnimationProperties record = context.Document().Properties().AnimationProperties();
    StudiedPlace place{{}, {}, record.Latitude(), record.Longitude()};
    CQuarnGetString city;
    city.SetCommandPrompt(QnLocalizeString(L"Name of the place of the sun study", 42945));
    if (city.GetString() != CQuarnGet::string)
        return city.CommandResult();
    CQuarnGetString zone;
    zone.SetCommandPrompt(
        QnLocalizeString(L"Its time zone, such as Europe/Berlin, +05:30 or solar", 42946));
    if (zone.GetString() != CQuarnGet::string)
        return zone.CommandResult();
    const auto known = Zone::written(KM_wString(zone.String()).ToUtf8(), record.Longitude());
    if (!known)
        return fail(known.message());
    place.city = city.String();
    place.zone = KM_wString::FromUtf8(known.value().name());
    Document::of(context.Document()).setStudiedPlace(place);
    return CQuarnCommand::success;
}

} // namespace quarn
