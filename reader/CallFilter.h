#pragma once

namespace quarn {

/// Lets this process make only those calls of the system for good that reading, memory and threads
/// need. Others are refused with EPERM; one that no honest reader makes, such as starting a
/// program, ends the process.
/// @return false where the kernel has no such filter
bool filterCalls();

} // namespace quarn
