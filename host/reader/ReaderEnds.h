#pragma once

#include "ground/Result.h"

#include <chrono>
#include <cstdint>
#include <filesystem>
#include <string_view>

namespace quarn {

// What a person is told when the program that reads a model file does not hand over a model, in the
// user's language.

/// @param why  part of a sentence
Error cannotStartReader(const std::filesystem::path& path, std::string_view why);
/// @param signal  that ended the program; 0: none
Error readerStopped(const std::filesystem::path& path, int signal);
Error readingTookTooLong(const std::filesystem::path& path, std::chrono::milliseconds longest);
Error readingNeedsMore(const std::filesystem::path& path, std::uint64_t most_memory);
Error readingGivenUp(const std::filesystem::path& path);
/// @param why  part of a sentence
Error cannotTakeModel(const std::filesystem::path& path, std::string_view why);

} // namespace quarn
