#pragma once

#include <filesystem>
#include <sys/stat.h>

namespace quarn {

/// Gives a new file the rights of the one that it is to replace: owner, group, permissions, access
/// list and the user's own attributes. Where the owner, the group or the list cannot be kept the
/// permissions become narrower, so that nobody has more than before; the rights to run a program as
/// its owner or group are left out. Labels of the system's security are the system's to give.
///
/// @param former      the file that is replaced
/// @param status      its status
/// @param descriptor  the new file, open for writing, which nobody else may use yet
void takeOverRights(const std::filesystem::path& former, const struct stat& status, int descriptor);

} // namespace quarn
