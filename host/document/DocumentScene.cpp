#include "host/document/DocumentScene.h"

#include "engine/images/PictureMemory.h"
#include "host/document/DisplayPolyline.h"
#include "host/document/ObjectTable.h"
#include "import/ImportedModel.h"

#include <algorithm>

namespace quarn {

namespace {

/// How far a drawn curve may lie beside the true one, as a share of its size: less than a pixel
/// even when it fills the largest picture.
constexpr double CHORD_TOLERANCE_OF_SIZE = 5e-5;

} // namespace

/// Its revision is no document's, so that the first update compares what there is.
DocumentScene::DocumentScene(const ObjectTable& objects, std::span<const SceneMesh> added,
                             const DocumentScene* earlier) {
    takeObjects(objects);
    takeVisibility(objects, {});
    m_content.revision = 0;
    m_content.meshes.insert(m_content.meshes.end(), added.begin(), added.end());
    if (earlier)
        m_display.shareWith(earlier->m_display);
}

Result<void> DocumentScene::build(BuildProgress& progress) {
    return m_display.update(m_content, &progress);
}

Result<void> DocumentScene::update(const ObjectTable& objects, std::span<const KM_Light> lights,
                                   const LightSettings& light, std::span<const KM_UUID> hidden) {
    if (m_content.revision != objects.revision())
        takeObjects(objects);
    takeVisibility(objects, hidden);
    m_content.lights.assign(lights.begin(), lights.end());
    m_content.light = light;
    return m_display.update(m_content);
}

/// Revisions of documents rise from one; those of models fall from the largest number.
Result<void> DocumentScene::update(const ImportedModel& model, std::span<const KM_Light> lights) {
    m_content = {};
    m_content.revision = ~m_models++;
    for (const ImportedMesh& mesh : model.meshes)
        m_content.meshes.push_back({mesh.placed, KM_nil_uuid});
    for (const ImportedCurve& curve : model.curves)
        m_content.curves.push_back({KM_nil_uuid, curve.points});
    for (const KM_3dPoint& point : model.points)
        m_content.points.push_back({KM_nil_uuid, point});
    m_content.lights.assign(lights.begin(), lights.end());
    return m_display.update(m_content);
}

Result<void> DocumentScene::draw(const KM_Viewport& viewport, const DisplayModeAttributes& mode,
                                 int width_px, int height_px, Image& picture) {
    const Result<void> fits = checkPictureMemory(width_px, height_px, m_pipeline.heldPixels());
    if (!fits)
        return fits;
    return m_pipeline.draw(m_display, viewport, mode, width_px, height_px, picture);
}

void DocumentScene::takeObjects(const ObjectTable& objects) {
    m_content.meshes.clear();
    m_content.curves.clear();
    m_content.points.clear();
    m_content.revision = objects.revision();
    for (const auto& object : objects.objects()) {
        if (object->placed.mesh)
            m_content.meshes.push_back({object->placed, object->id});
        else if (object->curve)
            m_content.curves.push_back(
                {object->id, displayPolyline(*object->curve, CHORD_TOLERANCE_OF_SIZE)});
        else if (object->point)
            m_content.points.push_back({object->id, *object->point});
    }
}

void DocumentScene::takeVisibility(const ObjectTable& objects, std::span<const KM_UUID> hidden) {
    auto mesh = m_content.meshes.begin();
    auto curve = m_content.curves.begin();
    auto point = m_content.points.begin();
    for (const auto& object : objects.objects()) {
        const bool shown = object->visible && std::ranges::find(hidden, object->id) == hidden.end();
        if (object->placed.mesh)
            (mesh++)->visible = shown;
        else if (object->curve)
            (curve++)->visible = shown;
        else if (object->point)
            (point++)->visible = shown;
    }
}

} // namespace quarn
