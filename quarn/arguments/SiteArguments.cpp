#include "quarn/arguments/SiteArguments.h"

#include "quarn/arguments/Readings.h"

namespace quarn::program {

namespace {

std::optional<std::string> takeZone(std::string_view name, CivilSite& site) {
    Result<Zone> zone = Zone::written(name, site.longitude_deg);
    if (!zone)
        return zone.message();
    site.zone = std::move(zone.value());
    return std::nullopt;
}

} // namespace

Reading<const City*> cityName() {
    return [](const std::string& option,
              const std::string& word) -> std::variant<const City*, Refusal> {
        if (const City* const city = findCity(word))
            return city;
        return Refusal{option + ": " + whyNoCity(word) +
                       " quarn places lists those that are known."};
    };
}

void addSite(const OptionAdder& add, TypedSite& typed) {
    add("--place", typed.city, "NAME", cityName(), "City; quarn places lists them");
    add("--latitude", typed.latitude_deg, "DEG", numberFrom(-90, 90, "degrees"),
        "Or: degrees north, -90 to 90");
    add("--longitude", typed.longitude_deg, "DEG", numberFrom(-180, 180, "degrees"),
        "and degrees east, -180 to 180; west is negative");
    add("--zone", typed.zone, "ZONE", scriptWord("the name of --zone"),
        "Clock: a name such as Europe/Berlin, a distance from UTC such as +05:30, or solar for the "
        "mean time of the longitude (default: that of the city, or of the nearest one)");
}

bool isTyped(const TypedSite& typed) {
    return typed.city || typed.latitude_deg || typed.longitude_deg;
}

std::optional<std::string> settleSite(const TypedSite& typed, CivilSite& site) {
    const bool has_coordinate = typed.latitude_deg || typed.longitude_deg;
    if (typed.city && has_coordinate)
        return "give either --place, or --latitude and --longitude.";
    if (!typed.city && !has_coordinate)
        return "say where with --place, or with --latitude and --longitude; quarn places lists "
               "the places.";
    if (has_coordinate && !(typed.latitude_deg && typed.longitude_deg))
        return "--latitude and --longitude go together.";
    if (typed.city) {
        site.place = nameWithCountry(*typed.city);
        site.latitude_deg = typed.city->latitude_deg;
        site.longitude_deg = typed.city->longitude_deg;
        return takeZone(typed.zone.empty() ? typed.city->zone : typed.zone, site);
    }
    site.latitude_deg = *typed.latitude_deg;
    site.longitude_deg = *typed.longitude_deg;
    return settleZone(typed.zone, site);
}

std::optional<std::string> settleZone(const std::string& typed_zone, CivilSite& site) {
    if (!typed_zone.empty())
        return takeZone(typed_zone, site);
    const City& city = nearestCity(site.latitude_deg, site.longitude_deg);
    site.zone_origin = nameWithCountry(city);
    return takeZone(city.zone, site);
}

} // namespace quarn::program
