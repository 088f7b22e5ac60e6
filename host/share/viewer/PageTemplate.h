#pragma once

#include "ground/AtomicFile.h"

#include <functional>
#include <map>
#include <string>
#include <string_view>

namespace quarn {

/// Hands a text on.
/// @return false where it could not be written
bool put(const ByteSink& sink, std::string_view text);

/// What stands in the places of a template: each writes itself.
using PlaceFillers = std::map<std::string, std::function<void(const ByteSink&)>, std::less<>>;

/// Writes a template whose places read {{name}}, and {{file:NAME}} for a file beside it. What comes
/// into a place is not looked through again.
/// @return an error, one sentence, where a file cannot be read, or a place has no filler
Result<void> fillTemplate(const std::filesystem::path& file, const PlaceFillers& fillers,
                          const ByteSink& sink);

/// A text as it stands in HTML, also in the value of an attribute.
std::string htmlText(std::string_view text);
/// JSON as it stands in a script element, which nothing in it can end.
std::string jsonInHtml(std::string json);
/// A file name as part of an address: only letters, digits and -_.~ stand for themselves.
std::string addressOf(std::string_view file_name);
/// Base64 (S. Josefsson, "The Base16, Base32, and Base64 Data Encodings", RFC 4648, section 4).
std::string base64(std::span<const std::byte> bytes);

} // namespace quarn
