#include "quarn/terminal/TextWidth.h"

#include <algorithm>
#include <span>

namespace quarn::program {

namespace {

struct Range {
    char32_t first;
    char32_t last;
};

/// Scripts and symbols that are wide or fullwidth. Pictographs are taken as whole blocks, whose few
/// narrow ones lose nothing by a blank.
constexpr Range WIDE[] = {
    {0x1100, 0x115F},   {0x231A, 0x231B},   {0x2329, 0x232A},   {0x23E9, 0x23EC},
    {0x2614, 0x2615},   {0x2648, 0x2653},   {0x2E80, 0x303E},   {0x3041, 0x33FF},
    {0x3400, 0x4DBF},   {0x4E00, 0xA4CF},   {0xA960, 0xA97F},   {0xAC00, 0xD7A3},
    {0xF900, 0xFAFF},   {0xFE10, 0xFE19},   {0xFE30, 0xFE6F},   {0xFF01, 0xFF60},
    {0xFFE0, 0xFFE6},   {0x17000, 0x18CFF}, {0x1B000, 0x1B2FF}, {0x1F300, 0x1F64F},
    {0x1F680, 0x1F6FF}, {0x1F900, 0x1FAFF}, {0x20000, 0x3FFFD},
};

/// Marks that stand over or under the character before them, and those that only steer it.
constexpr Range WITHOUT_WIDTH[] = {
    {0x0300, 0x036F}, {0x0483, 0x0489}, {0x0591, 0x05BD}, {0x064B, 0x065F}, {0x1AB0, 0x1AFF},
    {0x1DC0, 0x1DFF}, {0x200B, 0x200F}, {0x2060, 0x2064}, {0x20D0, 0x20FF}, {0x302A, 0x302D},
    {0x3099, 0x309A}, {0xFE00, 0xFE0F}, {0xFE20, 0xFE2F}, {0xFEFF, 0xFEFF}, {0xE0100, 0xE01EF},
};

bool isIn(std::span<const Range> ranges, char32_t character) {
    return std::ranges::any_of(ranges, [character](const Range& range) {
        return character >= range.first && character <= range.last;
    });
}

std::size_t widthOf(wchar_t character) {
    const auto code = static_cast<char32_t>(character);
    if (code < 0x300)
        return 1;
    if (isIn(WITHOUT_WIDTH, code))
        return 0;
    return isIn(WIDE, code) ? 2 : 1;
}

} // namespace

std::size_t textWidth(std::wstring_view text) {
    std::size_t width = 0;
    for (const wchar_t character : text)
        width += widthOf(character);
    return width;
}

} // namespace quarn::program
