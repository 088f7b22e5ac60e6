#include "import/gltf/GltfJson.h"

#include "kelmar/KM_wString.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace quarn::gltf {

namespace {

/// A member of an object, with its place in a tree and the memory that lists keep in reserve.
constexpr std::uint64_t MEMORY_OF_VALUE = 128;

const Json& nothing() {
    static const Json null;
    return null;
}

} // namespace

std::uint64_t memoryOfJson(std::string_view text) {
    std::uint64_t values = 1;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const char c = text[i];
        values += c == ',' || c == '[' || c == '{' || c == ':' ? 1 : 0;
        if (c != '"')
            continue;
        for (++i; i < text.size() && text[i] != '"'; ++i)
            i += text[i] == '\\' ? 1 : 0;
    }
    return text.size() + values * MEMORY_OF_VALUE;
}

Result<Json> parseJson(std::string_view text) {
    try {
        return Json::parse(text);
    } catch (const Json::parse_error& failure) {
        // Names in another encoding than UTF-8 are no reason to lose the model.
        const std::string repaired = KM_wString::FromUtf8(text).ToUtf8();
        Json json = repaired == text ? Json(Json::value_t::discarded)
                                     : Json::parse(repaired, nullptr, false);
        if (json.is_discarded())
            return Error{"its text is damaged at byte " + std::to_string(failure.byte)};
        return json;
    } catch (const Json::exception&) {
        return Error{"its text holds a number that is too large"};
    }
}

const Json& member(const Json& value, const char* name) {
    if (!value.is_object())
        return nothing();
    const auto found = value.find(name);
    return found == value.end() ? nothing() : *found;
}

const Json& extension(const Json& thing, const char* name) {
    return member(member(thing, "extensions"), name);
}

const Json& element(const Json& list, std::uint64_t index) {
    return list.is_array() && index < list.size() ? list[index] : nothing();
}

std::span<const Json> elements(const Json& list) {
    if (!list.is_array())
        return {};
    return list.get_ref<const Json::array_t&>();
}

std::optional<std::uint64_t> wholeNumber(const Json& value) {
    constexpr double BEYOND = 18446744073709551616.0; // 2^64
    if (value.is_number_unsigned())
        return value.get<std::uint64_t>();
    if (!value.is_number_float())
        return std::nullopt;
    const double number = value.get<double>();
    if (!(number >= 0.0) || number != std::floor(number))
        return std::nullopt;
    return number < BEYOND ? static_cast<std::uint64_t>(number)
                           : std::numeric_limits<std::uint64_t>::max();
}

double number(const Json& value, double otherwise) {
    return value.is_number() ? value.get<double>() : otherwise;
}

std::string text(const Json& value) {
    return value.is_string() ? value.get<std::string>() : std::string();
}

bool flag(const Json& value) {
    return value.is_boolean() && value.get<bool>();
}

void readNumbers(const Json& list, std::span<double> values) {
    const std::span<const Json> given = elements(list);
    for (std::size_t i = 0; i < std::min(given.size(), values.size()); ++i)
        values[i] = number(given[i], values[i]);
}

} // namespace quarn::gltf
