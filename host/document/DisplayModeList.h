#pragma once

#include "engine/display/DisplayMode.h"
#include "sdk/qncore/QnDisplayAttributes.h"

#include <span>
#include <string_view>
#include <vector>

namespace quarn {

/// The display modes of the drawing core, as plug-ins see them, in the same order. There is one
/// list, because the interface promises modes that live as long as the program.
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

    std::vector<CDisplayPipelineAttributes>
        m_modes; ///< made once, so that they stay in their place
};

/// What the drawing core draws for attributes that a plug-in may have changed: the mode of their id
/// with their settings put over it. An id of no mode is drawn as Shaded.
DisplayModeAttributes drawingAttributes(const CDisplayPipelineAttributes& attributes);

} // namespace quarn
