#pragma once

#include "host/session/Completion.h"

namespace quarn {

/// Completes the path of a file or folder. A path in double quotes stays in them.
///
/// @param typed     the path up to the cursor
/// @param is_word   blanks would end the path: one that has any is put in quotes, and a blank
///                  follows a file
QNCORE_API Completion completeFile(std::wstring_view typed, bool is_word);

} // namespace quarn
