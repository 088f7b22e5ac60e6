#include "host/document/Document.h"

#include "host/display/DisplayMode.h"
#include "host/document/DocumentList.h"
#include "host/document/DocumentScene.h"
#include "host/document/SceneChanges.h"
#include "host/document/StandardViews.h"
#include "host/front_end/FrontEnd.h"
#include "host/import/ModelFile.h"
#include "kelmar/KM_PolylineCurve.h"
#include "sdk/qncore/QnLocalize.h"

#include <algorithm>

namespace quarn {

namespace {

/// How far the cameras of a new document stand from the origin, in model units.
constexpr double START_DISTANCE = 80.0;

/// The share of the model's size below which two points count as one.
constexpr double TOLERANCE_OF_SIZE = 1e-6;

} // namespace

Document::Document(DocumentList& list, unsigned int serial_number)
    : m_list(list), m_serial_number(serial_number), m_properties(*this), m_face(*this) {
    addStandardViews();
}

Document::~Document() = default;

Document& Document::of(const CQuarnDoc& document) {
    return *document.m_document;
}

FrontEnd& Document::frontEnd() const {
    return m_list.frontEnd();
}

void Document::addStandardViews() {
    for (const StandardView& standard : standardViews()) {
        const KM_Viewport viewport =
            standardViewport(standard, KM_3dPoint::Origin, START_DISTANCE,
                             ViewState::default_width_px, ViewState::default_height_px);
        m_views.push_back(std::make_unique<ViewState>(*this, standard.name, viewport));
        m_active_view = m_views.back().get();
        m_active_view->setDisplayMode(viewport.IsPerspectiveProjection() ? shaded_mode_id
                                                                         : wireframe_mode_id);
    }
}

ViewState* Document::findView(std::wstring_view name) const {
    const KM_wString wanted(name);
    const auto found = std::find_if(m_views.begin(), m_views.end(), [&](const auto& view) {
        return view->name().CompareNoCase(wanted) == 0;
    });
    return found == m_views.end() ? nullptr : found->get();
}

bool Document::activateView(std::wstring_view name) {
    ViewState* view = findView(name);
    if (view)
        m_active_view = view;
    return view != nullptr;
}

void Document::addModel(const ImportedModel& model) {
    for (const ImportedMesh& mesh : model.meshes)
        m_objects.addMesh(mesh.name, mesh.mesh, mesh.material);
    for (const ImportedCurve& curve : model.curves)
        m_objects.addCurve(curve.name, std::make_unique<KM_PolylineCurve>(
                                           std::span(curve.points.Array(), curve.points.Count())));
    for (const KM_3dPoint& point : model.points)
        m_objects.addPoint(KM_wString(), point);
    for (const ImportedCamera& camera : model.cameras)
        m_named_views.push_back({camera.name, camera.viewport});
    fitTolerance();
}

void Document::fitTolerance() {
    KM_BoundingBox box;
    for (const auto& object : m_objects.objects())
        box.Union(object->boundingBox());
    const double size = box.Diagonal().Length();
    if (size > 0.0)
        m_absolute_tolerance = std::min(m_absolute_tolerance, TOLERANCE_OF_SIZE * size);
}

std::vector<KM_Light> Document::shiningLights() const {
    std::vector<KM_Light> lights = m_lights.shiningLights();
    if (const auto sun = m_sun.light())
        lights.insert(lights.begin(), *sun);
    return lights;
}

std::vector<KM_Light> Document::shiningLights(const SceneChanges& changes) const {
    if (!changes.sun)
        return shiningLights();
    std::vector<KM_Light> lights = m_lights.shiningLights(changes.sun->replaced_light);
    if (LightStore::canShine(changes.sun->light))
        lights.push_back(changes.sun->light);
    return lights;
}

Result<void> Document::draw(const KM_Viewport& viewport, const DisplayModeAttributes& mode,
                            int width_px, int height_px, Image& picture) {
    return draw(viewport, mode, width_px, height_px, picture, SceneChanges());
}

Result<void> Document::draw(const KM_Viewport& viewport, const DisplayModeAttributes& mode,
                            int width_px, int height_px, Image& picture,
                            const SceneChanges& changes) {
    if (!m_scene)
        m_scene = std::make_unique<DocumentScene>();
    const auto updated = m_scene->update(m_objects, shiningLights(changes), changes.hidden);
    if (!updated)
        return updated;
    return m_scene->draw(viewport, mode, width_px, height_px, picture);
}

void Document::regenerate() {
    if (!m_scene)
        return;
    if (const auto updated = m_scene->update(m_objects, shiningLights()); !updated)
        frontEnd().print(KM_wString::FromUtf8(updated.message() + "\n").View());
}

} // namespace quarn
