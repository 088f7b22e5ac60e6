#pragma once

#include <array>
#include <cstdint>

namespace quarn {

/// Scene light by the light that it is shown as, in equal steps from 0 to 1: the tone curve the
/// other way about. The floats are kept as their bits because vector gathers load those.
class ShownLight {
public:
    static constexpr int steps = 4096;

    ShownLight();
    /// `steps` + 1 entries.
    const std::uint32_t* entries() const { return m_entries.data(); }

private:
    std::array<std::uint32_t, steps + 1> m_entries;
};

/// The table, made once.
const ShownLight& shownLight();

} // namespace quarn
