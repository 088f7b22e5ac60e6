#include "tests/model_mutants/Mutator.h"

#include <algorithm>
#include <array>
#include <cctype>

namespace quarn::test {

namespace {

/// Larger ones leave little to be read.
std::size_t longestPiece(std::string_view bytes) {
    return std::min<std::size_t>(4096, 4 + bytes.size() / 16);
}

} // namespace

std::string Mutator::damaged(std::string_view bytes, std::string_view other) {
    std::string result(bytes);
    for (std::size_t left = 1 + below(2) * below(3); left > 0; --left)
        damageOnce(result, other);
    return result;
}

/// The remainder keeps the choice the same with every C++ library.
std::size_t Mutator::below(std::size_t count) {
    return count == 0 ? 0 : static_cast<std::size_t>(m_random() % count);
}

void Mutator::damageOnce(std::string& bytes, std::string_view other) {
    switch (below(8)) {
    case 0:
    case 1:
        return flipBits(bytes);
    case 2:
        return cut(bytes);
    case 3:
        return splice(bytes, other);
    case 4:
        return removePiece(bytes);
    case 5:
        return repeatPiece(bytes);
    case 6:
        return placeHugeNumber(bytes);
    default:
        return replaceDigits(bytes);
    }
}

void Mutator::flipBits(std::string& bytes) {
    for (std::size_t left = bytes.empty() ? 0 : 1 + below(8); left > 0; --left)
        bytes[below(bytes.size())] ^= static_cast<char>(1U << below(8));
}

void Mutator::cut(std::string& bytes) {
    bytes.resize(below(bytes.size()));
}

void Mutator::splice(std::string& bytes, std::string_view other) {
    const std::size_t from = below(other.size());
    const std::string_view piece = other.substr(from, 1 + below(longestPiece(bytes)));
    const std::size_t at = below(bytes.size());
    bytes.replace(at, std::min(piece.size(), bytes.size() - at), piece);
}

void Mutator::removePiece(std::string& bytes) {
    bytes.erase(below(bytes.size()), 1 + below(longestPiece(bytes)));
}

void Mutator::repeatPiece(std::string& bytes) {
    const std::string piece = bytes.substr(below(bytes.size()), 1 + below(longestPiece(bytes)));
    bytes.insert(below(bytes.size()), piece);
}

/// Binary counts, of four bytes in either order.
void Mutator::placeHugeNumber(std::string& bytes) {
    constexpr std::array<std::string_view, 6> NUMBERS = {
        std::string_view("\xff\xff\xff\xff", 4), std::string_view("\xff\xff\xff\x7f", 4),
        std::string_view("\x7f\xff\xff\xff", 4), std::string_view("\x00\x00\x00\x80", 4),
        std::string_view("\x00\x00\x00\x10", 4), std::string_view("\x00\x00\x80\x7f", 4)};
    const std::string_view number = NUMBERS[below(NUMBERS.size())];
    if (bytes.size() >= number.size())
        bytes.replace(below(bytes.size() - number.size() + 1), number.size(), number);
}

/// A number of a text becomes one that nobody expects.
void Mutator::replaceDigits(std::string& bytes) {
    constexpr std::array<std::string_view, 9> NUMBERS = {
        "4294967295", "2147483647",          "-1", "1e308", "nan", "1e-320", "9223372036854775807",
        "0",          "99999999999999999999"};
    const auto is_digit = [](char c) { return std::isdigit(static_cast<unsigned char>(c)) != 0; };
    const auto start = bytes.begin() + static_cast<std::ptrdiff_t>(below(bytes.size()));
    const auto first = std::find_if(start, bytes.end(), is_digit);
    const auto last = std::find_if_not(first, bytes.end(), is_digit);
    if (first != last)
        bytes.replace(first, last, NUMBERS[below(NUMBERS.size())]);
}

} // namespace quarn::test
