#pragma once

#include "engine/scene/LightSettings.h"

#include <filesystem>
#include <optional>

namespace quarn {

/// What a document is to be lit by beside its own lights, as a person chose it.
struct LightChoice {
    static constexpr double most_stops = 10.0;

    Surroundings surroundings = Surroundings::automatic;
    std::filesystem::path picture;  ///< absolute path of a file, for Surroundings::picture
    std::optional<double> exposure; ///< in stops, -most_stops to most_stops; none: automatic
    BackgroundKind background = BackgroundKind::automatic;
    KM_Color background_color{255, 255, 255, 255}; ///< for BackgroundKind::color
    bool has_ground = true;

    friend bool operator==(const LightChoice&, const LightChoice&) = default;
};

} // namespace quarn
