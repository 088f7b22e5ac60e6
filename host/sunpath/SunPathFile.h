#pragma once

#include "ground/Result.h"
#include "host/sunpath/SunPathDiagram.h"
#include "sdk/qncore/QnExport.h"

#include <filesystem>

namespace quarn {

/// Why no diagram can be written to a file of this name, in an English sentence that says what to
/// do; nothing where it can. Whether the folder is there nobody looks.
QNCORE_API std::optional<std::string> whyDiagramIsRefused(const std::filesystem::path& file);

/// Draws a diagram and writes it in the format of the file's extension, .svg or .png in any case.
/// The file appears whole or not at all, and replaces one of the same name.
/// @return an error that names the file: another extension, the folder is missing, no permission,
///         write-protected, the disk is full
Result<void> writeSunPathDiagram(const SunPathWish& wish, const std::filesystem::path& file);

} // namespace quarn
