#pragma once

#include "host/clock/Zone.h"
#include "sdk/qncore/QnExport.h"

#include <chrono>
#include <optional>
#include <string_view>
#include <variant>

namespace quarn {

/// A day that the year's course of the sun names.
struct SeasonDay {
    enum class Kind { march_equinox, june_solstice, september_equinox, december_solstice };
    Kind kind = Kind::march_equinox;
    std::optional<int> year; ///< one that SunYears.h names; nothing: this one
};

/// Nothing: today.
using WantedDay = std::variant<std::monostate, std::chrono::year_month_day, SeasonDay>;

/// Reads "today", "solstice-june", "solstice-december", "equinox-march", "equinox-september", one
/// of these with a year behind it ("solstice-june-2030"), and dates as isoDate does.
/// @return nothing for a word of any other form
QNCORE_API std::optional<WantedDay> wantedDay(std::string_view word);

/// Reads "2026-06-21". A date that no calendar has (31 April) is read too; it is not ok() then.
/// @return nothing for a word of any other form
QNCORE_API std::optional<std::chrono::year_month_day> isoDate(std::string_view word);

/// The day by the clocks of a place.
QNCORE_API std::chrono::year_month_day dayOf(const WantedDay& wanted, const Zone& zone);

/// What the clocks show as the date at a moment.
QNCORE_API std::chrono::year_month_day dateAt(const Zone& zone, std::chrono::sys_seconds moment);

/// The date of now by the clocks of a place.
QNCORE_API std::chrono::year_month_day today(const Zone& zone);

} // namespace quarn
