#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace quarn {

class Document;

/// Why pictures of a kind cannot be see-through.
/// @param extension  of their files, with or without its dot
/// @return a sentence of the user's language that says what to do; nothing for those that can, and
///         for what is no kind of picture
std::optional<std::string> whyHoldsNoOpacity(std::string_view extension);

/// The same of the pictures that a document makes now: nothing also where they are not see-through.
std::optional<std::string> whyNotSeeThrough(const Document& document, std::string_view extension);

} // namespace quarn
