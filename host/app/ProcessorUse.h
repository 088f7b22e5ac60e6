#pragma once

#include "host/front_end/SessionOptions.h"

#include <tbb/global_control.h>

#include <optional>

namespace quarn {

/// How much of the processor a session uses, as long as this lives: by how many threads, and which
/// of its instructions.
class ProcessorUse {
public:
    /// A name of instructions that is refused counts as none.
    explicit ProcessorUse(const SessionOptions& options);
    /// The next session may choose anew.
    ~ProcessorUse();
    ProcessorUse(const ProcessorUse&) = delete;
    ProcessorUse& operator=(const ProcessorUse&) = delete;

private:
    std::optional<tbb::global_control> m_limit;
};

/// How many threads may work, that which asks among them.
int mostThreads();

} // namespace quarn
