// The sun as JSON.
#include "host/clock/WallText.h"
#include "quarn/reports/SunTelling.h"
#include "quarn/words/Words.h"

#include <nlohmann/json.hpp>

namespace quarn::program {

namespace {

using Json = nlohmann::ordered_json;

/// To ten-thousandths of a degree: the sun is known to hundredths.
double rounded(double degrees) {
    return realNumber(fixedText(degrees, 4)).value_or(degrees);
}

Json jsonOf(const Zone& zone, const SunDay& day) {
    Json json = {{"date", dateText(std::chrono::year_month_day(day.date))},
                 {"day_length_s", day.sun.day_length.count()},
                 {"events", Json::array()}};
    if (const std::string course = nameOf(day.sun.course); !course.empty())
        json["course"] = course;
    for (const SunEvent& event : day.sun.events)
        json["events"].push_back(
            {{"kind", nameOf(event.kind)}, {"time", isoTextWithOffset(zone.at(event.time))}});
    return json;
}

} // namespace

std::string jsonOf(const SunRequest& request, const SunTelling& telling) {
    const CivilSite& site = request.site;
    Json json = {{"latitude_deg", site.latitude_deg},
                 {"longitude_deg", site.longitude_deg},
                 {"zone", site.zone.name()},
                 {"notes", request.notes},
                 {"days", Json::array()},
                 {"positions", Json::array()}};
    if (!site.place.empty())
        json["place"] = site.place;
    for (const SunDay& day : telling.days)
        json["days"].push_back(jsonOf(site.zone, day));
    for (const TimedSun& sun : telling.positions)
        json["positions"].push_back({{"time", isoTextWithOffset(site.zone.at(sun.time))},
                                     {"azimuth_deg", rounded(sun.position.azimuth_deg)},
                                     {"altitude_deg", rounded(sun.position.altitude_deg)}});
    return json.dump(2, ' ', false, Json::error_handler_t::replace) + "\n";
}

} // namespace quarn::program
