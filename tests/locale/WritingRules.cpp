#include "tests/locale/TextRules.h"

#include "kelmar/KM_wString.h"

#include <algorithm>
#include <regex>
#include <string_view>

namespace locale_rules {
namespace {

using std::wstring_view;

bool isBetween(wchar_t character, wchar_t first, wchar_t last) {
    return character >= first && character <= last;
}
bool isHan(wchar_t character) {
    return isBetween(character, 0x3400, 0x9FFF);
}
bool isKana(wchar_t character) {
    return isBetween(character, 0x3041, 0x30FF);
}
bool isEastAsian(wchar_t character) {
    return isHan(character) || isKana(character);
}
/// Of the Latin languages here; the C library's answer hangs on the locale of the program.
bool isLetter(wchar_t character) {
    return isBetween(character, L'a', L'z') || isBetween(character, L'A', L'Z') ||
           (isBetween(character, 0xC0, 0x17F) && character != 0xD7 && character != 0xF7);
}
bool isWide(const std::string& language) {
    return language == "ja" || language == "zh";
}

bool hasAny(wstring_view text, wstring_view characters) {
    return text.find_first_of(characters) != wstring_view::npos;
}

/// Neither control characters nor invisible ones, no stand-ins for what could not be read, no
/// accents apart from their letters, and no UTF-8 that was read as another encoding.
bool isClean(wstring_view text) {
    const bool is_broken = std::ranges::any_of(text, [](wchar_t c) {
        return (c < 0x20 && c != L'\n') || isBetween(c, 0x7F, 0x9F) || c == 0xFFFD || c == 0xFEFF ||
               isBetween(c, 0x200B, 0x200F) || isBetween(c, 0x0300, 0x036F);
    });
    if (is_broken)
        return false;
    for (std::size_t i = 0; i + 1 < text.size(); ++i)
        if ((isBetween(text[i], 0xC2, 0xC3) && isBetween(text[i + 1], 0x80, 0xBF)) ||
            (text[i] == 0xE2 && text[i + 1] == 0x20AC))
            return false;
    return true;
}

/// By frequent characters of commands that only one of two neighbours writes so.
bool isInScriptOf(const std::string& language, wstring_view text) {
    if (!isWide(language))
        return std::ranges::none_of(text, [](wchar_t c) { return c >= 0x2E80; });
    if (language == "zh")
        return std::ranges::none_of(text, isKana) && !hasAny(text, L"図択変読込単発絵");
    return !hasAny(text, L"图设动选择关变读转录编续种圆处项视觉进显个这");
}

/// The mark that a text ends with, in the writing of English: one of ".:?!…", or nothing.
wchar_t endMark(wstring_view text) {
    const std::size_t last = text.find_last_not_of(L" \n");
    if (last == wstring_view::npos)
        return 0;
    if (text.substr(0, last + 1).ends_with(L"..."))
        return L'…';
    constexpr wstring_view MARKS = L".:?!…", WIDE_MARKS = L"。：？！…";
    const wchar_t character = text[last];
    if (const std::size_t wide = WIDE_MARKS.find(character); wide != wstring_view::npos)
        return MARKS[wide];
    return MARKS.find(character) == wstring_view::npos ? 0 : character;
}

/// Whether every opening one is followed by its closing one, and none stands alone.
bool arePaired(wstring_view text, wchar_t open, wchar_t close) {
    int depth = 0;
    for (const wchar_t character : text) {
        depth += character == open ? 1 : character == close ? -1 : 0;
        if (depth < 0 || depth > 1)
            return false;
    }
    return depth == 0;
}

struct Quotes {
    wstring_view language;
    wchar_t open;
    wchar_t close;
};
constexpr Quotes QUOTES[] = {
    {L"de", L'„', L'“'},   {L"es", L'«', L'»'}, {L"fr", L'«', L'»'},
    {L"ja", L'「', L'」'}, {L"zh", L'“', L'”'},
};

bool hasOwnQuotes(const std::string& language, wstring_view text) {
    const auto own = std::ranges::find_if(QUOTES, [&](const Quotes& quotes) {
        return std::string(quotes.language.begin(), quotes.language.end()) == language;
    });
    const auto is_foreign = [&](wchar_t c) {
        return wstring_view(L"„“”«»「」『』‘‚‹›").find(c) != wstring_view::npos && c != own->open &&
               c != own->close;
    };
    return std::ranges::none_of(text, is_foreign) && arePaired(text, own->open, own->close);
}

/// No narrow mark touches a character of the script, and narrow brackets hold none.
bool hasWideMarks(wstring_view text) {
    int depth = 0;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const bool after = i > 0 && isEastAsian(text[i - 1]);
        const bool before = i + 1 < text.size() && isEastAsian(text[i + 1]);
        if (hasAny(text.substr(i, 1), L",;:?!.") && (after || before))
            return false;
        const bool opens_key = text.substr(i).starts_with(L"(&");
        if (text[i] == L'(' && !opens_key && (after || before))
            return false;
        depth += text[i] == L'(' ? 1 : text[i] == L')' ? -1 : 0;
        if (depth > 0 && isEastAsian(text[i]))
            return false;
    }
    return true;
}

/// A mark of two parts stands apart from the word before it.
bool hasFrenchBlanks(wstring_view text) {
    for (std::size_t i = 1; i < text.size(); ++i)
        if (hasAny(text.substr(i, 1), L":;?!") && isLetter(text[i - 1]))
            return false;
    return true;
}

bool hasSpanishPairs(wstring_view text) {
    return arePaired(text, L'¿', L'?') && arePaired(text, L'¡', L'!');
}

/// Listed signs (\ / : * ? " < > |) are not the sentence's own marks.
std::string withoutListedSigns(const std::string& text) {
    static const std::regex signs(R"( ?\\ / : \* \? " < > \|)");
    return std::regex_replace(text, signs, "");
}

} // namespace

std::vector<std::string> faultsOfWriting(const Translation& text) {
    const KM_wString local = KM_wString::FromUtf8(withoutListedSigns(text.local));
    const KM_wString english = KM_wString::FromUtf8(withoutListedSigns(text.english));
    const wstring_view written = local.View();
    std::vector<std::string> faults;
    const auto require = [&](bool is_met, const char* fault) {
        if (!is_met)
            faults.push_back(fault);
    };
    require(isClean(written), "broken or invisible characters");
    require(isInScriptOf(text.language, written), "characters of another language's script");
    require(endMark(written) == endMark(english.View()), "another mark at the end than in English");
    require(written.find(L"...") == wstring_view::npos, "three dots in place of an ellipsis");
    require(!hasAny(written, L"'`´"), "a typewriter's apostrophe");
    require(written.find(L"  ") == wstring_view::npos ||
                english.View().find(L"  ") != wstring_view::npos,
            "two blanks");
    require(hasOwnQuotes(text.language, written), "quotes of another language, or open ones");
    require(!isWide(text.language) || hasWideMarks(written), "narrow marks beside wide characters");
    require(isWide(text.language) || !hasAny(written, L"，。：；？！（）"), "wide marks");
    require(text.language != "fr" || hasFrenchBlanks(written),
            "no blank before a mark of two parts");
    require(text.language != "es" || hasSpanishPairs(written), "a question or call without ¿ or ¡");
    return faults;
}

} // namespace locale_rules
