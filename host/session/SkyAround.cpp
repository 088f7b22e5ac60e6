#include "host/session/SkyAround.h"

#include "host/document/Document.h"
#include "host/document/DocumentDrawing.h"
#include "host/document/DocumentScene.h"

namespace quarn {
namespace {

constexpr double HALF = 0.5;

bool isGlass(const Material* material) {
    if (!material)
        return false;
    const double opacity = material->base_color.a / 255.0;
    return (material->see_through && opacity < HALF) || material->transmission > HALF;
}

const DocumentObject* objectCalled(const ObjectTable& objects, const std::string& name) {
    const KM_wString wide = KM_wString::FromUtf8(name);
    if (const DocumentObject* const named = objects.findByName(wide.View()))
        return named;
    return objects.find(KM_UuidFromString(name));
}

/// A point of the world, and the object that it was taken from.
struct Found {
    KM_3dPoint point;
    KM_UUID object = KM_nil_uuid;
};

Result<Found> find(const ObjectTable& objects, const SkyPoint& place) {
    if (const KM_3dPoint* const point = std::get_if<KM_3dPoint>(&place))
        return Found{*point};
    const std::string& name = std::get<std::string>(place);
    const DocumentObject* const object = objectCalled(objects, name);
    if (!object)
        return Error{"No object is called \"" + name + "\", nor is that the id of one."};
    if (object->point)
        return Found{*object->point};
    const KM_BoundingBox box = object->boundingBox();
    if (!box.IsValid())
        return Error{"The object \"" + name + "\" has no place: it holds no point in space."};
    return Found{box.Center(), object->id};
}

} // namespace

Result<Obstruction> obstructionAround(CQuarnDoc& document, const SkyPoint& place,
                                      double north_deg) {
    Document& opened = Document::of(document);
    const auto found = find(opened.objects(), place);
    if (!found)
        return found.error();
    const auto scene = opened.drawing().scene();
    if (!scene)
        return scene.error();
    const DisplayScene& display = scene.value()->display();
    if (!display.surfaceBox().IsValid())
        return Error{"There is no visible surface that could hide the sky: draw the diagram "
                     "without a point, or of another model."};
    const std::span<const SceneMesh> meshes = scene.value()->content().meshes;
    const auto isPassed = [&](std::size_t mesh) {
        return meshes[mesh].id == found.value().object ||
               isGlass(meshes[mesh].placed.material.get());
    };
    return obstructionAround(display, SkyWatch{found.value().point, north_deg, isPassed});
}

} // namespace quarn
