#pragma once

#include <array>
#include <cstdint>

namespace quarn {

/// From scene light to sRGB bytes by the leading bits of the float: 256 steps an octave, from
/// 2^-13 to 8. The bytes are kept as 32-bit numbers because vector gathers load those.
class DisplayTable {
public:
    static constexpr int shift = 15;
    static constexpr int first = (127 - 13) << (23 - shift);
    static constexpr int count = 16 << (23 - shift);
    /// Light that the first and the last entry stand for.
    static constexpr float darkest = 0x1p-13F;
    static constexpr float brightest = 0x1.FFFFFEp2F;

    DisplayTable();
    /// `count` entries; entry 0 stands for everything below the first step too.
    const std::uint32_t* entries() const { return m_entries.data(); }

private:
    std::array<std::uint32_t, count> m_entries;
};

/// The table, made once.
const DisplayTable& displayTable();

} // namespace quarn
