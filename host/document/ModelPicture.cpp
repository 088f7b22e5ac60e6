#include "host/document/ModelPicture.h"

#include "host/document/DocumentScene.h"
#include "host/document/DocumentSun.h"
#include "host/document/Reach.h"
#include "host/document/StandardViews.h"
#include "import/ImportedModel.h"

namespace quarn {

namespace {

void addPoints(const ImportedModel& model, Reach& reach) {
    for (const ImportedMesh& mesh : model.meshes)
        for (const KM_3fPoint& vertex : mesh.placed.mesh->m_V)
            reach.add(mesh.placed.world_from_mesh * vertex.ToDouble());
    for (const ImportedCurve& curve : model.curves)
        for (const KM_3dPoint& point : curve.points)
            reach.add(point);
    for (const KM_3dPoint& point : model.points)
        reach.add(point);
}

/// A camera before a model that fills its picture.
KM_Viewport cameraBefore(const ImportedModel& model, const KM_BoundingBox& box, int width_px,
                         int height_px) {
    const KM_3dPoint target = box.Center();
    const double size = box.Diagonal().Length();
    const double clearance = size > 0.0 ? size / 100.0 : 1.0; // a single point has no size
    const auto standing_back = [&](double distance) {
        return standardViewport(standardViews().back(), target, distance, width_px, height_px);
    };
    Reach reach(standing_back(clearance), target);
    addPoints(model, reach);
    return standing_back(reach.distance(clearance));
}

} // namespace

Result<void> drawModel(const ImportedModel& model, DocumentScene& scene, int width_px,
                       int height_px, Image& picture) {
    const std::optional<KM_Light> sun = DocumentSun().light();
    const Result<void> updated = scene.update(model, std::span(&*sun, 1));
    if (!updated)
        return updated;
    const Error too_far{"The model is too far from the origin to be drawn."};
    const KM_BoundingBox& box = scene.display().boundingBox();
    if (!box.IsValid())
        return too_far;
    const KM_Viewport camera = cameraBefore(model, box, width_px, height_px);
    if (!scene.display().canBeSeenBy(camera, width_px, height_px))
        return too_far;
    DisplayModeAttributes mode = *findDisplayMode(rendered_mode_id);
    mode.antialiasing_level = static_cast<int>(AntialiasingLevel::capture);
    return scene.draw(camera, mode, width_px, height_px, picture);
}

} // namespace quarn
