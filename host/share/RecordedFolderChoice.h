#pragma once

#include "sdk/qncore/QnCommand.h"

#include <filesystem>
#include <optional>

namespace quarn {

/// Lets a person at the window choose a folder with recorded frames. The chooser begins at the
/// folder of the document's last recording; before the first one where other choosers do.
/// @param title  of the chooser, in the user's language
/// @return nothing where the command has to ask at its prompt: it is a script's, its line has words
///         left, there is no chooser, or it was closed
std::optional<std::filesystem::path> chooseRecordedFolder(const CQuarnCommandContext& context,
                                                          const wchar_t* title);

} // namespace quarn
