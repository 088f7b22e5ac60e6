#pragma once

#include <filesystem>

namespace quarn::program {

/// The folder above the program's own: build tree and installed tree look the same from there, so
/// that either can be moved anywhere. Empty when the system does not tell where the program is.
std::filesystem::path installedTree();

/// Where plug-in files are.
std::filesystem::path plugInFolder();

/// Where the host's own string tables are.
std::filesystem::path hostLocaleFolder();

/// Where the dialog templates of plug-ins are, in a folder for each.
std::filesystem::path dialogFolder();

/// Where the files are that viewer pages are made from.
std::filesystem::path viewerFolder();

} // namespace quarn::program
