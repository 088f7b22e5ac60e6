// Formatting without the C library's printf: that one takes its decimal mark from the locale.

#include "kelmar/KM_wString.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstdarg>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <utility>

namespace {

constexpr int largest_field = 4096;

// Digits before the point of the largest number, and room for the point and an exponent.
template <class Number>
constexpr std::size_t largest_integral_part = std::numeric_limits<Number>::max_exponent10 + 32;

enum class ArgumentSize { char_size, short_size, int_size, long_size, long_long_size, long_double };

struct Conversion {
    bool left = false;
    bool plus = false;
    bool blank = false;
    bool zero = false;
    bool alternate = false;
    int width = 0;
    int precision = -1;
    ArgumentSize size = ArgumentSize::int_size;
    wchar_t kind = 0;
};

std::wstring widen(std::string_view ascii) {
    return {ascii.begin(), ascii.end()};
}

void makeUpperAscii(std::wstring& text) {
    for (wchar_t& character : text) {
        if (character >= L'a' && character <= L'z')
            character -= L'a' - L'A';
    }
}

/// Walks through a format, fetching arguments as conversions ask for them.
class Formatter {
public:
    Formatter(std::wstring_view format, std::va_list arguments) : m_format(format) {
        va_copy(m_arguments, arguments);
    }
    ~Formatter() { va_end(m_arguments); }
    Formatter(const Formatter&) = delete;
    Formatter& operator=(const Formatter&) = delete;

    std::wstring Run() {
        while (m_position < m_format.size()) {
            if (m_format[m_position] == L'%')
                convert();
            else
                m_output += m_format[m_position++];
        }
        return std::move(m_output);
    }

private:
    wchar_t peek() const { return m_position < m_format.size() ? m_format[m_position] : L'\0'; }

    bool take(wchar_t character) {
        if (peek() != character || m_position >= m_format.size())
            return false;
        ++m_position;
        return true;
    }

    void convert() {
        const std::size_t start = m_position++;
        Conversion conversion;
        readFlags(conversion);
        readWidthAndPrecision(conversion);
        readSize(conversion);
        conversion.kind = peek();
        if (m_position < m_format.size())
            ++m_position;
        if (!write(conversion))
            m_output += m_format.substr(start, m_position - start);
    }

    void readFlags(Conversion& conversion) {
        for (;;) {
            if (take(L'-'))
                conversion.left = true;
            else if (take(L'+'))
                conversion.plus = true;
            else if (take(L' '))
                conversion.blank = true;
            else if (take(L'0'))
                conversion.zero = true;
            else if (take(L'#'))
                conversion.alternate = true;
            else
                return;
        }
    }

    int readNumber() {
        int number = 0;
        while (peek() >= L'0' && peek() <= L'9')
            number = std::min(number * 10 + (m_format[m_position++] - L'0'), largest_field);
        return number;
    }

    void readWidthAndPrecision(Conversion& conversion) {
        if (take(L'*')) {
            const int width = std::clamp(va_arg(m_arguments, int), -largest_field, largest_field);
            conversion.left = conversion.left || width < 0;
            conversion.width = std::abs(width);
        } else {
            conversion.width = readNumber();
        }
        if (!take(L'.'))
            return;
        if (take(L'*'))
            conversion.precision = std::clamp(va_arg(m_arguments, int), -1, largest_field);
        else
            conversion.precision = readNumber();
    }

    void readSize(Conversion& conversion) {
        if (take(L'h'))
            conversion.size = take(L'h') ? ArgumentSize::char_size : ArgumentSize::short_size;
        else if (take(L'l'))
            conversion.size = take(L'l') ? ArgumentSize::long_long_size : ArgumentSize::long_size;
        else if (take(L'L'))
            conversion.size = ArgumentSize::long_double;
        else if (take(L'j'))
            conversion.size = ArgumentSize::long_long_size;
        else if (take(L'z') || take(L't'))
            conversion.size = sizeof(std::size_t) == sizeof(long) ? ArgumentSize::long_size
                                                                  : ArgumentSize::int_size;
    }

    bool write(const Conversion& conversion) {
        switch (conversion.kind) {
        case L'%':
            m_output += L'%';
            return true;
        case L'd':
        case L'i':
            writeSigned(conversion);
            return true;
        case L'u':
        case L'x':
        case L'X':
        case L'o':
            writeUnsigned(conversion);
            return true;
        case L'f':
        case L'F':
        case L'e':
        case L'E':
        case L'g':
        case L'G':
        case L'a':
        case L'A':
            writeFloating(conversion);
            return true;
        case L's':
            writeText(conversion);
            return true;
        case L'c':
            pad(conversion, L"", std::wstring(1, static_cast<wchar_t>(va_arg(m_arguments, int))));
            return true;
        case L'p':
            writePointer(conversion);
            return true;
        default:
            return false;
        }
    }

    long long fetchSigned(ArgumentSize size) {
        switch (size) {
        case ArgumentSize::char_size:
            return static_cast<signed char>(va_arg(m_arguments, int));
        case ArgumentSize::short_size:
            return static_cast<short>(va_arg(m_arguments, int));
        case ArgumentSize::long_size:
            return va_arg(m_arguments, long);
        case ArgumentSize::long_long_size:
        case ArgumentSize::long_double:
            return va_arg(m_arguments, long long);
        case ArgumentSize::int_size:
            break;
        }
        return va_arg(m_arguments, int);
    }

    unsigned long long fetchUnsigned(ArgumentSize size) {
        switch (size) {
        case ArgumentSize::char_size:
            return static_cast<unsigned char>(va_arg(m_arguments, unsigned));
        case ArgumentSize::short_size:
            return static_cast<unsigned short>(va_arg(m_arguments, unsigned));
        case ArgumentSize::long_size:
            return va_arg(m_arguments, unsigned long);
        case ArgumentSize::long_long_size:
        case ArgumentSize::long_double:
            return va_arg(m_arguments, unsigned long long);
        case ArgumentSize::int_size:
            break;
        }
        return va_arg(m_arguments, unsigned);
    }

    static std::wstring digitsOf(unsigned long long number, int base, int precision) {
        char buffer[64];
        const auto end = std::to_chars(buffer, buffer + sizeof buffer, number, base).ptr;
        std::wstring digits(buffer, end);
        if (number == 0 && precision == 0)
            digits.clear();
        if (static_cast<int>(digits.size()) < precision)
            digits.insert(0, static_cast<std::size_t>(precision) - digits.size(), L'0');
        return digits;
    }

    static const wchar_t* signOf(const Conversion& conversion, bool negative) {
        if (negative)
            return L"-";
        if (conversion.plus)
            return L"+";
        return conversion.blank ? L" " : L"";
    }

    void writeSigned(Conversion conversion) {
        const long long number = fetchSigned(conversion.size);
        const auto bits = static_cast<unsigned long long>(number);
        // As in C, a stated precision rules over the flag 0.
        conversion.zero = conversion.zero && conversion.precision < 0;
        pad(conversion, signOf(conversion, number < 0),
            digitsOf(number < 0 ? 0 - bits : bits, 10, conversion.precision));
    }

    void writeUnsigned(Conversion conversion) {
        const unsigned long long number = fetchUnsigned(conversion.size);
        const int base = conversion.kind == L'u' ? 10 : conversion.kind == L'o' ? 8 : 16;
        conversion.zero = conversion.zero && conversion.precision < 0;
        std::wstring digits = digitsOf(number, base, conversion.precision);
        std::wstring prefix;
        if (conversion.alternate && base == 16 && number != 0)
            prefix = L"0x";
        if (conversion.alternate && base == 8 && (digits.empty() || digits[0] != L'0'))
            prefix = L"0";
        if (conversion.kind == L'X') {
            makeUpperAscii(digits);
            makeUpperAscii(prefix);
        }
        pad(conversion, prefix, digits);
    }

    template <class Number>
    static std::wstring floatingDigits(Number magnitude, const Conversion& conversion) {
        const wchar_t kind = conversion.kind | 0x20; // to lower case
        const auto style = kind == L'f'   ? std::chars_format::fixed
                           : kind == L'e' ? std::chars_format::scientific
                           : kind == L'g' ? std::chars_format::general
                                          : std::chars_format::hex;
        const int precision = conversion.precision < 0 ? 6 : conversion.precision;
        std::string buffer(largest_integral_part<Number> + static_cast<std::size_t>(precision),
                           '\0');
        char* const begin = buffer.data();
        char* const end = begin + buffer.size();
        const bool shortest = kind == L'a' && conversion.precision < 0;
        const auto written = shortest ? std::to_chars(begin, end, magnitude, style)
                                      : std::to_chars(begin, end, magnitude, style, precision);
        return widen({begin, static_cast<std::size_t>(written.ptr - begin)});
    }

    void writeFloating(Conversion conversion) {
        if (conversion.size == ArgumentSize::long_double)
            writeFloating(conversion, va_arg(m_arguments, long double));
        else
            writeFloating(conversion, va_arg(m_arguments, double));
    }

    template <class Number> void writeFloating(Conversion conversion, Number number) {
        std::wstring digits = floatingDigits(std::abs(number), conversion);
        std::wstring prefix = signOf(conversion, std::signbit(number));
        if ((conversion.kind | 0x20) == L'a' && std::isfinite(number))
            prefix += L"0x";
        if (conversion.kind < L'a') {
            makeUpperAscii(digits);
            makeUpperAscii(prefix);
        }
        conversion.zero = conversion.zero && std::isfinite(number);
        pad(conversion, prefix, digits);
    }

    void writeText(Conversion conversion) {
        std::wstring text;
        if (conversion.size == ArgumentSize::short_size) {
            const char* narrow = va_arg(m_arguments, const char*);
            text = narrow ? KM_wString::FromUtf8(narrow).View() : L"(null)";
        } else {
            text = readWideText(conversion.precision);
        }
        if (conversion.precision >= 0 &&
            text.size() > static_cast<std::size_t>(conversion.precision))
            text.resize(static_cast<std::size_t>(conversion.precision));
        conversion.zero = false;
        pad(conversion, L"", text);
    }

    // With a precision the text need not end in a zero, so no more than that is read.
    std::wstring readWideText(int precision) {
        const wchar_t* text = va_arg(m_arguments, const wchar_t*);
        if (!text)
            return L"(null)";
        if (precision < 0)
            return text;
        std::size_t length = 0;
        while (length < static_cast<std::size_t>(precision) && text[length] != L'\0')
            ++length;
        return {text, length};
    }

    void writePointer(const Conversion& conversion) {
        const auto address = reinterpret_cast<std::uintptr_t>(va_arg(m_arguments, void*));
        pad(conversion, L"0x", digitsOf(address, 16, -1));
    }

    void pad(const Conversion& conversion, std::wstring_view prefix, std::wstring_view body) {
        const std::size_t length = prefix.size() + body.size();
        const auto width = static_cast<std::size_t>(conversion.width);
        const std::size_t missing = width > length ? width - length : 0;
        const bool zeros = conversion.zero && !conversion.left;
        if (!conversion.left && !zeros)
            m_output.append(missing, L' ');
        m_output += prefix;
        if (zeros)
            m_output.append(missing, L'0');
        m_output += body;
        if (conversion.left)
            m_output.append(missing, L' ');
    }

    std::wstring_view m_format;
    std::size_t m_position = 0;
    std::va_list m_arguments;
    std::wstring m_output;
};

} // namespace

void KM_wString::Format(const wchar_t* format, ...) {
    std::va_list arguments;
    va_start(arguments, format);
    std::wstring formatted = format ? Formatter(format, arguments).Run() : std::wstring();
    va_end(arguments);
    m_text = std::move(formatted);
}

KM_wString KM_wString::FormatToString(const wchar_t* format, ...) {
    std::va_list arguments;
    va_start(arguments, format);
    KM_wString formatted;
    if (format)
        formatted.m_text = Formatter(format, arguments).Run();
    va_end(arguments);
    return formatted;
}
