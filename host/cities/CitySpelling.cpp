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

bool isAscii(char letter) {
    return (static_cast<unsigned char>(letter) & 0x80U) == 0;
}

void appendAscii(std::string_view letters, std::string& compared) {
    for (const char letter : letters) {
        if (letter >= 'A' && letter <= 'Z')
            compared += static_cast<char>(letter - 'A' + 'a');
        else if ((letter >= 'a' && letter <= 'z') || (letter >= '0' && letter <= '9'))
            compared += letter;
    }
}

void appendOthers(std::string_view characters, std::string& compared) {
    if (characters.empty())
        return;
    const KM_wString written = KM_wString::FromUtf8(characters);
    std::wstring plain;
    for (const wchar_t character : written.View())
        plain += plainLetters(character);
    compared += KM_wString(plain).ToUtf8();
}

} // namespace

std::string comparedName(std::string_view name) {
    std::string compared;
    while (!name.empty()) {
        const auto other = std::ranges::find_if_not(name, isAscii);
        const auto ascii = static_cast<std::size_t>(other - name.begin());
        const auto end =
            static_cast<std::size_t>(std::find_if(other, name.end(), isAscii) - name.begin());
        appendAscii(name.substr(0, ascii), compared);
        appendOthers(name.substr(ascii, end - ascii), compared);
        name.remove_prefix(end);
    }
    return compared;
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
