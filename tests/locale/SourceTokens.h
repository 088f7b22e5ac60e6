#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace locale_rules {

/// A piece of C++ source.
struct Token {
    enum class Kind { wide_literal, narrow_literal, number, word, sign };
    Kind kind = Kind::sign;
    std::string text; ///< of a literal: what it stands for, in UTF-8
    int line = 0;     ///< from 1
};

/// Splits a source; comments are left out and neighbouring wide literals are one.
std::vector<Token> tokensOf(std::string_view source);

} // namespace locale_rules
