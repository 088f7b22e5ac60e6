#pragma once

#include "host/front_end/FrontEndChoices.h"

#include <filesystem>
#include <optional>
#include <string>
#include <string_view>

class QWidget;

namespace quarn::desktop {

/// Lets a person choose a folder. One that is typed and does not exist yet is made, with those
/// above it.
/// @param message  told above the folders; may be empty
/// @param start    the folder that is shown first; the nearest that exists
/// @return nothing when the person gave up
std::optional<std::filesystem::path> askFolder(QWidget* owner, std::wstring_view title,
                                               std::wstring_view message,
                                               const std::filesystem::path& start);

/// Lets a person choose a file. A file to save gets the extension of the chosen kind unless it has
/// one of the question's kinds already; before one that exists is replaced the person is asked.
/// @return chosen or given up
FileChoice askFile(QWidget* owner, const FileQuestion& question);

/// The file with the first extension of the chosen kind behind its name, unless its own, ignoring
/// case, is one of any kind, or the kind takes every file.
std::filesystem::path withExtension(const std::filesystem::path& file,
                                    const std::vector<FileKind>& kinds, std::size_t chosen_kind);

} // namespace quarn::desktop
