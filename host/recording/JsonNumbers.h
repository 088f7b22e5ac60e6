#pragma once

#include <cmath>
#include <cstdint>
#include <limits>
#include <nlohmann/json.hpp>
#include <stdexcept>

namespace quarn {

// Numbers in files that anybody may have changed, from the library's values with or without an
// order of members. All of these throw std::out_of_range for what is no such number.

/// The library would convert a number of another type, and one too large for this is a double to
/// it.
template <class Integer, class Json> Integer integerOf(const Json& value) {
    if (!value.is_number_integer())
        throw std::out_of_range("number");
    return value.template get<Integer>();
}

/// An int from 0.
template <class Json> int intOf(const Json& value) {
    const auto number = integerOf<std::int64_t>(value);
    if (number < 0 || number > std::numeric_limits<int>::max())
        throw std::out_of_range("number");
    return static_cast<int>(number);
}

/// A finite number.
template <class Json> double finiteOf(const Json& value) {
    if (!value.is_number())
        throw std::out_of_range("number");
    const double number = value.template get<double>();
    if (!std::isfinite(number))
        throw std::out_of_range("number");
    return number;
}

} // namespace quarn
