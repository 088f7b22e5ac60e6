#include "import/WritingProgram.h"

#include <algorithm>

namespace quarn {

TakenUpAxis upAxisOf(UpAxis asked, std::string_view header,
                     std::initializer_list<WritingProgram> programs) {
    if (asked != UpAxis::by_format)
        return {asked, TakenUpAxis::Reason::asked, {}};
    for (const WritingProgram& program : programs)
        if (header.find(program.mark) != std::string_view::npos)
            return {program.up, TakenUpAxis::Reason::writer, std::string(program.name)};
    return {UpAxis::z, TakenUpAxis::Reason::habit, {}};
}

} // namespace quarn
