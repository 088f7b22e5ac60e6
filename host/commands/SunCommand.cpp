#include "host/app/Application.h"
#include "host/commands/CommandEnd.h"
#include "host/commands/HostCommands.h"
#include "host/commands/NumberPrompt.h"
#include "host/commands/SunPlacePrompt.h"
#include "host/commands/SunText.h"
#include "host/document/Document.h"
#include "host/document/SunDirection.h"
#include "sdk/qncore/QnGet.h"

namespace quarn {

namespace {

void print(const KM_wString& text) {
    Application::current()->print(text.View());
}

CQuarnCommand::result showSun(const DocumentSun& sun) {
    print(sunText(sun));
    if (sun.isEnabled() && sun.directionToSun().z < 0)
        print(L"The sun is below the horizon: nothing is in its light.\n");
    return CQuarnCommand::success;
}

CQuarnCommand::result enable(DocumentSun& sun, bool enabled) {
    sun.beginChange();
    sun.setEnabled(enabled);
    sun.endChange();
    return showSun(sun);
}

/// A sun that is put somewhere is there to be seen: it is turned on.
CQuarnCommand::result moveTo(DocumentSun& sun, const SunPosition& position) {
    sun.beginChange();
    sun.setDirectionToSun(directionToSun(position));
    sun.setEnabled(true);
    sun.endChange();
    return showSun(sun);
}

CQuarnCommand::result moveByAngles(DocumentSun& sun) {
    SunPosition position = positionOfSun(sun.directionToSun());
    CQuarnCommand::result asked =
        askNumber(QnLocalizeString(L"Azimuth, clockwise from north (Y axis)", 42321), -360, 360,
                  position.azimuth_deg);
    if (asked == CQuarnCommand::success)
        asked = askNumber(QnLocalizeString(L"Altitude above the horizon", 42322), -90, 90,
                          position.altitude_deg);
    return asked == CQuarnCommand::success ? moveTo(sun, position) : asked;
}

/// What was asked for, and what came of it: which zone was taken is the usual doubt.
KM_wString whereAndWhen(const SunWish& wish, const SunPosition& position) {
    KM_wString text;
    if (wish.city)
        text += KM_wString::FromUtf8(std::string(wish.city->name) + ", " +
                                     std::string(wish.city->country) + ": ");
    text += L"latitude " + angleText(wish.site.latitude_deg) + L", longitude " +
            angleText(wish.site.longitude_deg) + L"\n";
    text += wish.clock.time.Format() + L" " + zoneText(wish.clock.zone_minutes) + L" is " +
            universalTime(wish.clock).Format() + L" universal time\n";
    return text + L"azimuth " + azimuthText(position.azimuth_deg) + L" from north, altitude " +
           angleText(position.altitude_deg) + L"\n";
}

CQuarnCommand::result moveByPlaceAndTime(DocumentSun& sun) {
    SunWish wish;
    const CQuarnCommand::result asked = askPlaceAndTime(wish);
    if (asked != CQuarnCommand::success)
        return asked;
    const auto position = sunPositionAt(wish.site, wish.clock);
    if (!position)
        return fail("The sun has no known position for this place and time.");
    print(whereAndWhen(wish, *position));
    return moveTo(sun, {position->azimuth_deg + wish.north_angle_deg, position->altitude_deg});
}

} // namespace

CQuarnCommand::result runSun(const CQuarnCommandContext& context) {
    DocumentSun& sun = Document::of(context.Document()).sun();
    CQuarnGetOption get;
    get.SetCommandPrompt(QnLocalizeString(L"Sun", 42320));
    get.AcceptNothing();
    const int on = get.AddCommandOption(QnLocalizeCommandOptionName(L"On", 42320));
    const int off = get.AddCommandOption(QnLocalizeCommandOptionName(L"Off", 42321));
    const int direction = get.AddCommandOption(QnLocalizeCommandOptionName(L"Direction", 42322));
    get.AddCommandOption(QnLocalizeCommandOptionName(L"PlaceAndTime", 42323));
    const CQuarnGet::result answer = get.GetOption();
    if (answer == CQuarnGet::nothing)
        return showSun(sun);
    if (answer == CQuarnGet::string)
        return failForWord(get.String(), "On, Off, Direction, PlaceAndTime or _Enter");
    if (answer != CQuarnGet::option)
        return get.CommandResult();
    const int picked = get.Option()->m_option_index;
    if (picked == on || picked == off)
        return enable(sun, picked == on);
    return picked == direction ? moveByAngles(sun) : moveByPlaceAndTime(sun);
}

} // namespace quarn
