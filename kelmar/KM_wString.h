#pragma once

#include "kelmar/KM_Export.h"

#include <compare>
#include <string>
#include <string_view>

/// Wide text: a value type that owns its characters. Indices count characters from 0.
///
/// No operation depends on the process's locale. Case changes and case-blind comparison know
/// ASCII, the Latin letters of Europe and Vietnam, Greek, Cyrillic and Armenian, one character to
/// one character; every other character is its own upper and lower case.
class KELMAR_API KM_wString {
public:
    KM_wString() = default;

    /// Copies zero-terminated text; a null pointer gives the empty string.
    KM_wString(const wchar_t* text);

    /// Copies the characters of the view, which may hold zeros.
    KM_wString(std::wstring_view text);

    /// Number of characters.
    int Length() const;
    bool IsEmpty() const;
    /// Makes the string empty.
    void Empty();

    /// Zero-terminated text, never null; valid until the string changes or dies.
    const wchar_t* Array() const;
    operator const wchar_t*() const { return Array(); }
    /// The characters; valid until the string changes or dies.
    std::wstring_view View() const { return m_text; }

    /// The character at `index`, or 0 when the index is outside the string.
    wchar_t operator[](int index) const;
    /// Replaces the character at `index`; an index outside the string changes nothing.
    void SetAt(int index, wchar_t character);

    KM_wString& operator+=(const KM_wString& tail);
    /// A null pointer adds nothing.
    KM_wString& operator+=(const wchar_t* tail);
    KM_wString& operator+=(wchar_t tail);

    friend KELMAR_API KM_wString operator+(const KM_wString& head, const KM_wString& tail);
    friend KELMAR_API KM_wString operator+(const KM_wString& head, const wchar_t* tail);
    friend KELMAR_API KM_wString operator+(const wchar_t* head, const KM_wString& tail);

    /// Equality and order by character value; a null pointer counts as empty text.
    friend KELMAR_API bool operator==(const KM_wString& a, const KM_wString& b);
    friend KELMAR_API bool operator==(const KM_wString& a, const wchar_t* b);
    friend KELMAR_API bool operator<(const KM_wString& a, const KM_wString& b);

    /// Compares by character value: negative, 0 or positive as this text comes before, equals or
    /// comes after `other`. A null pointer counts as empty text.
    int Compare(const wchar_t* other) const;
    /// As Compare, with upper and lower case taken as equal.
    int CompareNoCase(const wchar_t* other) const;

    /// Index of the first occurrence, or -1. Empty text is found at 0; null is never found.
    int Find(wchar_t character) const;
    int Find(const wchar_t* text) const;

    /// Up to `count` characters from index `first`; the range is cut to the string.
    KM_wString Mid(int first, int count) const;
    /// The first `count` characters, or all when there are fewer.
    KM_wString Left(int count) const;
    /// The last `count` characters, or all when there are fewer.
    KM_wString Right(int count) const;

    /// Remove white space (blank, tab to carriage return, U+0085, U+00A0 and Unicode's other
    /// space separators) from one end or both.
    void TrimLeft();
    void TrimRight();
    void TrimLeftAndRight();

    /// Removes every occurrence.
    /// @return how many characters were removed
    int Remove(wchar_t character);
    /// Replaces every occurrence.
    /// @return how many characters were replaced
    int Replace(wchar_t from, wchar_t to);
    /// Replaces every occurrence, from left to right, never looking into what was put in. A null
    /// or empty `from` replaces nothing; a null `to` counts as empty.
    /// @return how many occurrences were replaced
    int Replace(const wchar_t* from, const wchar_t* to);

    void MakeLower();
    void MakeUpper();

    /// Replaces the content with formatted text; the decimal mark is always a point.
    ///
    /// Conversions: `%d %i %u %x %X %o` (with `hh h l ll j z t`), `%f %F %e %E %g %G %a %A`
    /// (with `L`), `%c`, `%s` and `%ls` (both take a `const wchar_t*`), `%hs` (UTF-8
    /// `const char*`), `%p` and `%%`, with the flags `- + blank 0 #`, width and precision as
    /// numbers or `*` (cut to 4096). `#` has no effect on floating-point conversions. A null
    /// string prints "(null)". A conversion that is not in this list is copied as it stands and
    /// takes no argument. Arguments may point into this very string. A null format gives the
    /// empty string.
    void Format(const wchar_t* format, ...);
    /// The text that Format would store.
    static KM_wString FormatToString(const wchar_t* format, ...);

    /// The text in UTF-8; what is no Unicode character becomes U+FFFD.
    std::string ToUtf8() const;
    /// Text from UTF-8. Each maximal ill-formed part (overlong forms, surrogates, values above
    /// U+10FFFF and cut sequences included) becomes one U+FFFD, as The Unicode Standard
    /// recommends in section 3.9, "U+FFFD Substitution of Maximal Subparts".
    static KM_wString FromUtf8(std::string_view bytes);

private:
    std::wstring m_text;
};
