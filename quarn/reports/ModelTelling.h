#pragma once

#include "host/session/ModelContents.h"

#include <chrono>
#include <cstdint>
#include <filesystem>
#include <string>

namespace quarn::program {

/// A file that was read, and what was in it.
struct ReadFile {
    std::filesystem::path path;
    std::uintmax_t bytes = 0;
    std::chrono::steady_clock::duration read_time{};
    ModelContents contents;
};

/// For people: a line for each thing worth knowing, then a line for each object.
std::string textOf(const ReadFile& file);
/// For programs; docs/model-files.md names the fields.
std::string jsonOf(const ReadFile& file);

} // namespace quarn::program
