#include "engine/display/ShownLight.h"

#include "engine/images/ColorSpace.h"

#include <bit>

namespace quarn {

ShownLight::ShownLight() {
    for (int i = 0; i <= steps; ++i) {
        const float shown = static_cast<float>(i) / static_cast<float>(steps);
        m_entries[static_cast<std::size_t>(i)] =
            std::bit_cast<std::uint32_t>(sceneLightShownAs(shown));
    }
}

const ShownLight& shownLight() {
    static const ShownLight table;
    return table;
}

} // namespace quarn
