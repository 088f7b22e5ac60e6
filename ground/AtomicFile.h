#pragma once

#include "ground/Result.h"

#include <cstddef>
#include <filesystem>
#include <span>

namespace quarn {

/// Whether a written file must be on the disk, and not only on its way there, before the call ends.
enum class FileSync { no, yes };

/// Writes a file so that it appears whole or not at all: the bytes go to a temporary name in the
/// same folder, which is then renamed. A file that was there before is replaced and keeps its
/// permissions; after a failure it is untouched, and no temporary file stays.
///
/// @param path   its folder must exist; must not name anything but an ordinary file
/// @param sync   yes also flushes the file and its folder to the disk
/// @return an error that names the file and why it could not be written: the folder is missing, no
///   permission, the disk is full, ...
Result<void> writeFileAtomically(const std::filesystem::path& path,
                                 std::span<const std::byte> bytes, FileSync sync = FileSync::no);

} // namespace quarn
