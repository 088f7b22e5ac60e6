#include "host/commands/SunPlacePrompt.h"

#include "host/app/Application.h"
#include "host/commands/NumberPrompt.h"
#include "host/commands/WordsLeft.h"
#include "host/prompt/NumberText.h"
#include "sdk/qncore/QnGet.h"
#include "sdk/zel/QnZone.h"

#include <cmath>

namespace quarn {

namespace {

/// Asks for text until it can be taken.
/// @param take  takes the text, or returns why it cannot
template <class Take> CQuarnCommand::result askText(const wchar_t* prompt, Take take) {
    CQuarnGetString get;
    get.SetCommandPrompt(prompt);
    for (;;) {
        const bool from_line = hasWordsLeft();
        if (get.GetString() != CQuarnGet::string)
            return get.CommandResult();
        const Result<void> taken = take(get.String());
        if (taken)
            return CQuarnCommand::success;
        Application::current()->tell(taken.message());
        if (!mayAskAgain(from_line))
            return CQuarnCommand::failure;
    }
}

class PlaceQuestion {
public:
    explicit PlaceQuestion(SunWish& wish) : m_wish(wish), m_is_line(hasWordsLeft()) {}

    CQuarnCommand::result run() {
        CQuarnCommand::result asked = askPlace();
        if (asked == CQuarnCommand::success)
            asked = askTime();
        if (asked != CQuarnCommand::success)
            return asked;
        m_wish.clock.zone_minutes = 60 * QnZoneOfLongitude(m_wish.site.longitude_deg);
        return askZoneAndNorth();
    }

private:
    CQuarnCommand::result askPlace() {
        const CQuarnCommand::result asked =
            askText(QnLocalizeString(L"City, or latitude", 42323),
                    [this](const wchar_t* text) { return takePlace(text); });
        if (asked != CQuarnCommand::success || m_wish.city)
            return asked;
        CQuarnGetNumber get;
        get.SetCommandPrompt(QnLocalizeString(L"Longitude, east positive", 42324));
        get.SetLowerLimit(-180);
        get.SetUpperLimit(180);
        if (get.GetNumber() == CQuarnGet::number)
            m_wish.site.longitude_deg = get.Number();
        return get.CommandResult();
    }

    Result<void> takePlace(const wchar_t* text) {
        if (const auto latitude = readNumber(text)) {
            if (std::abs(*latitude) > 90)
                return Error{"A latitude is a number from -90 to 90, not " +
                             numberText(*latitude).ToUtf8() + "."};
            m_wish.site.latitude_deg = *latitude;
            return {};
        }
        const std::string name = KM_wString(text).ToUtf8();
        m_wish.city = findCity(name);
        if (!m_wish.city)
            return Error{whyNoCity(name) + " A name with blanks stands in double quotes. Any place "
                                           "can be given by its latitude and longitude."};
        m_wish.site = {m_wish.city->latitude_deg, m_wish.city->longitude_deg};
        return {};
    }

    CQuarnCommand::result askTime() {
        bool has_time_of_day = false;
        const CQuarnCommand::result asked =
            askText(QnLocalizeString(L"Date and time, such as 2026-06-21 14:30", 42325),
                    [&](const wchar_t* text) -> Result<void> {
                        const auto written = readDateTime(text);
                        if (!written)
                            return written.error();
                        m_wish.clock.time = written.value().time;
                        has_time_of_day = written.value().has_time_of_day;
                        return {};
                    });
        if (asked != CQuarnCommand::success || has_time_of_day)
            return asked;
        return askText(QnLocalizeString(L"Time of day, such as 14:30", 42326),
                       [this](const wchar_t* text) -> Result<void> {
                           const auto time = readTimeOfDay(m_wish.clock.time, text);
                           if (!time)
                               return time.error();
                           m_wish.clock.time = time.value();
                           return {};
                       });
    }

    CQuarnCommand::result askZoneAndNorth() {
        while (!m_is_line || hasWordsLeft()) {
            CQuarnGetOption get;
            get.SetCommandPrompt(QnLocalizeString(L"Enter to set the sun", 42327));
            get.AcceptNothing();
            const int zone = get.AddCommandOption(QnLocalizeCommandOptionName(L"TimeZone", 42324),
                                                  valueOf(zoneHours()));
            get.AddCommandOption(QnLocalizeCommandOptionName(L"NorthAngle", 42325),
                                 valueOf(m_wish.north_angle_deg));
            const CQuarnGet::result answer = get.GetOption();
            if (answer == CQuarnGet::nothing)
                return CQuarnCommand::success;
            if (answer == CQuarnGet::string)
                return CQuarnCommand::failure;
            if (answer != CQuarnGet::option)
                return get.CommandResult();
            const CQuarnCommand::result asked =
                get.Option()->m_option_index == zone ? askZone() : askNorth();
            if (asked != CQuarnCommand::success)
                return asked;
        }
        return CQuarnCommand::success;
    }

    static CQuarnCommandOptionValue valueOf(double number) {
        const KM_wString text = numberText(number);
        return {text, text};
    }

    double zoneHours() const { return m_wish.clock.zone_minutes / 60.0; }

    CQuarnCommand::result askZone() {
        double hours = zoneHours();
        const CQuarnCommand::result asked =
            askNumber(QnLocalizeString(L"Hours that clocks are ahead of universal time", 42328),
                      -24, 24, hours);
        m_wish.clock.zone_minutes = static_cast<int>(std::lround(hours * 60));
        return asked;
    }

    CQuarnCommand::result askNorth() {
        return askNumber(QnLocalizeString(L"North angle (clockwise from Y axis)", 42329), -360, 360,
                         m_wish.north_angle_deg);
    }

    SunWish& m_wish;
    bool m_is_line;
};

} // namespace

CQuarnCommand::result askPlaceAndTime(SunWish& wish) {
    return PlaceQuestion(wish).run();
}

} // namespace quarn
