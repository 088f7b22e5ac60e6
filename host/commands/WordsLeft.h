#pragma once

namespace quarn {

/// Whether the line of the command that runs has words left: answers that were given in advance.
bool hasWordsLeft();

} // namespace quarn
