#include "host/app/DocumentsFolder.h"

#include <cstdlib>
#include <fstream>
#include <string>
#include <string_view>

namespace quarn {

namespace {

namespace fs = std::filesystem;

fs::path variable(const char* name) {
    const char* value = std::getenv(name);
    return value ? value : "";
}

bool isFolder(const fs::path& path) {
    std::error_code error;
    return fs::is_directory(path, error);
}

/// Reads `XDG_DOCUMENTS_DIR="$HOME/Texts"`: the value is an absolute path, or one that begins with
/// $HOME/. The home folder itself says that there is no documents folder.
fs::path readEntry(std::string_view line, const fs::path& home) {
    constexpr std::string_view key = "XDG_DOCUMENTS_DIR=\"";
    constexpr std::string_view home_variable = "$HOME/";
    const std::size_t begin = line.find(key);
    if (begin == line.npos || line.substr(0, begin).find_first_not_of(" \t") != line.npos)
        return {};
    line.remove_prefix(begin + key.size());
    const std::string_view value = line.substr(0, line.find('"'));
    if (value.starts_with(home_variable))
        return value.size() > home_variable.size() ? home / value.substr(home_variable.size())
                                                   : fs::path();
    return value.starts_with('/') ? fs::path(value) : fs::path();
}

fs::path folderOfDesktop(const fs::path& home) {
    const fs::path configured = variable("XDG_CONFIG_HOME");
    const fs::path config_folder = configured.is_absolute() ? configured : home / ".config";
    std::ifstream stream(config_folder / "user-dirs.dirs");
    fs::path found;
    for (std::string line; std::getline(stream, line);) {
        if (fs::path entry = readEntry(line, home); !entry.empty())
            found = entry;
    }
    return found;
}

} // namespace

std::optional<fs::path> documentsFolder(const fs::path& configured) {
    if (!configured.empty())
        return configured;
    const fs::path home = variable("HOME");
    if (home.empty())
        return std::nullopt;
    for (const fs::path& folder : {folderOfDesktop(home), home / "Documents"}) {
        if (!folder.empty() && isFolder(folder))
            return folder;
    }
    return std::nullopt;
}

} // namespace quarn
