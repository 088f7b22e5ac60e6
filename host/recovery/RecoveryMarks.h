#pragma once

#include "ground/ProcessIdentity.h"
#include "ground/Result.h"

#include <filesystem>
#include <optional>
#include <vector>

namespace quarn {

/// Says where a recovery file is and whose: a small file in the folder of marks, by which the next
/// start finds what stands beside documents anywhere.
struct RecoveryMark {
    ProcessIdentity writer;
    std::filesystem::path recovery; ///< the recovery file
    std::filesystem::path document; ///< the document's own file; empty: it was never saved
};

/// The folder of marks in a folder for state, and of recovery files that cannot stand beside their
/// documents.
std::filesystem::path recoveryFolder(const std::filesystem::path& state_folder);

/// The name that a recovery file has while it is not whole yet.
std::filesystem::path unfinishedRecovery(const std::filesystem::path& recovery);

/// Writes a mark under a name of its own. Makes the folder, for the user alone.
/// @return the mark's file, or a sentence that says why there is none
Result<std::filesystem::path> writeMark(const std::filesystem::path& folder,
                                        const RecoveryMark& mark);
/// @return nothing when the file is none, or damaged
std::optional<RecoveryMark> readMark(const std::filesystem::path& file);
/// The files of the marks in a folder.
std::vector<std::filesystem::path> marksIn(const std::filesystem::path& folder);

/// Removes a recovery file with what is unfinished of it, and last its mark. One that is not there
/// is left alone.
void removeRecovery(const std::filesystem::path& mark);

} // namespace quarn
