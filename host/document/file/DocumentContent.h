#pragma once

#include "engine/display/DisplayMode.h"
#include "engine/scene/PlacedMesh.h"
#include "engine/scene/UnitSystem.h"
#include "host/document/RenderSettings.h"
#include "host/document/StudiedPlace.h"
#include "kelmar/KM_BinaryArchive.h"
#include "kelmar/KM_Curve.h"
#include "kelmar/KM_Light.h"
#include "kelmar/KM_Uuid.h"
#include "kelmar/KM_Viewport.h"
#include "kelmar/KM_wString.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <vector>

namespace quarn {

/// The oldest version of document files that can be written and read; the newest is
/// KM_CURRENT_ARCHIVE_VERSION.
inline constexpr int OLDEST_DOCUMENT_VERSION = 3;

/// Files of older versions hold no more of materials than their base colour.
inline constexpr int FIRST_VERSION_WITH_SURFACES = 5;

/// An object of a document file: exactly one of mesh, curve and point is there. Meshes, materials
/// and textures may be shared by several objects, in memory and in the file.
struct ObjectContent {
    KM_UUID id = KM_nil_uuid;
    KM_wString name;
    bool visible = true;
    PlacedMesh placed; ///< its mesh is null in other objects
    std::shared_ptr<const KM_Curve> curve;
    std::optional<KM_3dPoint> point;
};

/// A view of a document file.
struct ViewContent {
    KM_wString name;
    KM_Viewport viewport;
    KM_UUID display_mode = KM_nil_uuid;
    std::int32_t width_px = 0;
    std::int32_t height_px = 0;
    bool active = false;
};

/// A camera that was kept under a name.
struct CameraContent {
    KM_wString name;
    KM_Viewport viewport;
};

/// A light, with its index in the light table. The slots between hold no lights any more.
struct LightContent {
    std::int32_t index = 0;
    KM_Light light;
};

/// What belongs to the document as a whole.
struct SettingsContent {
    UnitSystem units = UnitSystem::none;
    double absolute_tolerance = 0.001; ///< in document units, above 0
    bool sun_enabled = true;
    KM_3dVector direction_to_sun{0.0, 0.0, 1.0}; ///< a unit vector
    std::int32_t light_slots = 0; ///< of the light table, those of deleted lights too
};

/// Which edges of meshes a display mode draws, where that is not the mode's own choice.
struct EdgesContent {
    KM_UUID display_mode = KM_nil_uuid;
    MeshEdgeChoice choice = MeshEdgeChoice::standard;
};

/// What a plug-in keeps in a document, as it wrote it: its version
/// (KM_BinaryArchive::Write3dmChunkVersion), then what only the plug-in understands.
struct PlugInContent {
    KM_UUID plug_in_id = KM_nil_uuid;
    std::vector<std::uint8_t> bytes;
};

/// A chunk that this program does not know.
struct UnknownContent {
    std::uint32_t id = 0;
    std::vector<std::uint8_t> payload;
};

/// All that a document file holds. A value that no open document knows of: reading makes one, and
/// only a whole one is put into a document; writing takes one of a document.
struct DocumentContent {
    int version = KM_CURRENT_ARCHIVE_VERSION;
    SettingsContent settings;
    std::vector<ObjectContent> objects;
    std::vector<ViewContent> views;
    std::vector<CameraContent> cameras;
    std::vector<EdgesContent> edges; ///< each display mode once
    /// None: those that a new document has. Without the light, which is kept beside them.
    std::optional<RenderSettings> rendering;
    std::optional<LightChoice> light; ///< none: that which a new document has
    std::optional<StudiedPlace> studied_place;
    std::vector<LightContent> lights; ///< by ascending index, each below settings.light_slots
    std::vector<PlugInContent> plug_ins;
    std::vector<UnknownContent> unknown;
    /// What materials were beyond their base colour was read and can be given to none: a program
    /// that does not know it saved the file. Not written.
    bool lost_surfaces = false;
};

} // namespace quarn
