#pragma once

#include "ground/Result.h"

#include <filesystem>

namespace quarn {

class FrontEnd;

/// Opens a file with the desktop's program for it (`xdg-open`, looked for in PATH), never through a
/// shell. The program goes on by itself; only what it says in its first second is waited for.
///
/// @param front_end  works on its events meanwhile
/// @return an error when the file is missing, there is no opener, or the opener fails at once
Result<void> openWithDesktop(const std::filesystem::path& file, FrontEnd& front_end);

} // namespace quarn
