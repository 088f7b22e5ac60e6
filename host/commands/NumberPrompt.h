#pragma once

#include "sdk/qncore/QnCommand.h"

namespace quarn {

/// Asks for a number; Enter keeps the present one.
/// @param number  the present one, and the answer; the limits are among the answers
CQuarnCommand::result askNumber(const wchar_t* prompt, double lowest, double highest,
                                double& number);

} // namespace quarn
