#include "quarn/words/DateWords.h"

#include "quarn/words/Words.h"

#include <algorithm>

namespace quarn::program {

namespace {

/// Reads digits alone, without a sign.
std::optional<int> digits(std::string_view word) {
    const auto is_digit = [](char c) { return c >= '0' && c <= '9'; };
    return std::ranges::all_of(word, is_digit) ? wholeNumber(word) : std::nullopt;
}

} // namespace

std::optional<COleDateTime> isoDate(std::string_view word) {
    if (word.size() != 10 || word[4] != '-' || word[7] != '-')
        return std::nullopt;
    const std::optional<int> year = digits(word.substr(0, 4));
    const std::optional<int> month = digits(word.substr(5, 2));
    const std::optional<int> day = digits(word.substr(8, 2));
    if (!year || !month || !day)
        return std::nullopt;
    return COleDateTime(*year, *month, *day, 0, 0, 0);
}

std::optional<ClockTime> clockTime(std::string_view word) {
    const std::size_t colon = word.find(':');
    if (colon == 0 || colon > 2 || word.size() != colon + 3)
        return std::nullopt;
    const std::optional<int> hour = digits(word.substr(0, colon));
    const std::optional<int> minute = digits(word.substr(colon + 1));
    if (!hour || !minute || *hour > 23 || *minute > 59)
        return std::nullopt;
    return ClockTime{*hour, *minute};
}

} // namespace quarn::program
