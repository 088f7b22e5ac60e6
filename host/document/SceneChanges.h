#pragma once

#include "kelmar/KM_Light.h"
#include "kelmar/KM_Uuid.h"

#include <optional>
#include <vector>

namespace quarn {

/// What one picture shows otherwise than its document, which stays as it is.
struct SceneChanges {
    std::vector<KM_UUID> hidden; ///< objects that are left out; ids of none are passed over
    std::optional<KM_Light> sun; ///< of a sun study, in the place of all lights
};

} // namespace quarn
