#pragma once

#include "import/ImportedModel.h"

#include <string_view>

namespace quarn {

/// Which axis points up in a file whose format leaves that open. Where a comment at its head names
/// the program that wrote it, and that program writes one axis unless it is told otherwise, it is
/// that one, else z.
///
/// @param format  the extension in lower case: "obj"
/// @param file    at least the head of the file
/// @param asked   by whoever reads the file; goes before all else
TakenUpAxis upAxisOfOpenFormat(std::string_view format, std::string_view file, UpAxis asked);

} // namespace quarn
