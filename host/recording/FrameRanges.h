#pragma once

#include "ground/Result.h"
#include "host/recording/FrameSet.h"

#include <string_view>

namespace quarn {

/// Reads which frames of an animation are meant: ranges "first-last" with commas between them, both
/// counted from 0 and both of them in, and behind a range ":step" where only each step-th of it is;
/// or "none" for no frame at all. A bare number is none: elsewhere it means how many frames.
/// @return an error, in a sentence of the user's language that says what to do
Result<FrameSet> parseFrameRanges(std::string_view text);

} // namespace quarn
