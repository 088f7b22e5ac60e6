#include "host/app/Application.h"
#include "host/commands/HostCommands.h"
#include "host/commands/PointText.h"
#include "host/document/Document.h"
#include "host/prompt/NumberText.h"

#include <set>

namespace quarn {

namespace {

/// How many objects of each kind there are.
struct ObjectCounts {
    int meshes = 0;
    long long triangles = 0;
    long long vertices = 0;
    std::set<const Material*> materials;
    int curves = 0;
    int points = 0;
    int hidden = 0;

    void add(const DocumentObject& object) {
        meshes += object.mesh ? 1 : 0;
        triangles += object.mesh ? object.mesh->TriangleCount() : 0;
        vertices += object.mesh ? object.mesh->VertexCount() : 0;
        if (object.material)
            materials.insert(object.material.get());
        curves += object.curve ? 1 : 0;
        points += object.point ? 1 : 0;
        hidden += object.visible ? 0 : 1;
    }

    KM_wString text() const {
        return KM_wString::FormatToString(
            L"%d meshes with %lld triangles and %lld vertices, %d materials, %d curves, %d points; "
            L"%d hidden\n",
            meshes, triangles, vertices, static_cast<int>(materials.size()), curves, points,
            hidden);
    }
};

KM_wString sizeText(const KM_BoundingBox& box) {
    const KM_3dVector size = box.Diagonal();
    return L"from " + pointText(box.m_min) + L" to " + pointText(box.m_max) + L", size " +
           numberText(size.x) + L" x " + numberText(size.y) + L" x " + numberText(size.z) + L"\n";
}

KM_wString lineOf(const DocumentObject& object) {
    const KM_wString name = object.name.IsEmpty() ? KM_UuidToString(object.id) : object.name;
    KM_wString kind = object.kind();
    if (object.mesh)
        kind += KM_wString::FormatToString(L", %d triangles", object.mesh->TriangleCount());
    if (object.curve)
        kind = object.curve->TypeName();
    return KM_wString::FormatToString(L"%s  %s%s\n", name.Array(), kind.Array(),
                                      object.visible ? L"" : L", hidden");
}

} // namespace

CQuarnCommand::result runList(const CQuarnCommandContext& context) {
    const Document& document = Document::of(context.Document());
    Application& application = *Application::current();
    ObjectCounts counts;
    for (const auto& object : document.objects().objects()) {
        application.print(lineOf(*object).View());
        counts.add(*object);
    }
    for (const NamedView& view : document.namedViews())
        application.print((view.name + L"  named view\n").View());
    application.print(counts.text().View());
    const KM_BoundingBox box = document.objects().visibleBox();
    if (box.IsValid())
        application.print(sizeText(box).View());
    return CQuarnCommand::success;
}

} // namespace quarn
