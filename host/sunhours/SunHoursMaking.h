#pragma once

#include "host/document/Document.h"
#include "host/sunhours/SunHoursRequest.h"

#include <filesystem>
#include <functional>
#include <vector>

namespace quarn {

/// What came of it.
struct SunHoursReport {
    std::vector<std::filesystem::path> files; ///< that stand written, the picture first
    double most_hours = 0.0;                  ///< of sun that a day has, on average
    std::size_t steps = 0;                    ///< with the sun above the horizon
    bool is_given_up = false;                 ///< by who watched: nothing was written
};

/// The files that a request is answered with, the picture first.
std::vector<std::filesystem::path> filesOf(const SunHoursRequest& request);

/// Finds the hours of sun of a document's surfaces and writes picture, numbers, table and page;
/// each file appears whole or not at all.
/// @param page_template  sunhours.html
/// @param watch  called some times a second with what is done, from 0 to 1; false ends the work
/// @return an error, sentences: the document shows no surface, the sun has no positions for a year,
///         the scene cannot be built, a file cannot be written
Result<SunHoursReport> writeSunHours(Document& document, const SunHoursRequest& request,
                                     const std::filesystem::path& page_template,
                                     const std::function<bool(double share)>& watch);

} // namespace quarn
