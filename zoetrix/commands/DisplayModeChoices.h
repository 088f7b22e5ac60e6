#pragma once

#include "kelmar/KM_Uuid.h"
#include "kelmar/KM_wString.h"

#include <vector>

/// A display mode as the set-up commands offer it.
struct DisplayModeChoice {
    /// The local name without "_", " ", "-" and ",", so that it can be an option's name; the
    /// rendered and the x-ray mode have names of their own.
    KM_wString local_name;
    /// The English name as the host has it; the rendered and the x-ray mode's are as above.
    KM_wString english_name;
    KM_UUID id;
};

/// The host's display modes in its order.
/// @param sun_filter  only shaded modes that use the document's lights or cast shadows
std::vector<DisplayModeChoice> ListDisplayModes(bool sun_filter);
