#include "engine/display/DisplayMode.h"

#include <vector>

namespace quarn {

const KM_UUID wireframe_mode_id{
    0x2B7F1D04, 0x91C3, 0x4E6A, {0xA8, 0x15, 0x3C, 0x70, 0xD9, 0x42, 0x6E, 0x01}};
const KM_UUID shaded_mode_id{
    0x5E90A3C7, 0x0D48, 0x4B1F, {0x96, 0x2E, 0x84, 0x1B, 0xF3, 0x5D, 0x27, 0x02}};
const KM_UUID rendered_mode_id{
    0x8C1465BE, 0xE27A, 0x4D93, {0xB0, 0x4F, 0x19, 0xA6, 0x72, 0xC8, 0x5B, 0x03}};

namespace {

const KM_UUID translucent_mode_id{
    0xA35DF812, 0x46B9, 0x4C05, {0x8D, 0x73, 0xE2, 0x5A, 0x0F, 0x96, 0xC1, 0x04}};
const KM_UUID x_ray_mode_id{
    0xD0927B6F, 0x3A1E, 0x4F58, {0x91, 0xC6, 0x07, 0xBD, 0x48, 0xE3, 0x7A, 0x05}};
const KM_UUID drawing_mode_id{
    0xF7486E29, 0xB50C, 0x4A7D, {0x85, 0x3B, 0xD4, 0x61, 0x9C, 0x0E, 0xA8, 0x06}};
const KM_UUID clay_mode_id{
    0x19C3E05A, 0x7F84, 0x4236, {0xBC, 0x98, 0x5E, 0x2D, 0xA1, 0x76, 0x43, 0x07}};

constexpr KM_Color white{255, 255, 255, 255};

DisplayModeAttributes mode(const KM_UUID& id, const wchar_t* name, SurfaceStyle style) {
    DisplayModeAttributes attributes;
    attributes.id = id;
    attributes.english_name = name;
    attributes.surface_style = style;
    return attributes;
}

DisplayModeAttributes wireframe() {
    auto attributes = mode(wireframe_mode_id, L"Wireframe", SurfaceStyle::none);
    attributes.kind = DisplayKind::wireframe;
    attributes.background_top = {240, 241, 243, 255};
    attributes.background_bottom = {240, 241, 243, 255};
    attributes.draws_edges = true;
    attributes.draws_outlines = true;
    attributes.shows_hidden_lines = true;
    attributes.edge_width_px = 1.0F;
    attributes.outline_width_px = 1.3F;
    attributes.edge_strength = 0.85F;
    attributes.edge_color = {24, 28, 36, 255};
    attributes.far_strength = 0.50F;
    attributes.crowded_strength = 1.0F;
    return attributes;
}

/// A backdrop and a ground that white and black models stand out from.
DisplayModeAttributes shaded() {
    auto attributes = mode(shaded_mode_id, L"Shaded", SurfaceStyle::studio);
    attributes.has_ground_plane = true;
    attributes.background_top = {170, 174, 180, 255};
    attributes.background_bottom = {148, 150, 153, 255};
    return attributes;
}

DisplayModeAttributes underDocumentLights(DisplayModeAttributes attributes) {
    attributes.uses_document_lights = true;
    attributes.casts_shadows = true;
    attributes.has_ground_plane = true;
    return attributes;
}

DisplayModeAttributes rendered() {
    auto attributes = underDocumentLights(mode(rendered_mode_id, L"Rendered", SurfaceStyle::lit));
    attributes.has_sky = true;
    return attributes;
}

DisplayModeAttributes translucent() {
    return mode(translucent_mode_id, L"Translucent", SurfaceStyle::translucent);
}

DisplayModeAttributes xRay() {
    auto attributes = mode(x_ray_mode_id, L"X-Ray", SurfaceStyle::x_ray);
    attributes.draws_edges = true;
    attributes.draws_outlines = true;
    attributes.shows_hidden_lines = true;
    attributes.edge_color = {24, 44, 78, 255};
    attributes.edge_strength = 0.85F;
    attributes.covered_strength = 0.55F;
    attributes.crowded_strength = 1.0F;
    return attributes;
}

DisplayModeAttributes drawing() {
    auto attributes = mode(drawing_mode_id, L"Drawing", SurfaceStyle::paper);
    attributes.background_top = white;
    attributes.background_bottom = white;
    attributes.draws_edges = true;
    attributes.draws_outlines = true;
    attributes.edge_color = {20, 20, 24, 255};
    attributes.edge_width_px = 0.9F;
    attributes.outline_width_px = 2.1F;
    attributes.edge_strength = 0.85F;
    return attributes;
}

DisplayModeAttributes clay() {
    return underDocumentLights(mode(clay_mode_id, L"Clay", SurfaceStyle::clay));
}

} // namespace

bool showsMaterials(SurfaceStyle style) {
    return style == SurfaceStyle::lit || style == SurfaceStyle::studio;
}

DisplayModeAttributes withEdges(DisplayModeAttributes mode, MeshEdgeChoice choice) {
    if (choice == MeshEdgeChoice::standard)
        return mode;
    mode.draws_edges = choice != MeshEdgeChoice::none;
    mode.draws_all_edges = choice == MeshEdgeChoice::all;
    mode.draws_outlines = mode.draws_outlines || mode.draws_edges;
    return mode;
}

std::span<const DisplayModeAttributes> standardDisplayModes() {
    static const std::vector<DisplayModeAttributes> modes{
        wireframe(), shaded(), rendered(), translucent(), xRay(), drawing(), clay()};
    return modes;
}

const DisplayModeAttributes* findDisplayMode(const KM_UUID& id) {
    for (const auto& candidate : standardDisplayModes())
        if (candidate.id == id)
            return &candidate;
    return nullptr;
}

} // namespace quarn
