#pragma once

#include <cstdint>
#include <random>
#include <string>
#include <string_view>

namespace quarn::test {

/// Damages the bytes of files as the world does: bits flip, ends are cut off, pieces of another
/// file get in, counts become huge. The same seed damages in the same way everywhere.
class Mutator {
public:
    explicit Mutator(std::uint64_t seed) : m_random(seed) {}

    /// @param other  another file, from which pieces may come; may be the same
    /// @return the bytes with one to three kinds of damage
    std::string damaged(std::string_view bytes, std::string_view other);

private:
    std::size_t below(std::size_t count); ///< 0 where count is 0
    void damageOnce(std::string& bytes, std::string_view other);
    void flipBits(std::string& bytes);
    void cut(std::string& bytes);
    void splice(std::string& bytes, std::string_view other);
    void removePiece(std::string& bytes);
    void repeatPiece(std::string& bytes);
    void placeHugeNumber(std::string& bytes);
    void replaceDigits(std::string& bytes);

    std::mt19937_64 m_random;
};

} // namespace quarn::test
