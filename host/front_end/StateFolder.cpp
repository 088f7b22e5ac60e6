#include "host/front_end/StateFolder.h"

#include <cstdlib>
#include <system_error>

namespace quarn {

namespace {

/// A folder that a variable of the environment names; empty when it names none, or only one that
/// depends on where the program was started.
std::filesystem::path folderOf(const char* variable) {
    const char* const value = std::getenv(variable);
    const std::filesystem::path folder = value ? value : "";
    return folder.is_absolute() ? folder : std::filesystem::path();
}

} // namespace

std::filesystem::path userStateFolder() {
    if (const std::filesystem::path state = folderOf("XDG_STATE_HOME"); !state.empty())
        return state / "quarn";
    if (const std::filesystem::path home = folderOf("HOME"); !home.empty())
        return home / ".local" / "state" / "quarn";
    return {};
}

bool makeStateFolder(const std::filesystem::path& folder) {
    std::error_code error;
    if (std::filesystem::create_directories(folder, error))
        std::filesystem::permissions(folder, std::filesystem::perms::owner_all, error);
    return std::filesystem::is_directory(folder, error);
}

} // namespace quarn
