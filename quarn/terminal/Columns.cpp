#include "quarn/terminal/Columns.h"

#include "quarn/terminal/TextWidth.h"
#include "quarn/words/Words.h"

#include <algorithm>

namespace quarn::program {

namespace {

constexpr std::size_t GAP = 2;

} // namespace

std::string inColumns(const std::vector<std::wstring>& names, std::size_t width) {
    std::size_t longest = 1;
    for (const std::wstring& name : names)
        longest = std::max(longest, textWidth(name));
    const std::size_t columns = std::max<std::size_t>(1, (width + GAP) / (longest + GAP));
    const std::size_t rows = (names.size() + columns - 1) / columns;

    std::wstring text;
    for (std::size_t row = 0; row < rows; ++row) {
        for (std::size_t i = row; i < names.size(); i += rows) {
            const bool is_last = i + rows >= names.size();
            text += names[i] +
                    (is_last ? L"\n" : std::wstring(longest + GAP - textWidth(names[i]), L' '));
        }
    }
    return utf8Text(text);
}

} // namespace quarn::program
