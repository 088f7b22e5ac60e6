#pragma once

#include "host/cities/Cities.h"
#include "quarn/arguments/OptionAdder.h"
#include "quarn/scripts/CivilSite.h"

#include <optional>
#include <string>

namespace quarn::program {

/// A city by its name.
Reading<const City*> cityName();

/// A place on the earth as it is typed.
struct TypedSite {
    const City* city = nullptr;
    std::optional<double> latitude_deg;
    std::optional<double> longitude_deg;
    std::string zone;
};

/// Adds --place, --latitude, --longitude and --zone.
void addSite(const OptionAdder& add, TypedSite& typed);

/// Whether a place was typed at all.
bool isTyped(const TypedSite& typed);

/// Takes what was typed together.
/// @return what does not go together, or which zone there is not; else nothing
std::optional<std::string> settleSite(const TypedSite& typed, CivilSite& site);

/// The zone of a place, where nobody typed one: that of the nearest known city.
std::optional<std::string> settleZone(const std::string& typed_zone, CivilSite& site);

} // namespace quarn::program
