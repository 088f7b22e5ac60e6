#pragma once

#include <optional>
#include <string_view>
#include <vector>

namespace quarn {

/// The instructions of the processor that pictures are drawn with, and rays followed. Pictures of
/// different sets differ in a few pixels.
enum class InstructionSet { sse2, avx2, avx512 };

/// "sse2", "avx2" or "avx512".
std::string_view nameOf(InstructionSet set);

/// Those that this processor has, the fastest first; sse2 is always among them.
std::vector<InstructionSet> setsOfProcessor();

/// What is drawn with from now on, in the whole program: the set that was chosen, else the fastest.
InstructionSet instructionSetInForce();

/// Chooses what is drawn with. A pipeline, a renderer and a scene's search structure stay with the
/// set in force when they were made, so this is to be called before there are any.
/// @param set  one of setsOfProcessor(); nothing: the fastest
void chooseInstructionSet(std::optional<InstructionSet> set);

} // namespace quarn
