#include "host/document/Document.h"
#include "host/document/file/DocumentContent.h"
#include "host/document/file/FileRemainder.h"

#include <utility>

namespace quarn {

namespace {

ObjectContent contentOf(const DocumentObject& object) {
    ObjectContent content;
    content.id = object.id;
    content.name = object.name;
    content.visible = object.visible;
    content.placed = object.placed;
    if (object.curve)
        content.curve.reset(object.curve->Duplicate());
    content.point = object.point;
    return content;
}

ViewContent contentOf(const ViewState& view, bool is_active) {
    ViewContent content;
    content.name = view.name();
    content.viewport = view.viewport();
    if (view.displayMode())
        content.display_mode = view.displayMode()->Id();
    content.width_px = view.frameWidth();
    content.height_px = view.frameHeight();
    content.active = is_active;
    return content;
}

DocumentObject& add(ObjectTable& objects, const ObjectContent& content) {
    if (content.placed.mesh)
        return objects.addMesh(content.name, content.placed, content.id);
    if (content.curve)
        return objects.addCurve(content.name, std::unique_ptr<KM_Curve>(content.curve->Duplicate()),
                                content.id);
    return objects.addPoint(content.name, content.point.value_or(KM_3dPoint::Origin), content.id);
}

} // namespace

DocumentContent Document::content(bool only_selected) const {
    DocumentContent content = only_selected ? settingsContent() : contentWithoutObjects();
    content.objects.reserve(only_selected ? 0 : m_objects.objects().size());
    for (const auto& object : m_objects.objects())
        if (object->selected || !only_selected)
            content.objects.push_back(contentOf(*object));
    return content;
}

std::shared_ptr<const ObjectCopies>
Document::objectCopies(std::chrono::steady_clock::time_point end) const {
    constexpr int copies_between_looks = 64;
    if (m_object_copies && m_copied_changes == m_objects.changeCount())
        return m_object_copies;
    auto copies = std::make_shared<ObjectCopies>();
    copies->reserve(m_objects.objects().size());
    int made = 0;
    for (const auto& object : m_objects.objects()) {
        if (!object->copy) {
            if (++made % copies_between_looks == 0 && std::chrono::steady_clock::now() >= end)
                return nullptr;
            object->copy = std::make_shared<const ObjectContent>(contentOf(*object));
        }
        copies->push_back(object->copy);
    }
    m_copied_changes = m_objects.changeCount();
    m_object_copies = std::move(copies);
    return m_object_copies;
}

DocumentContent Document::settingsContent() const {
    DocumentContent content;
    content.settings.units = m_units;
    content.settings.absolute_tolerance = m_absolute_tolerance;
    content.settings.sun_enabled = m_sun.isEnabled();
    content.settings.direction_to_sun = m_sun.directionToSun();
    return content;
}

DocumentContent Document::contentWithoutObjects() const {
    DocumentContent content = settingsContent();
    for (const auto& view : m_views)
        content.views.push_back(contentOf(*view, view.get() == m_active_view));
    for (const NamedView& camera : m_named_views)
        content.cameras.push_back({camera.name, camera.viewport});
    for (const auto& [display_mode, choice] : m_edges)
        content.edges.push_back({display_mode, choice});
    RenderSettings pictures = m_render_window.settings;
    const LightChoice light = std::exchange(pictures.light, {});
    if (pictures != RenderSettings())
        content.rendering = pictures;
    if (light != LightChoice())
        content.light = light;
    content.studied_place = studiedPlace();
    content.settings.light_slots = m_lights.count();
    for (const auto& [index, slot] : m_lights.live())
        content.lights.push_back({index, slot.Light()});
    return content;
}

std::vector<std::string> Document::openContent(const DocumentContent& content) {
    m_units = content.settings.units;
    m_absolute_tolerance = content.settings.absolute_tolerance;
    m_sun.restore(content.settings.sun_enabled, content.settings.direction_to_sun);
    addObjects(content);
    addCameras(content);
    for (const EdgesContent& edges : content.edges)
        setEdgesOf(edges.display_mode, edges.choice);
    m_render_window.settings = content.rendering.value_or(RenderSettings());
    m_render_window.settings.light = content.light.value_or(LightChoice());
    m_studied_place = content.studied_place;
    for (const LightContent& light : content.lights) {
        m_lights.addDeletedUpTo(light.index);
        m_lights.add(light.light);
    }
    m_lights.addDeletedUpTo(content.settings.light_slots);
    m_file_remainder->unknown = content.unknown;
    return replaceViews(content);
}

std::map<int, int> Document::addContent(const DocumentContent& content) {
    addObjects(content);
    addCameras(content);
    std::map<int, int> indices;
    for (const LightContent& light : content.lights)
        indices[light.index] = m_lights.add(light.light);
    fitTolerance();
    return indices;
}

void Document::addObjects(const DocumentContent& content) {
    for (const ObjectContent& object : content.objects)
        add(m_objects, object).visible = object.visible;
}

void Document::addCameras(const DocumentContent& content) {
    for (const CameraContent& camera : content.cameras)
        m_named_views.push_back({camera.name, camera.viewport});
}

/// A file without views, as one of selected objects is, leaves the standard ones.
std::vector<std::string> Document::replaceViews(const DocumentContent& content) {
    std::vector<std::string> warnings;
    if (content.views.empty())
        return warnings;
    closeAllViews();
    for (const ViewContent& stored : content.views) {
        ViewState& view =
            *m_views.emplace_back(std::make_unique<ViewState>(*this, stored.name, stored.viewport));
        view.setFrameSize(stored.width_px, stored.height_px);
        view.setViewport(stored.viewport, true, true);
        if (!view.setDisplayMode(stored.display_mode)) {
            view.setDisplayMode(standardModeFor(stored.viewport));
            warnings.push_back("The view \"" + stored.name.ToUtf8() +
                               "\" has a display mode that is not known here. It is drawn in the "
                               "standard one.");
        }
        if (stored.active || !m_active_view)
            m_active_view = &view;
    }
    return warnings;
}

} // namespace quarn
