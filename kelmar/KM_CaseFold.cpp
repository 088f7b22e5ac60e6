#include "kelmar/KM_CaseFold.h"

#include <cstdint>

namespace kelmar {
namespace {

// Capitals from first to last, every step-th of them, whose small letters stand offset further on.
struct CapitalRange {
    std::uint32_t first;
    std::uint32_t last;
    std::int32_t offset;
    std::uint32_t step;
};

// From the Unicode Character Database, UnicodeData.txt, simple mappings of these blocks.
constexpr CapitalRange capital_ranges[] = {
    {0x0041, 0x005A, 32, 1}, {0x00C0, 0x00D6, 32, 1},   {0x00D8, 0x00DE, 32, 1},
    {0x0100, 0x012E, 1, 2},  {0x0132, 0x0136, 1, 2},    {0x0139, 0x0147, 1, 2},
    {0x014A, 0x0176, 1, 2},  {0x0178, 0x0178, -121, 1}, {0x0179, 0x017D, 1, 2},
    {0x0386, 0x0386, 38, 1}, {0x0388, 0x038A, 37, 1},   {0x038C, 0x038C, 64, 1},
    {0x038E, 0x038F, 63, 1}, {0x0391, 0x03A1, 32, 1},   {0x03A3, 0x03AB, 32, 1},
    {0x0400, 0x040F, 80, 1}, {0x0410, 0x042F, 32, 1},   {0x0460, 0x0480, 1, 2},
    {0x048A, 0x04BE, 1, 2},  {0x04C0, 0x04C0, 15, 1},   {0x04C1, 0x04CD, 1, 2},
    {0x04D0, 0x052E, 1, 2},  {0x0531, 0x0556, 48, 1},   {0x1E00, 0x1E94, 1, 2},
    {0x1EA0, 0x1EFE, 1, 2},
};

bool isCapitalOf(const CapitalRange& range, std::uint32_t code) {
    return code >= range.first && code <= range.last && (code - range.first) % range.step == 0;
}

} // namespace

wchar_t toLower(wchar_t character) {
    const auto code = static_cast<std::uint32_t>(character);
    for (const CapitalRange& range : capital_ranges) {
        if (isCapitalOf(range, code))
            return static_cast<wchar_t>(character + range.offset);
    }
    return character;
}

wchar_t toUpper(wchar_t character) {
    const auto code = static_cast<std::uint32_t>(character);
    for (const CapitalRange& range : capital_ranges) {
        if (isCapitalOf(range, code - static_cast<std::uint32_t>(range.offset)))
            return static_cast<wchar_t>(character - range.offset);
    }
    return character;
}

wchar_t foldCase(wchar_t character) {
    switch (character) {
    case 0x03C2: // final sigma
        return 0x03C3;
    case 0x00B5: // micro sign
        return 0x03BC;
    case 0x017F: // long s
        return L's';
    default:
        return toLower(character);
    }
}

bool isSpace(wchar_t character) {
    const auto code = static_cast<std::uint32_t>(character);
    if ((code >= 0x09 && code <= 0x0D) || (code >= 0x2000 && code <= 0x200A))
        return true;
    switch (code) {
    case 0x20:
    case 0x85:
    case 0xA0:
    case 0x1680:
    case 0x2028:
    case 0x2029:
    case 0x202F:
    case 0x205F:
    case 0x3000:
        return true;
    default:
        return false;
    }
}

} // namespace kelmar
