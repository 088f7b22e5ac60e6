#include "host/app/Application.h"
#include "host/border/Border.h"
#include "host/commands/CommandEnd.h"
#include "host/commands/FormAsking.h"
#include "host/commands/HostCommands.h"
#include "host/commands/NumberPrompt.h"
#include "host/commands/SunForm.h"
#include "host/commands/SunPlacePrompt.h"
#include "host/commands/SunText.h"
#include "host/document/Document.h"
#include "host/sun/SunDirection.h"
#include "sdk/qncore/QnGet.h"
#include "sdk/qncore/QnZoetrixDynamicAccess.h"
#include "sdk/zel/QnZone.h"

#include <cmath>

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
        text += KM_wString::FromUtf8(nameWithCountry(*wish.city) + ": ");
    text += L"latitude " + angleText(wish.site.latitude_deg) + L", longitude " +
            angleText(wish.site.longitude_deg) + L"\n";
    text += wish.clock.time.Format() + L" " + QnZoneText(wish.clock.zone_minutes) + L" is " +
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
    sun.setLastPlaceAndTime({wish.site, wish.clock, wish.north_angle_deg});
    return moveTo(sun, {position->azimuth_deg + wish.north_angle_deg, position->altitude_deg});
}

bool isOnEarth(const KM_3dmAnimationProperties& record) {
    return std::abs(record.Latitude()) <= 90 && std::abs(record.Longitude()) <= 180;
}

/// Where a record has its sun study, at noon of the first day.
PlaceAndTime placeAndTimeOf(const KM_3dmAnimationProperties& record) {
    PlaceAndTime study;
    study.site = {record.Latitude(), record.Longitude()};
    study.clock.time = {record.StartYear(), record.StartMonth(), record.StartDay(), 12, 0, 0};
    study.clock.zone_minutes = 60 * QnZoneOfLongitude(record.Longitude());
    study.north_angle_deg = record.NorthAngle();
    return study;
}

/// The place and time that a form begins with: the last ones, else those of the document's sun
/// study. The record is looked at in place, as a copy of its point lists may be long; one from a
/// file may hold what is no place and no day.
PlaceAndTime placeAndTimeToOffer(Document& document) {
    if (document.sun().lastPlaceAndTime())
        return *document.sun().lastPlaceAndTime();
    if (const IQnZoetrixDynamicAccess* access = Zoetrix_QuarnDynamicAccess()) {
        const auto record =
            acrossBorder([&] { return &access->AnimationProperties(document.face()); });
        if (record && isOnEarth(*record.value())) {
            const PlaceAndTime study = placeAndTimeOf(*record.value());
            if (sunPositionAt(study.site, study.clock))
                return study;
        }
    }
    return placeAndTimeOf({});
}

CQuarnCommand::result takeOver(const SunForm& form, DocumentSun& sun) {
    const PlaceAndTime& entered = form.placeAndTime();
    sun.setLastPlaceAndTime(entered);
    if (form.isByPlaceAndTime()) {
        SunWish wish;
        wish.site = entered.site;
        wish.clock = entered.clock;
        if (const auto position = sunPositionAt(wish.site, wish.clock))
            print(whereAndWhen(wish, *position));
    }
    sun.beginChange();
    if (const auto position = form.movedTo())
        sun.setDirectionToSun(directionToSun(*position));
    sun.setEnabled(form.isEnabled());
    sun.endChange();
    return showSun(sun);
}

CQuarnCommand::result askAndMove(DocumentSun& sun) {
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
        return CQuarnCommand::failure;
    if (answer != CQuarnGet::option)
        return get.CommandResult();
    const int picked = get.Option()->m_option_index;
    if (picked == on || picked == off)
        return enable(sun, picked == on);
    return picked == direction ? moveByAngles(sun) : moveByPlaceAndTime(sun);
}

} // namespace

CQuarnCommand::result runSun(const CQuarnCommandContext& context) {
    Document& document = Document::of(context.Document());
    DocumentSun& sun = document.sun();
    if (!mayAskInForm(context))
        return askAndMove(sun);
    SunForm form(sun, placeAndTimeToOffer(document));
    const auto answered = askInForm(context, form);
    if (!answered)
        return askAndMove(sun);
    return *answered == CQuarnCommand::success ? takeOver(form, sun) : *answered;
}

} // namespace quarn
