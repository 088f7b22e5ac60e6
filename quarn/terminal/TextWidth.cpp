#include "quarn/terminal/TextWidth.h"

#include "quarn/terminal/Utf8Scope.h"

#include <algorithm>
#include <cwchar>

namespace quarn::program {

std::size_t textWidth(std::wstring_view text) {
    const Utf8Scope utf8;
    std::size_t width = 0;
    for (const wchar_t character : text)
        width += static_cast<std::size_t>(std::max(0, wcwidth(character)));
    return width;
}

} // namespace quarn::program
