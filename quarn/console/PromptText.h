#pragma once

#include "host/front_end/FrontEnd.h"

#include <string>

namespace quarn::program {

/// A question as a command line shows it, ready for the answer to be typed behind it: with its
/// default in angle brackets and its options, each as it is typed, in round ones.
/// "Number of frames <100>: ", "Direction <Clockwise> ( Clockwise AntiClockwise ): "
std::wstring promptText(const Question& question);

/// Breaks a prompt between its words into lines that leave room to type behind the last.
/// @param width  columns of a line, of which a wide character takes two
std::wstring wrappedPrompt(const std::wstring& prompt, std::size_t width);

} // namespace quarn::program
