#include "engine/display/InstructionSet.h"

#include <atomic>

namespace quarn {

namespace {

bool hasAvx2() {
    return __builtin_cpu_supports("avx2") && __builtin_cpu_supports("fma") &&
           __builtin_cpu_supports("bmi") && __builtin_cpu_supports("bmi2");
}

bool hasAvx512() {
    return hasAvx2() && __builtin_cpu_supports("avx512f") && __builtin_cpu_supports("avx512bw") &&
           __builtin_cpu_supports("avx512cd") && __builtin_cpu_supports("avx512dq") &&
           __builtin_cpu_supports("avx512vl");
}

InstructionSet fastest() {
    static const InstructionSet set = setsOfProcessor().front();
    return set;
}

/// One for the whole program: loops that run side by side draw parts of one picture.
std::atomic<std::optional<InstructionSet>> chosen_set;

} // namespace

std::string_view nameOf(InstructionSet set) {
    switch (set) {
    case InstructionSet::avx512:
        return "avx512";
    case InstructionSet::avx2:
        return "avx2";
    case InstructionSet::sse2:
        break;
    }
    return "sse2";
}

std::vector<InstructionSet> setsOfProcessor() {
    std::vector<InstructionSet> sets;
    if (hasAvx512())
        sets.push_back(InstructionSet::avx512);
    if (hasAvx2())
        sets.push_back(InstructionSet::avx2);
    sets.push_back(InstructionSet::sse2);
    return sets;
}

InstructionSet instructionSetInForce() {
    return chosen_set.load().value_or(fastest());
}

void chooseInstructionSet(std::optional<InstructionSet> set) {
    chosen_set = set;
}

} // namespace quarn
