#include "tests/locale/SourceTokens.h"

#include <algorithm>
#include <cctype>

namespace locale_rules {
namespace {

bool isWordCharacter(char character) {
    return std::isalnum(static_cast<unsigned char>(character)) || character == '_';
}

/// What a piece of source between quotes stands for. Escapes of single characters only: texts are
/// written as themselves.
std::string unescaped(std::string_view source) {
    std::string text;
    for (std::size_t i = 0; i < source.size(); ++i) {
        const bool is_escaped = source[i] == '\\' && i + 1 < source.size();
        if (is_escaped)
            ++i;
        text += is_escaped && source[i] == 'n' ? '\n' : source[i];
    }
    return text;
}

class Reader {
public:
    explicit Reader(std::string_view source) : m_source(source) {}

    std::vector<Token> read() {
        while (m_at < m_source.size())
            readOne();
        return std::move(m_tokens);
    }

private:
    bool isAt(std::string_view text) const { return m_source.substr(m_at).starts_with(text); }

    std::string_view take(std::size_t end) {
        end = std::min(end, m_source.size());
        const std::string_view taken = m_source.substr(m_at, end - m_at);
        m_line += static_cast<int>(std::ranges::count(taken, '\n'));
        m_at = end;
        return taken;
    }

    void readOne() {
        const char first = m_source[m_at];
        if (isAt("//"))
            take(m_source.find('\n', m_at));
        else if (isAt("/*"))
            take(m_source.find("*/", m_at) == std::string_view::npos
                     ? m_source.size()
                     : m_source.find("*/", m_at) + 2);
        else if (std::isspace(static_cast<unsigned char>(first)))
            take(m_at + 1);
        else if (first == '"')
            readLiteral(Token::Kind::narrow_literal);
        else if (first == '\'')
            readQuoted('\'');
        else if (std::isdigit(static_cast<unsigned char>(first)))
            readNumber();
        else if (isWordCharacter(first))
            readWord();
        else
            add(Token::Kind::sign, take(m_at + 1));
    }

    void readNumber() {
        std::size_t end = m_at;
        while (end < m_source.size() &&
               (isWordCharacter(m_source[end]) || m_source[end] == '.' || m_source[end] == '\''))
            ++end;
        add(Token::Kind::number, take(end));
    }

    void readWord() {
        std::size_t end = m_at;
        while (end < m_source.size() && isWordCharacter(m_source[end]))
            ++end;
        const std::string_view word = m_source.substr(m_at, end - m_at);
        const bool is_prefix = end < m_source.size() && m_source[end] == '"';
        if (is_prefix && word.ends_with('R'))
            return readRaw(word.size());
        if (!is_prefix)
            return add(Token::Kind::word, take(end));
        take(end);
        readLiteral(word == "L" ? Token::Kind::wide_literal : Token::Kind::narrow_literal);
    }

    void readRaw(std::size_t prefix) {
        const std::size_t open = m_source.find('(', m_at);
        const std::size_t quote = m_at + prefix;
        const std::string close =
            ")" + std::string(m_source.substr(quote + 1, open - quote - 1)) + "\"";
        const std::size_t end = m_source.find(close, open);
        take(end == std::string_view::npos ? end : end + close.size());
    }

    std::string_view readQuoted(char quote) {
        const std::size_t begin = ++m_at;
        std::size_t end = begin;
        while (end < m_source.size() && m_source[end] != quote)
            end += m_source[end] == '\\' ? 2 : 1;
        const std::string_view inside = take(end);
        take(m_at + 1);
        return inside;
    }

    void readLiteral(Token::Kind kind) {
        const int line = m_line;
        const std::string text = unescaped(readQuoted('"'));
        if (kind == Token::Kind::wide_literal && !m_tokens.empty() && m_tokens.back().kind == kind)
            m_tokens.back().text += text;
        else
            m_tokens.push_back({kind, text, line});
    }

    void add(Token::Kind kind, std::string_view text) {
        m_tokens.push_back({kind, std::string(text), m_line});
    }

    std::string_view m_source;
    std::size_t m_at = 0;
    int m_line = 1;
    std::vector<Token> m_tokens;
};

} // namespace

std::vector<Token> tokensOf(std::string_view source) {
    return Reader(source).read();
}

} // namespace locale_rules
