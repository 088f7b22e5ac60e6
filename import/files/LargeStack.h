#pragma once

#include <functional>

namespace quarn {

/// Runs `work`, which must not throw, on a thread with a stack of 512 MB, and waits for its end.
/// The reading library walks a file's nodes by recursion, and a hostile file nests them deeper than
/// an ordinary stack can follow. Only the pages that are used take memory. Where such a thread is
/// not to be had, the work runs on the calling thread.
void runWithLargeStack(const std::function<void()>& work);

} // namespace quarn
