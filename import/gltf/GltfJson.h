#pragma once

#include "ground/Result.h"
#include "import/ReadingBudget.h"

#include <nlohmann/json.hpp>

#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>

/// Reading the text part of a glTF file. What is absent and what is of another kind than it should
/// be are the same: null, nothing or a default value.
namespace quarn::gltf {

using Json = nlohmann::json;
using Bytes = std::span<const std::uint8_t>;

/// What a text takes in memory once it is understood, at most.
std::uint64_t memoryOfJson(std::string_view text);

/// @return an error, a part of a sentence, that names the byte from which it is no JSON
Result<Json> parseJson(std::string_view text);

/// A member of an object.
const Json& member(const Json& value, const char* name);
/// An extension of a thing, by its name.
const Json& extension(const Json& thing, const char* name);
/// An element of a list.
const Json& element(const Json& list, std::uint64_t index);
/// The elements of a list, none for anything else.
std::span<const Json> elements(const Json& list);

/// A number that is whole and not negative. One beyond 64 bits becomes the largest.
std::optional<std::uint64_t> wholeNumber(const Json& value);
double number(const Json& value, double otherwise);
std::string text(const Json& value);
bool flag(const Json& value);

/// Sets as many of `values` as the list has numbers for.
void readNumbers(const Json& list, std::span<double> values);

} // namespace quarn::gltf
