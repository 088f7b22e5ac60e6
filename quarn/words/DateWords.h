#pragma once

#include "sdk/qncore/QnDateTime.h"

#include <optional>
#include <string_view>

namespace quarn::program {

struct ClockTime {
    int hour;
    int minute;
};

/// Reads "2026-06-21" as the midnight at its beginning. A date that no calendar has (31 April) is
/// read too; it is not valid then.
/// @return nothing for a word of any other form
std::optional<COleDateTime> isoDate(std::string_view word);

/// Reads "6:05" or "06:05", from 00:00 to 23:59.
std::optional<ClockTime> clockTime(std::string_view word);

} // namespace quarn::program
