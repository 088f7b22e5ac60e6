#pragma once

#include <string>
#include <string_view>

namespace quarn {

/// The text of a DAE file without the blanks between a tag and what follows it: the reading library
/// takes numbers that begin with a blank for damage.
std::string withoutBlanksBehindTags(std::string_view text);

} // namespace quarn
