#pragma once

#include "sdk/qncore/QnDialogResult.h"
#include "sdk/qncore/QnExport.h"

/// Lets a person choose a place on the earth, by its coordinates, in a table of cities or on a map.
///
/// @param title      the window's title
/// @param latitude   degrees from -90 to 90, north positive; shown first, receives what was chosen
/// @param longitude  degrees from -180 to 180, east positive; likewise. Where either is outside, or
///                   no number, the place 0, 0 is shown first.
/// @return QnDialogConfirmed when a place was chosen; QnDialogGivenUp, with nothing changed, when
///         not, also where nobody can choose one, and, with a message, for what is no place on the
///         earth
QNCORE_API int QnShowLocationDialog(const wchar_t* title, double& latitude, double& longitude);
