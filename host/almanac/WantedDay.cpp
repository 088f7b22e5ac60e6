#include "host/almanac/WantedDay.h"

#include "host/sun/Seasons.h"

#include <algorithm>
#include <charconv>
#include <utility>

namespace quarn {

namespace {

using namespace std::chrono;

/// Reads digits alone, without a sign.
std::optional<int> digits(std::string_view word) {
    const auto is_digit = [](char c) { return c >= '0' && c <= '9'; };
    int number = 0;
    if (word.empty() || word.size() > 4 || !std::ranges::all_of(word, is_digit))
        return std::nullopt;
    std::from_chars(word.data(), word.data() + word.size(), number);
    return number;
}

sys_seconds momentOf(SeasonDay::Kind kind, int of_year) {
    const Seasons seasons = seasonsOf(of_year);
    switch (kind) {
    case SeasonDay::Kind::march_equinox:
        return seasons.march_equinox;
    case SeasonDay::Kind::june_solstice:
        return seasons.june_solstice;
    case SeasonDay::Kind::september_equinox:
        return seasons.september_equinox;
    case SeasonDay::Kind::december_solstice:
        break;
    }
    return seasons.december_solstice;
}

std::optional<SeasonDay> seasonDay(std::string_view word) {
    using Kind = SeasonDay::Kind;
    constexpr std::pair<std::string_view, Kind> NAMED[] = {
        {"equinox-march", Kind::march_equinox},
        {"solstice-june", Kind::june_solstice},
        {"equinox-september", Kind::september_equinox},
        {"solstice-december", Kind::december_solstice}};
    for (const auto& [name, kind] : NAMED) {
        if (word == name)
            return SeasonDay{kind, {}};
        if (!word.starts_with(name) || word.size() != name.size() + 5 || word[name.size()] != '-')
            continue;
        if (const auto year = digits(word.substr(name.size() + 1)))
            return SeasonDay{kind, year};
    }
    return std::nullopt;
}

} // namespace

std::optional<WantedDay> wantedDay(std::string_view word) {
    if (word == "today")
        return WantedDay();
    if (const auto season = seasonDay(word))
        return WantedDay(*season);
    if (const auto date = isoDate(word))
        return WantedDay(*date);
    return std::nullopt;
}

std::optional<year_month_day> isoDate(std::string_view word) {
    if (word.size() != 10 || word[4] != '-' || word[7] != '-')
        return std::nullopt;
    const std::optional<int> of_year = digits(word.substr(0, 4));
    const std::optional<int> of_month = digits(word.substr(5, 2));
    const std::optional<int> of_day = digits(word.substr(8, 2));
    if (!of_year || !of_month || !of_day)
        return std::nullopt;
    return year(*of_year) / *of_month / *of_day;
}

year_month_day dayOf(const WantedDay& wanted, const Zone& zone) {
    if (const auto* const day = std::get_if<year_month_day>(&wanted))
        return *day;
    const year_month_day now = today(zone);
    if (const auto* const season = std::get_if<SeasonDay>(&wanted))
        return dateAt(zone, momentOf(season->kind, season->year.value_or(int(now.year()))));
    return now;
}

year_month_day dateAt(const Zone& zone, sys_seconds moment) {
    return year_month_day{floor<days>(zone.at(moment).local)};
}

year_month_day today(const Zone& zone) {
    return dateAt(zone, floor<seconds>(system_clock::now()));
}

} // namespace quarn
