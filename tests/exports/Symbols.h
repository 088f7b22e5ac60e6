#pragma once

#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

namespace exports {

/// Reads the symbols that a shared library defines and shows to others, with `nm -D`.
///
/// @return mangled names without their version, sorted; version nodes are left out
std::vector<std::string> exportedSymbols(const std::filesystem::path& library);

/// The identifiers that a symbol's own name is made of, outermost first: `_ZN5quarn4Host3runEi`
/// gives `quarn`, `Host`, `run`. Tables, type names and thunks count as what they belong to. A
/// plain C name is its own only part. A name of the standard library begins with `std`. Where an
/// operator or a constructor comes, the list ends.
std::vector<std::string> qualifiedName(std::string_view symbol);

/// Reads headers (.h) below a folder into one text, comments removed.
std::string declarationsBelow(const std::filesystem::path& folder);

/// True if `identifier` stands as a whole word in `text`.
bool mentions(const std::string& text, const std::string& identifier);

} // namespace exports
