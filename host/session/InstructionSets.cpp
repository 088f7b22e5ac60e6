#include "host/session/InstructionSets.h"

#include "engine/display/InstructionSet.h"

#include <algorithm>

namespace quarn {

namespace {

/// "avx512, avx2 and sse2"
std::string listOf(const std::vector<std::string>& sets) {
    std::string text;
    for (std::size_t i = 0; i < sets.size(); ++i)
        text += (i == 0 ? "" : i + 1 == sets.size() ? " and " : ", ") + sets[i];
    return text;
}

} // namespace

std::vector<std::string> instructionSets() {
    std::vector<std::string> names;
    for (const InstructionSet set : setsOfProcessor())
        names.emplace_back(nameOf(set));
    return names;
}

std::optional<std::string> whyInstructionsAreRefused(const std::string& name,
                                                     const std::vector<std::string>& sets) {
    if (std::ranges::find(sets, name) != sets.end())
        return std::nullopt;
    return "\"" + name +
           "\" is no instruction set that pictures can be drawn with on this processor, which "
           "has " +
           listOf(sets) + ".";
}

} // namespace quarn
