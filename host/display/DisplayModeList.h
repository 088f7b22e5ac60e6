#pragma once

#include "sdk/qncore/QnDisplayAttributes.h"

#include <array>
#include <span>
#include <string_view>

namespace quarn {

/// The display modes of the host: Wireframe, Shaded, Rendered, Translucent, X-Ray, Drawing, Clay.
/// There is one list, because the interface promises modes that live as long as the program.
class DisplayModeList {
public:
    static DisplayModeList& instance();

    std::span<const CDisplayPipelineAttributes> modes() const { return m_modes; }
    /// The mode with this id, or null.
    const CDisplayPipelineAttributes* find(const KM_UUID& id) const;
    /// The mode with this English or local name, or null. Case is ignored, and so are the
    /// characters "_", " ", "-" and ",", which option names cannot hold; "RenderedViewport" is the
    /// rendered mode.
    const CDisplayPipelineAttributes* findByName(std::wstring_view name) const;

    /// Gives the modes their names in the language that is chosen now. The modes stay where they
    /// are.
    void localize();

private:
    DisplayModeList();

    static constexpr int mode_count = 7;
    std::array<CDisplayPipelineAttributes, mode_count> m_modes;
};

} // namespace quarn
