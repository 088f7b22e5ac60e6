#pragma once

#include "kelmar/KM_Uuid.h"
#include "kelmar/KM_wString.h"

#include <vector>

/// A display mode as the set-up commands offer it.
struct DisplayModeChoice {
    KM_wString local_name; ///< as QnCaptureOptionName has them
    KM_wString english_name;
    KM_UUID id;
};

/// The host's display modes in its order.
/// @param sun_filter  only those in which a sun study can be seen
std::vector<DisplayModeChoice> ListDisplayModes(bool sun_filter);
