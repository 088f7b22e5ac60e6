#include "engine/display/DisplayTable.h"

#include "engine/images/ColorSpace.h"

#include <bit>

namespace quarn {

DisplayTable::DisplayTable() {
    for (int i = 0; i < count; ++i) {
        const auto lower = static_cast<std::uint32_t>(first + i) << shift;
        const float middle = std::bit_cast<float>(lower | (1U << (shift - 1)));
        m_entries[static_cast<std::size_t>(i)] = srgbByteFromLinear(toneMapped(middle));
    }
}

const DisplayTable& displayTable() {
    static const DisplayTable table;
    return table;
}

} // namespace quarn
