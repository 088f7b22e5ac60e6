#pragma once

#include <cstdint>
#include <istream>
#include <string>

namespace quarn {

/// Checks the counts that a PLY file claims against its length; for a binary file also walks its
/// lists, so that one that is cut short is found before it is read with garbage for its end.
///
/// @param file  at its beginning, opened in binary mode
/// @param size  its length in bytes
/// @return why the file cannot be read, a part of a sentence; empty when nothing speaks against it
std::string whyBadPly(std::istream& file, std::uint64_t size);

} // namespace quarn
