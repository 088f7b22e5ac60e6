#pragma once

#include "kelmar/KM_Light.h"
#include "kelmar/KM_Uuid.h"

#include <optional>
#include <vector>

namespace quarn {

/// What one picture shows otherwise than its document, which stays as it is.
struct SceneChanges {
    /// A light in the place of the document's sun.
    struct Sun {
        KM_Light light;
        int replaced_light = -1; ///< index in the light table of one that goes out; -1 for none
    };

    std::vector<KM_UUID> hidden; ///< objects that are left out; ids of none are passed over
    std::optional<Sun> sun;
};

} // namespace quarn
