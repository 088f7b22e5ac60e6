#include "quarn/session/InstalledTree.h"

#include <system_error>

namespace quarn::program {

std::filesystem::path installedTree() {
    std::error_code error;
    const std::filesystem::path program = std::filesystem::read_symlink("/proc/self/exe", error);
    return program.parent_path().parent_path();
}

std::filesystem::path plugInFolder() {
    return installedTree() / "lib" / "quarn" / "plug-ins";
}

std::filesystem::path hostLocaleFolder() {
    return installedTree() / "share" / "quarn" / "locale" / "host";
}

std::filesystem::path dialogFolder() {
    return installedTree() / "share" / "quarn" / "dialogs";
}

std::filesystem::path viewerFolder() {
    return installedTree() / "share" / "quarn" / "viewer";
}

} // namespace quarn::program
