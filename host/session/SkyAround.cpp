#include "host/session/SkyAround.h"

#include "host/document/Document.h"
#include "host/document/DocumentDrawing.h"
#include "host/document/DocumentScene.h"
#include "host/letters/SheetWords.h"

namespace quarn {
namespace {

constexpr SheetText NO_OBJECT{L"No object is called \"%1\", nor is that the id of one.", 43427};
constexpr SheetText NO_PLACE{L"The object \"%1\" has no place: it holds no point in space.", 43428};
constexpr SheetText NO_SURFACE{
    L"There is no visible surface that could hide the sky: draw the diagram "
    L"without a point, or of another model.",
    43429};

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
        return Error{SheetWords()(NO_OBJECT, {name})};
    if (object->point)
        return Found{*object->point};
    const KM_BoundingBox box = object->boundingBox();
    if (!box.IsValid())
        return Error{SheetWords()(NO_PLACE, {name})};
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
        return Error{SheetWords()(NO_SURFACE)};
    const std::span<const SceneMesh> meshes = scene.value()->content().meshes;
    SkyWatch watch{found.value().point, north_deg, {}};
    for (std::size_t mesh = 0; mesh < meshes.size(); ++mesh)
        if (meshes[mesh].id == found.value().object)
            watch.absent_mesh = mesh;
    return obstructionAround(display, watch);
}

} // namespace quarn
