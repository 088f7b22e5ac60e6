#include "kelmar/KM_CaseFold.h"

#include <clocale>
#include <cstdint>
#include <cwctype>

namespace kelmar {
namespace {

// Lasts as long as the program. A machine without C.UTF-8 still knows the letters of English.
locale_t unicode() {
    static const locale_t locale = [] {
        const locale_t found = newlocale(LC_CTYPE_MASK, "C.UTF-8", nullptr);
        return found ? found : newlocale(LC_CTYPE_MASK, "C", nullptr);
    }();
    return locale;
}

} // namespace

wchar_t toLower(wchar_t character) {
    return static_cast<wchar_t>(towlower_l(static_cast<wint_t>(character), unicode()));
}

wchar_t toUpper(wchar_t character) {
    return static_cast<wchar_t>(towupper_l(static_cast<wint_t>(character), unicode()));
}

wchar_t foldCase(wchar_t character) {
    return toLower(toUpper(character));
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
