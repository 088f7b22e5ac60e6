#pragma once

#include <chrono>
#include <filesystem>
#include <string>

namespace quarn::program {

/// The kind of a file by its ending: "OBJ"; "unknown" where it has none.
std::string formatName(const std::filesystem::path& model);
double millisecondsOf(std::chrono::steady_clock::duration time);

} // namespace quarn::program
