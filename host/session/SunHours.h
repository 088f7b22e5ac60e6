#pragma once

#include "ground/Result.h"
#include "host/sunhours/SunHoursRequest.h"
#include "sdk/qncore/QnExport.h"

#include <functional>
#include <vector>

class CQuarnDoc;

namespace quarn {

/// What was found, and where it stands.
struct SunHoursFiles {
    std::vector<std::filesystem::path> files; ///< the picture first
    double most_hours = 0.0;  ///< that the sun is above the horizon in a day, on average
    std::size_t steps = 0;    ///< 0 in a polar night: then no place has any sun
    bool is_given_up = false; ///< by who watched: nothing was written
};

/// The files that makeSunHours writes, and replaces where they are there.
QNCORE_API std::vector<std::filesystem::path> sunHoursFiles(const SunHoursRequest& request);

/// Finds how many hours of direct sun the surfaces of a document get, and writes NAME-sunhours.png,
/// .npy, .csv and .html, with a grid .ply too, into the request's folder, which must be there.
/// @param watch  called some times a second with what is done, from 0 to 1; false ends the work
/// @return an error, sentences: no surface is shown, the year is out of range, the grid would be
///         too large, a file cannot be written
QNCORE_API Result<SunHoursFiles> makeSunHours(CQuarnDoc& document, const SunHoursRequest& request,
                                              const std::function<bool(double share)>& watch);

} // namespace quarn
