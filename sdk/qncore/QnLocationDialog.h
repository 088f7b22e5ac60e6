#pragma once

#include "sdk/qncore/QnExport.h"

/// Lets a person choose a place on the earth, by its coordinates, in a table of cities or on a map.
///
/// @param title      the window's title
/// @param latitude   degrees, north positive; shown first, receives what was chosen
/// @param longitude  degrees, east positive; likewise
/// @return 1 when a place was chosen; 2, with nothing changed, when not, also where nobody can
///         choose one
QNCORE_API int QnShowLocationDialog(const wchar_t* title, double& latitude, double& longitude);
