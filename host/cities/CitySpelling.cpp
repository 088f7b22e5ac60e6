#include "host/cities/CitySpelling.h"

#include "kelmar/KM_wString.h"

#include <algorithm>
#include <vector>

namespace quarn {
namespace {

/// The plain letters for U+00C0 to U+017F; '?' stands for two letters or none.
constexpr std::string_view PLAIN_LETTERS = "aaaaaa?ceeeeiiii"
                                           "dnooooo?ouuuuy??"
                                           "aaaaaa?ceeeeiiii"
                                           "dnooooo?ouuuuy?y"
                                           "aaaaaaccccccccdd"
                                           "ddeeeeeeeeeegggg"
                                           "gggghhhhiiiiiiii"
                                           "ii??jjkkklllllll"
                                           "lllnnnnnnnnnoooo"
                                           "oo??rrrrrrssssss"
                                           "ssttttttuuuuuuuu"
                                           "uuuuwwyyyzzzzzzs";
static_assert(PLAIN_LETTERS.size() == 0x180 - 0xC0);

std::wstring doubleLetter(wchar_t character) {
    switch (character) {
    case 0xC6:
    case 0xE6:
        return L"ae";
    case 0x152:
    case 0x153:
        return L"oe";
    case 0xDF:
        return L"ss";
    case 0xDE:
    case 0xFE:
        return L"th";
    default:
        return {};
    }
}

/// An accent on the letter before it, an apostrophe, a quotation mark or a dash.
bool isMark(wchar_t character) {
    return character < 0xC0 || character == 0x2BB || character == 0x2BC ||
           (character >= 0x300 && character < 0x370) || (character >= 0x2010 && character < 0x2020);
}

/// What stands for a character that is not of ASCII, which may be nothing.
std::wstring plainLetters(wchar_t character) {
    if (isMark(character))
        return {};
    if (character == 0x218 || character == 0x219)
        return L"s";
    if (character == 0x21A || character == 0x21B)
        return L"t";
    if (character >= 0x180)
        return {character};
    const char plain = PLAIN_LETTERS[static_cast<std::size_t>(character - 0xC0)];
    return plain == '?' ? doubleLetter(character) : std::wstring{static_cast<wchar_t>(plain)};
}

std::wstring comparedCharacter(wchar_t character) {
    if (character >= 0x80)
        return plainLetters(character);
    if (character >= L'A' && character <= L'Z')
        return {static_cast<wchar_t>(character - L'A' + L'a')};
    const bool stays =
        (character >= L'a' && character <= L'z') || (character >= L'0' && character <= L'9');
    return stays ? std::wstring{character} : std::wstring{};
}

} // namespace

std::string comparedName(std::string_view name) {
    const KM_wString written = KM_wString::FromUtf8(name);
    std::wstring compared;
    for (const wchar_t character : written.View())
        compared += comparedCharacter(character);
    return KM_wString(compared).ToUtf8();
}

int lettersApart(std::string_view one, std::string_view other) {
    std::vector<int> before_last(other.size() + 1);
    std::vector<int> last(other.size() + 1);
    std::vector<int> present(other.size() + 1);
    for (std::size_t column = 0; column <= other.size(); ++column)
        present[column] = static_cast<int>(column);
    for (std::size_t row = 1; row <= one.size(); ++row) {
        before_last.swap(last);
        last.swap(present);
        present[0] = static_cast<int>(row);
        for (std::size_t column = 1; column <= other.size(); ++column) {
            const int changed = last[column - 1] + (one[row - 1] != other[column - 1]);
            present[column] = std::min({changed, last[column] + 1, present[column - 1] + 1});
            const bool is_swap = row > 1 && column > 1 && one[row - 1] == other[column - 2] &&
                                 one[row - 2] == other[column - 1];
            if (is_swap)
                present[column] = std::min(present[column], before_last[column - 2] + 1);
        }
    }
    return present[other.size()];
}

} // namespace quarn
