#pragma once

#include "quarn/session/HostSession.h"
#include "quarn/words/Outcome.h"

#include <filesystem>
#include <optional>
#include <string>
#include <vector>

namespace quarn::program {

/// Why pictures that one instruction set drew cannot be followed by those of this machine.
/// @param wanted  that the recording in the folder is drawn with; empty: it is not known
/// @param here    those that this processor has
std::optional<std::string> whyInstructionsLack(const std::filesystem::path& folder,
                                               const std::string& wanted,
                                               const std::vector<std::string>& here);

/// Draws with the instruction set that the recording in the folder is drawn with, where there is
/// one and nobody chose another: then all its pictures are the same to the last bit.
/// @return why that cannot be, or nothing
std::optional<Outcome> takeInstructionsOf(const std::filesystem::path& folder,
                                          CommonOptions& common);

/// The quality of the JPEG pictures of the recording in the folder; nothing where it has none.
std::optional<int> jpegQualityOf(const std::filesystem::path& folder);

} // namespace quarn::program
