#pragma once

#include "kelmar/KM_Light.h"
#include "kelmar/KM_Uuid.h"

#include <cstddef>
#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace quarn {

class Document;
class ViewState;
enum class MeshEdgeChoice : int;

/// What of a document has to be the same for its file to hold all of it. States are compared rather
/// than changes counted, so that what is put back, as a curve that was hidden while an animation
/// played, is no change.
struct SavedState {
    struct View {
        std::wstring name;
        KM_UUID display_mode = KM_nil_uuid;
        int width_px = 0;
        int height_px = 0;
        friend bool operator==(const View&, const View&) = default;
    };

    std::uint64_t object_revision = 0;
    std::uint32_t object_names = 0; ///< a check sequence of all names
    std::vector<KM_UUID> hidden;    ///< objects
    std::vector<std::pair<int, KM_Light>> lights;
    bool sun_enabled = false;
    KM_3dVector direction_to_sun;
    std::map<KM_UUID, MeshEdgeChoice> edges;
    std::vector<View> views;
    std::size_t named_views = 0;
    /// A check sequence of the animation record, without what playing it changes: the current frame
    /// and the light that moves. None while no plug-in keeps a record.
    std::optional<std::uint32_t> record;

    friend bool operator==(const SavedState&, const SavedState&) = default;

    /// Takes over the size of a view's frame where it had the former one.
    void follow(const ViewState& view, int old_width_px, int old_height_px);
};

SavedState savedStateOf(const Document& document);

/// The part of the state that a plug-in keeps.
std::optional<std::uint32_t> recordStateOf(const Document& document);

} // namespace quarn
