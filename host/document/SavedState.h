#pragma once

#include "host/document/RenderSettings.h"
#include "host/document/StudiedPlace.h"
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

    /// The animation that a plug-in keeps.
    struct Record {
        /// A check sequence, without what playing changes: the current frame and the light that
        /// moves.
        std::uint32_t crc = 0;
        std::wstring view;                  ///< that is animated
        KM_UUID display_mode = KM_nil_uuid; ///< that showing a frame brings into that view
        friend bool operator==(const Record&, const Record&) = default;
    };

    std::uint64_t object_revision = 0;
    std::uint32_t object_names = 0; ///< a check sequence of all names
    std::vector<KM_UUID> hidden;    ///< objects
    std::vector<std::pair<int, KM_Light>> lights;
    bool sun_enabled = false;
    KM_3dVector direction_to_sun;
    std::map<KM_UUID, MeshEdgeChoice> edges;
    RenderSettings rendering;
    std::optional<StudiedPlace> studied_place;
    std::vector<View> views;
    std::size_t named_views = 0;
    std::optional<Record> record; ///< none while no plug-in keeps one

    friend bool operator==(const SavedState&, const SavedState&) = default;

    /// Whether a document in the state `now` has nothing beyond this state. Where the animated view
    /// has the animation's display mode, because a frame was shown, that is nothing new.
    bool covers(SavedState now) const;
    /// Takes over the size of a view's frame where it had the former one.
    void follow(const ViewState& view, int old_width_px, int old_height_px);
};

SavedState savedStateOf(const Document& document);

/// The part of the state that a plug-in keeps.
std::optional<SavedState::Record> recordStateOf(const Document& document);

} // namespace quarn
