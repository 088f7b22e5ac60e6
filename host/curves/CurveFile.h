#pragma once

#include "host/curves/CurveMaking.h"

#include <filesystem>
#include <string_view>

namespace quarn {

/// Reads a curve from a small text or JSON file; docs/curve-files.md describes both. A file whose
/// first character is "{" is JSON. Coordinates are those of the document, Z up.
///
/// @return an error that names the file, and where it lies in the text, the line, from 1: missing,
///         not readable, larger than 64 MB, more than a million points, no such text, or points
///         that make no curve
CurveResult readCurveFile(const std::filesystem::path& file);

/// Reads the text of such a file.
/// @return as readCurveFile, with a message that begins with "line 3: " or tells what is wrong with
///         the whole
CurveResult readCurveText(std::string_view text);

} // namespace quarn
