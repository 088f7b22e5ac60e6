#include "host/app/FormatArguments.h"

#include <algorithm>

namespace quarn {

namespace {

constexpr std::wstring_view FLAGS = L"-+ 0#";
constexpr std::wstring_view DIGITS = L"0123456789";
constexpr std::wstring_view SIZES = L"hlLjzt";
constexpr std::wstring_view KINDS = L"diuxXofFeEgGaAcsp";

/// One conversion, read from behind its percent sign.
class ConversionReader {
public:
    explicit ConversionReader(std::wstring_view rest) : m_rest(rest) {}

    std::wstring arguments() {
        skip(FLAGS);
        readField();
        if (take(L'.'))
            readField();
        const std::wstring size(skip(SIZES));
        if (!m_rest.empty() && KINDS.find(m_rest.front()) != std::wstring_view::npos)
            m_arguments += (isWideText(size) ? L"" : size) + m_rest.front();
        m_rest.remove_prefix(std::min<std::size_t>(m_rest.size(), 1));
        return m_arguments;
    }

    std::wstring_view rest() const { return m_rest; }

private:
    std::wstring_view skip(std::wstring_view characters) {
        const std::size_t length = std::min(m_rest.find_first_not_of(characters), m_rest.size());
        const std::wstring_view skipped = m_rest.substr(0, length);
        m_rest.remove_prefix(length);
        return skipped;
    }

    bool take(wchar_t character) {
        if (!m_rest.starts_with(character))
            return false;
        m_rest.remove_prefix(1);
        return true;
    }

    /// A width or a precision.
    void readField() {
        if (take(L'*'))
            m_arguments += L'*';
        else
            skip(DIGITS);
    }

    /// Text is wide with and without the letter.
    bool isWideText(std::wstring_view size) const {
        return size == L"l" && m_rest.starts_with(L's');
    }

    std::wstring_view m_rest;
    std::wstring m_arguments;
};

} // namespace

std::wstring formatArguments(std::wstring_view format) {
    std::wstring arguments;
    for (std::size_t at = format.find(L'%'); at != std::wstring_view::npos;
         at = format.find(L'%')) {
        ConversionReader conversion(format.substr(at + 1));
        arguments += conversion.arguments();
        format = conversion.rest();
    }
    return arguments;
}

} // namespace quarn
