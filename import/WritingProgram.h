#pragma once

#include "import/ImportedModel.h"

#include <initializer_list>
#include <string_view>

namespace quarn {

/// A program that writes model files, and the axis that points up in them.
struct WritingProgram {
    std::string_view mark; ///< a piece of what it writes of itself
    std::string_view name;
    UpAxis up;
};

/// The axis that points up in a file of a format that leaves it open, as Z by habit: the one that
/// was asked for, else that of the program which wrote the file.
/// @param header    what the file says of where it comes from
/// @param programs  those that are known to leave such files behind
TakenUpAxis upAxisOf(UpAxis asked, std::string_view header,
                     std::initializer_list<WritingProgram> programs);

} // namespace quarn
