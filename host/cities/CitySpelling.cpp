#include "host/cities/CitySpelling.h"

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

/// One character of two bytes at the beginning of a text; 0 when there is none.
unsigned twoByteCharacter(std::string_view text) {
    if (text.size() < 2)
        return 0;
    const unsigned lead = static_cast<unsigned char>(text[0]);
    const unsigned tail = static_cast<unsigned char>(text[1]);
    const bool is_one = lead >= 0xC2 && lead <= 0xDF && (tail & 0xC0U) == 0x80;
    return is_one ? (lead & 0x1FU) << 6U | (tail & 0x3FU) : 0;
}

std::string_view doubleLetter(unsigned character) {
    switch (character) {
    case 0xC6:
    case 0xE6:
        return "ae";
    case 0x152:
    case 0x153:
        return "oe";
    case 0xDF:
        return "ss";
    case 0xDE:
    case 0xFE:
        return "th";
    default:
        return "";
    }
}

/// What stands for a character of two bytes, which may be nothing.
std::string plainLetters(unsigned character, std::string_view bytes) {
    if (character >= 0x300 && character < 0x370) // an accent on the letter before it
        return "";
    if (character == 0x218 || character == 0x219)
        return "s";
    if (character == 0x21A || character == 0x21B)
        return "t";
    if (character == 0x2BB || character == 0x2BC || character < 0xC0) // apostrophes and marks
        return "";
    if (character >= 0x180)
        return std::string(bytes);
    const char plain = PLAIN_LETTERS[character - 0xC0];
    return plain == '?' ? std::string(doubleLetter(character)) : std::string(1, plain);
}

/// An apostrophe, a quotation mark or a dash of typography: U+2010 to U+201F.
bool isTypographicMark(std::string_view text) {
    return text.starts_with("\xE2\x80") && text.size() > 2 && text[2] >= '\x90' &&
           text[2] <= '\x9F';
}

} // namespace

std::string comparedName(std::string_view name) {
    std::string result;
    while (!name.empty()) {
        std::size_t length = 1;
        const char letter = name.front();
        if (const unsigned character = twoByteCharacter(name)) {
            length = 2;
            result += plainLetters(character, name.substr(0, length));
        } else if (isTypographicMark(name)) {
            length = 3;
        } else if (letter >= 'A' && letter <= 'Z') {
            result += static_cast<char>(letter - 'A' + 'a');
        } else if ((letter >= 'a' && letter <= 'z') || (letter >= '0' && letter <= '9') ||
                   (static_cast<unsigned char>(letter) & 0x80U)) {
            result += letter;
        }
        name.remove_prefix(length);
    }
    return result;
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
