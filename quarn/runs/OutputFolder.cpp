#include "quarn/runs/OutputFolder.h"

#include <cerrno>
#include <cstdlib>
#include <system_error>
#include <unistd.h>

namespace quarn::program {

namespace {

/// Permissions alone do not tell: a folder may be on a file system that takes no files.
std::error_code tryToWriteInto(const std::filesystem::path& folder) {
    std::string probe = (folder / ".quarn-XXXXXX").native();
    const int file = mkstemp(probe.data());
    if (file < 0)
        return {errno, std::generic_category()};
    close(file);
    unlink(probe.c_str());
    return {};
}

} // namespace

std::optional<std::string> whyFolderCannotBeUsed(const std::filesystem::path& folder) {
    std::error_code error;
    std::filesystem::create_directories(folder, error);
    if (error)
        return "cannot make the output folder " + folder.native() + ": " + error.message() +
               "; choose another one with --out.";
    if (!std::filesystem::is_directory(folder, error))
        return folder.native() + " is no folder; choose another one with --out.";
    error = tryToWriteInto(folder);
    if (error)
        return "cannot write into the output folder " + folder.native() + ": " + error.message() +
               "; choose another one with --out.";
    return std::nullopt;
}

std::optional<std::string> whyNotReplaced(const std::filesystem::path& file, bool overwrites) {
    std::error_code unknown; // what cannot be looked at cannot be written either, and says why then
    if (overwrites || !std::filesystem::exists(file, unknown))
        return std::nullopt;
    return file.native() + " is there already: give --overwrite to replace it, or another --out.";
}

} // namespace quarn::program
