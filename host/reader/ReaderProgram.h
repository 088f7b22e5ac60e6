#pragma once

#include "ground/Result.h"

#include <filesystem>

namespace quarn {

/// The variable of the environment that says who reads model files: `inside` this very process, for
/// debugging, or the program that the variable names in place of the installed one.
inline constexpr const char* READER_VARIABLE = "QUARN_READER";

/// Whether model files are read inside this process.
bool readsInside();

/// The program that reads model files: that of the environment, else `quarn-reader` of the
/// installation that this library belongs to, in `bin` beside its folder, or beside itself.
/// @return an error, a sentence, that says where it was looked for
Result<std::filesystem::path> readerProgram();

} // namespace quarn
