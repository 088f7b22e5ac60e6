#pragma once

#include <optional>
#include <string>

namespace quarn {

/// Reads a number in the user's notation: as readNumber, and a comma is a decimal mark as a point
/// is. There may be one mark, so that a text with marks of thousands is no number.
std::optional<double> readUsersNumber(std::wstring text);

} // namespace quarn
