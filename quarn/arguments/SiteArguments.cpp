#include "quarn/arguments/SiteArguments.h"

#include "host/session/StatedSite.h"
#include "quarn/arguments/Readings.h"

namespace quarn::program {

namespace {

Reading<const City*> cityName() {
    return [](const std::string& option,
              const std::string& word) -> std::variant<const City*, Refusal> {
        if (const City* const city = findCity(word))
            return city;
        return Refusal{option + ": " + whyNoCity(word) +
                       " quarn places lists those that are known."};
    };
}

void addPlace(const OptionAdder& add, TypedSite& typed, const std::string& of_city) {
    add("--place", typed.city, "NAME", cityName(), of_city);
    add("--latitude", typed.latitude_deg, "DEG", numberFrom(-90, 90, "degrees"),
        "Or: degrees north, -90 to 90");
    add("--longitude", typed.longitude_deg, "DEG", numberFrom(-180, 180, "degrees"),
        "and degrees east, -180 to 180; west is negative");
}

void addZone(const OptionAdder& add, TypedSite& typed) {
    add("--zone", typed.zone, "ZONE", scriptWord("the name of --zone"),
        "Clock: a name such as Europe/Berlin, a distance from UTC such as +05:30, or solar for the "
        "mean time of the longitude (default: that of the city, or of the nearest one)");
}

/// Takes the place that the model's file states.
/// @return why there is none
std::optional<std::string> settleByModel(const std::filesystem::path& model, SettledSite& settled) {
    const bool has_model = !model.empty();
    const auto stated = has_model ? statedSite(model) : std::nullopt;
    if (!stated)
        return std::string("say where") + (has_model ? " the model stands" : "") +
               " with --place, or with --latitude and --longitude; quarn places lists the places.";
    settled.site.place = "As " + model.filename().native() + " states";
    settled.site.latitude_deg = stated->latitude_deg;
    settled.site.longitude_deg = stated->longitude_deg;
    settled.site.north_deg = stated->north_angle_deg;
    settled.is_stated = settled.has_north = true;
    return std::nullopt;
}

/// The place, without its clocks.
std::optional<std::string> settlePlace(const TypedSite& typed, const std::filesystem::path& model,
                                       SettledSite& settled) {
    CivilSite& site = settled.site;
    const bool has_coordinate = typed.latitude_deg || typed.longitude_deg;
    if (typed.city && has_coordinate)
        return "give either --place, or --latitude and --longitude.";
    if (has_coordinate && !(typed.latitude_deg && typed.longitude_deg))
        return "--latitude and --longitude go together.";
    if (!typed.city && !has_coordinate)
        return settleByModel(model, settled);
    site.place = typed.city ? nameWithCountry(*typed.city) : "";
    site.latitude_deg = typed.city ? typed.city->latitude_deg : *typed.latitude_deg;
    site.longitude_deg = typed.city ? typed.city->longitude_deg : *typed.longitude_deg;
    return std::nullopt;
}

} // namespace

void addSite(const OptionAdder& add, TypedSite& typed) {
    addPlace(add, typed, "City; quarn places lists them");
    addZone(add, typed);
}

void addSiteOfModel(const OptionAdder& add, TypedSite& typed) {
    addPlace(add, typed,
             "City; quarn places lists them. An IFC file may state its own place and north, which "
             "count where these options are left out");
    add("--north", typed.north_deg, "DEG", numberFrom(-360, 360, "degrees"),
        "Where north is in the model, in degrees clockwise from its Y axis (default: 0)");
    addZone(add, typed);
}

Result<SettledSite> settleSite(const TypedSite& typed, const std::filesystem::path& model) {
    SettledSite settled;
    if (const auto mistake = settlePlace(typed, model, settled))
        return Error{*mistake};
    if (typed.north_deg) {
        settled.site.north_deg = *typed.north_deg;
        settled.has_north = true;
    }
    const auto nearest = giveZone(settled.site, typed.zone);
    if (!nearest)
        return Error{(typed.zone.empty() ? "" : "--zone: ") + nearest.message()};
    if (nearest.value())
        settled.zone_note = "The clock is that of " + nameWithCountry(*nearest.value()) +
                            ", the nearest city known; --zone takes another";
    return settled;
}

} // namespace quarn::program
