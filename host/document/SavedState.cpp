#include "host/document/SavedState.h"

#include "host/border/Border.h"
#include "host/document/Document.h"
#include "kelmar/KM_BinaryArchive.h"
#include "kelmar/KM_Crc32.h"
#include "sdk/qncore/QnZoetrixDynamicAccess.h"

namespace quarn {

namespace {

/// Two names in a row are another thing than one of both.
std::uint32_t crcWith(const KM_wString& name, std::uint32_t before) {
    const std::string text = name.ToUtf8();
    const auto* bytes = reinterpret_cast<const std::uint8_t*>(text.c_str());
    return KM_Crc32({bytes, text.size() + 1}, before);
}

void addObjects(SavedState& state, const ObjectTable& table) {
    state.object_revision = table.revision();
    for (const auto& object : table.objects()) {
        state.object_names = crcWith(object->name, state.object_names);
        if (!object->visible)
            state.hidden.push_back(object->id);
    }
}

SavedState::View stateOf(const ViewState& view) {
    const CDisplayPipelineAttributes* mode = view.displayMode();
    return {std::wstring(view.name().View()), mode ? mode->Id() : KM_nil_uuid, view.frameWidth(),
            view.frameHeight()};
}

SavedState::Record stateOf(const KM_3dmAnimationProperties& record) {
    KM_3dmAnimationProperties lasting(record);
    lasting.SetCurrentFrame(0);
    lasting.SetLightIndex(-1);
    KM_BinaryArchive archive = KM_BinaryArchive::ForWriting();
    lasting.Write(archive);
    return {KM_Crc32(archive.Bytes()), std::wstring(record.ViewportName().View()),
            record.DisplayMode()};
}

} // namespace

bool SavedState::covers(SavedState now) const {
    if (now.record && now.views.size() == views.size()) {
        for (std::size_t i = 0; i < views.size(); ++i) {
            View& view = now.views[i];
            if (view.name == now.record->view && view.display_mode == now.record->display_mode)
                view.display_mode = views[i].display_mode;
        }
    }
    return now == *this;
}

void SavedState::follow(const ViewState& view, int old_width_px, int old_height_px) {
    for (View& each : views) {
        if (each.name != view.name().View() || each.width_px != old_width_px ||
            each.height_px != old_height_px)
            continue;
        each.width_px = view.frameWidth();
        each.height_px = view.frameHeight();
    }
}

SavedState savedStateOf(const Document& document) {
    SavedState state;
    addObjects(state, document.objects());
    for (const auto& [index, slot] : document.lights().live())
        state.lights.emplace_back(index, slot.Light());
    state.sun_enabled = document.sun().isEnabled();
    state.direction_to_sun = document.sun().directionToSun();
    state.edges = document.edges();
    state.rendering = document.renderWindow().settings;
    state.studied_place = document.studiedPlace();
    for (const auto& view : document.views())
        state.views.push_back(stateOf(*view));
    state.named_views = document.namedViews().size();
    state.record = recordStateOf(document);
    return state;
}

std::optional<SavedState::Record> recordStateOf(const Document& document) {
    const IQnZoetrixDynamicAccess* access = Zoetrix_QuarnDynamicAccess();
    if (!access)
        return std::nullopt;
    const auto state = acrossBorder([&]() -> SavedState::Record {
        return stateOf(access->AnimationProperties(document.face()));
    });
    return state ? std::optional(state.value()) : std::nullopt;
}

} // namespace quarn
