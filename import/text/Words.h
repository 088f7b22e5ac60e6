#pragma once

#include <charconv>
#include <cmath>
#include <limits>
#include <optional>
#include <string>
#include <string_view>
#include <type_traits>

namespace quarn {

/// What parts words on a line. A carriage return before a line break counts as one.
inline bool isBlank(char c) {
    return c == ' ' || (c >= '\t' && c <= '\r' && c != '\n');
}

inline void skipBlanks(std::string_view& rest) {
    std::size_t begin = 0;
    while (begin < rest.size() && isBlank(rest[begin]))
        ++begin;
    rest.remove_prefix(begin);
}

/// A text without the blanks at its ends.
inline std::string_view trimmed(std::string_view text) {
    skipBlanks(text);
    while (!text.empty() && isBlank(text.back()))
        text.remove_suffix(1);
    return text;
}

/// The next word of a line, which `rest` loses; empty at the end of the line.
inline std::string_view takeWord(std::string_view& rest) {
    skipBlanks(rest);
    std::size_t end = 0;
    while (end < rest.size() && !isBlank(rest[end]))
        ++end;
    const std::string_view word = rest.substr(0, end);
    rest.remove_prefix(end);
    return word;
}

/// Takes the number with which `rest` begins behind blanks; whatever may follow it.
/// @tparam Number  a floating-point type, for which a number too large becomes infinite and one too
///   small zero, or a whole one, for which one too large or too small is none
/// @return nothing, with `rest` behind the blanks, where there is no number
template <class Number> std::optional<Number> takeLeadingNumber(std::string_view& rest) {
    skipBlanks(rest);
    const char* begin = rest.data();
    const char* const end = begin + rest.size();
    if (begin != end && *begin == '+' && begin + 1 != end && begin[1] != '-')
        ++begin;
    Number number{};
    const auto [after, failure] = std::from_chars(begin, end, number);
    if constexpr (std::is_floating_point_v<Number>) {
        if (failure == std::errc::result_out_of_range) {
            const std::string_view digits(begin, after);
            const std::size_t exponent = digits.find_first_of("eE");
            const bool is_small =
                exponent != std::string_view::npos && digits.substr(exponent + 1).starts_with('-');
            number = is_small ? Number{} : std::numeric_limits<Number>::infinity();
        }
        if (failure == std::errc::invalid_argument)
            return std::nullopt;
    } else if (failure != std::errc()) {
        return std::nullopt;
    }
    rest.remove_prefix(static_cast<std::size_t>(after - rest.data()));
    return number;
}

/// The next word of a line as a number.
/// @return nothing, with `rest` at the word, where the word is no number or there is none
template <class Number> std::optional<Number> takeNumber(std::string_view& rest) {
    std::string_view after = rest;
    const std::optional<Number> number = takeLeadingNumber<Number>(after);
    if (number && !after.empty() && !isBlank(after.front())) {
        skipBlanks(rest);
        return std::nullopt;
    }
    rest = after;
    return number;
}

/// A word of a file as messages quote it: "'12x'", shortened where it is long, without characters
/// that would reach a terminal as commands.
std::string quotedWord(std::string_view word);

} // namespace quarn
