#pragma once

#include "ground/Result.h"

#include <cstddef>
#include <filesystem>
#include <functional>
#include <span>
#include <string>

namespace quarn {

/// Whether a file that is protected from writing keeps what it holds, or is replaced all the same.
enum class Protection { respected, overridden };

/// Writes a file so that it appears whole or not at all: the bytes go to a temporary name in the
/// same folder, which is then renamed. After a failure a file that was there before is untouched,
/// and no temporary file stays.
///
/// A path that is a symbolic link means the file that it leads to (fileBehindLinks): the links
/// stay, and a file that is not there yet is made.
///
/// A file that was there before keeps its permissions, owner, group, access list and the user's own
/// attributes. Where the owner or the group cannot be kept, nobody has more rights than before; the
/// rights to run a program as its owner or group are never kept. Other hard links go on naming the
/// former content: a file that several names share cannot be replaced whole.
///
/// @param path        the folder must exist; must not name anything but an ordinary file
/// @param protection  whether isWriteProtected keeps the file from being replaced
/// @return an error that names the file and why it could not be written: the folder is missing, no
///   permission, write-protected, the disk is full, the links lead nowhere, ...
Result<void> writeFileAtomically(const std::filesystem::path& path,
                                 std::span<const std::byte> bytes,
                                 Protection protection = Protection::respected);

/// Takes the next bytes of a file.
/// @return false where they could not be written: no more are wanted then
using ByteSink = std::function<bool(std::span<const std::byte>)>;

/// Writes a file as writeFileAtomically does, whose bytes come piece by piece, so that a large one
/// is never whole in memory.
/// @param fill  hands the pieces to the sink; an error of its own keeps the file from being written
/// @return as writeFileAtomically, or the error of `fill`
Result<void> writeFileInPieces(const std::filesystem::path& path,
                               const std::function<Result<void>(const ByteSink&)>& fill,
                               Protection protection = Protection::respected);

/// A file that stands written.
struct WrittenFile {
    /// A sentence for the person where it is not sure that the file is on the disk; else empty.
    std::string warning;
};

/// Writes a file as writeFileAtomically does, and has it on the disk, and not only on its way
/// there, before the call ends. What programs of this machine that have ended left behind in the
/// folder under temporary names is removed.
/// @return as writeFileAtomically; where the folder alone could not be flushed to the disk the file
///   is written, with a warning
Result<WrittenFile> writeFileToDisk(const std::filesystem::path& path,
                                    std::span<const std::byte> bytes,
                                    Protection protection = Protection::respected);

/// Whether the file that a path leads to is there and protected from writing by this user. Root may
/// write everything: to it a file is protected that nobody may write, or its own that it may not.
bool isWriteProtected(const std::filesystem::path& path);

} // namespace quarn
