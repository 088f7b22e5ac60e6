#pragma once

#include <string>
#include <vector>

namespace quarn::program {

/// Sets names in columns, from top to bottom and then from left to right, as many columns as fit.
///
/// @param width  columns of a line, of which a wide character takes two
/// @return UTF-8; every line ends with a line break
std::string inColumns(const std::vector<std::wstring>& names, std::size_t width);

} // namespace quarn::program
