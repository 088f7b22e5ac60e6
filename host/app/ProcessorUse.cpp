#include "host/app/ProcessorUse.h"

#include "engine/display/InstructionSet.h"

#include <algorithm>

namespace quarn {

namespace {

std::optional<InstructionSet> setNamed(const std::string& name) {
    const std::vector<InstructionSet> sets = setsOfProcessor();
    const auto found = std::ranges::find(sets, name, nameOf);
    return found == sets.end() ? std::nullopt : std::optional(*found);
}

} // namespace

ProcessorUse::ProcessorUse(const SessionOptions& options) {
    chooseInstructionSet(setNamed(options.instructions));
    if (options.most_threads > 0)
        m_limit.emplace(tbb::global_control::max_allowed_parallelism,
                        static_cast<std::size_t>(options.most_threads));
}

ProcessorUse::~ProcessorUse() {
    chooseInstructionSet(std::nullopt);
}

int mostThreads() {
    const std::size_t threads =
        tbb::global_control::active_value(tbb::global_control::max_allowed_parallelism);
    return std::max(1, static_cast<int>(threads));
}

} // namespace quarn
