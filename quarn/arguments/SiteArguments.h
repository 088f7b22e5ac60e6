#pragma once

#include "host/almanac/CivilSite.h"
#include "quarn/arguments/OptionAdder.h"

#include <filesystem>
#include <optional>
#include <string>

namespace quarn::program {

/// A place on the earth as it is typed.
struct TypedSite {
    const City* city = nullptr;
    std::optional<double> latitude_deg;
    std::optional<double> longitude_deg;
    std::optional<double> north_deg;
    std::string zone; ///< empty: that of the place
};

/// Adds --place, --latitude, --longitude and --zone.
void addSite(const OptionAdder& add, TypedSite& typed);

/// Adds the same, of a model that may state its place itself, and --north.
void addSiteOfModel(const OptionAdder& add, TypedSite& typed);

/// A place with its clocks, and what a person should know of them.
struct SettledSite {
    CivilSite site;
    bool is_stated = false; ///< by the model, not typed
    bool has_north = false; ///< typed or stated; else the Y axis counts as north
    std::string zone_note;  ///< a sentence without its full stop; empty: nothing
};

/// Takes what was typed together; where no place was, the one that the model's file states.
/// @param model  empty: there is none
/// @return why there is no place, or no such zone
Result<SettledSite> settleSite(const TypedSite& typed, const std::filesystem::path& model);

} // namespace quarn::program
