#pragma once

#include "sdk/qncore/QnExport.h"

#include <chrono>

namespace quarn {

/// The instants of a year at which the apparent longitude of the sun is a multiple of 90 degrees:
/// UTC, to the nearest second.
struct Seasons {
    std::chrono::sys_seconds march_equinox;
    std::chrono::sys_seconds june_solstice;
    std::chrono::sys_seconds september_equinox;
    std::chrono::sys_seconds december_solstice;
};

/// Finds the equinoxes and solstices of a year. The delay of the earth's rotation is that of the
/// 2020s in all years: by that an instant of 1800 is a minute early, and later ones are right as
/// long as UTC gets no more leap seconds.
/// @param year  of those that SunYears.h names
QNCORE_API Seasons seasonsOf(int year);

} // namespace quarn
