#pragma once

#include <string>
#include <string_view>

namespace quarn {

/// The arguments that KM_wString::Format takes from its caller for this text, one character or two
/// each, in their order: texts with the same ones can stand for each other. Empty where the text
/// takes none.
std::wstring formatArguments(std::wstring_view format);

} // namespace quarn
