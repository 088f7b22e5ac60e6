#include "host/app/Application.h"
#include "host/commands/AnimationText.h"
#include "host/commands/FollowableText.h"
#include "host/commands/HostCommands.h"
#include "host/commands/PointText.h"
#include "host/commands/SunText.h"
#include "host/commands/WordsLeft.h"
#include "host/document/Document.h"
#include "host/prompt/NumberText.h"
#include "sdk/qncore/QnGet.h"

#include <set>

namespace quarn {

namespace {

/// "1 mesh", "3 meshes".
KM_wString counted(long long count, const wchar_t* one, const wchar_t* several) {
    return KM_wString::FormatToString(L"%lld %s", count, count == 1 ? one : several);
}

/// How many objects of each kind there are.
struct ObjectCounts {
    int meshes = 0;
    long long triangles = 0;
    long long vertices = 0;
    std::set<const Material*> materials;
    int curves = 0;
    int points = 0;
    int hidden = 0;
    int selected = 0;

    void add(const DocumentObject& object) {
        meshes += object.placed.mesh ? 1 : 0;
        triangles += object.placed.mesh ? object.placed.mesh->TriangleCount() : 0;
        vertices += object.placed.mesh ? object.placed.mesh->VertexCount() : 0;
        if (object.placed.material)
            materials.insert(object.placed.material.get());
        curves += object.curve ? 1 : 0;
        points += object.point ? 1 : 0;
        hidden += object.visible ? 0 : 1;
        selected += object.selected ? 1 : 0;
    }

    KM_wString text() const {
        const KM_wString parts =
            counted(meshes, L"mesh", L"meshes") + L" with " +
            counted(triangles, L"triangle", L"triangles") + L" and " +
            counted(vertices, L"vertex", L"vertices") + L", " +
            counted(static_cast<long long>(materials.size()), L"material", L"materials") + L", " +
            counted(curves, L"curve", L"curves") + L", " + counted(points, L"point", L"points");
        return parts + KM_wString::FormatToString(L"; %d hidden, %d selected\n", hidden, selected);
    }
};

KM_wString sizeText(const KM_BoundingBox& box, UnitSystem units) {
    const KM_3dVector size = box.Diagonal();
    return L"from " + pointText(box.m_min) + L" to " + pointText(box.m_max) + L", size " +
           numberText(size.x) + L" x " + numberText(size.y) + L" x " + numberText(size.z) +
           (units == UnitSystem::none ? L"\n" : KM_wString(L" ") + unitName(units) + L"\n");
}

KM_wString lineOf(const DocumentObject& object, bool with_id) {
    const KM_wString id = KM_UuidToString(object.id);
    KM_wString line = nameOrId(object) + L"  ";
    line += object.curve ? object.curve->TypeName() : object.kind();
    if (object.placed.mesh)
        line += L", " + counted(object.placed.mesh->TriangleCount(), L"triangle", L"triangles");
    line += object.visible ? L"" : L", hidden";
    line += object.selected ? L", selected" : L"";
    return line + (with_id && !object.name.IsEmpty() ? L"  " + id : KM_wString()) + L"\n";
}

KM_wString lineOf(const ViewState& view, bool is_active) {
    const CDisplayPipelineAttributes* mode = view.displayMode();
    return view.name() + L"  view, " + (mode ? mode->LocalName() + L", " : KM_wString()) +
           KM_wString::FormatToString(L"%d x %d%s\n", view.frameWidth(), view.frameHeight(),
                                      is_active ? L", active" : L"");
}

const wchar_t* styleText(KM_LightStyle style) {
    switch (style) {
    case KM_LightStyle::camera_directional:
    case KM_LightStyle::world_directional:
        return L"directional";
    case KM_LightStyle::camera_point:
    case KM_LightStyle::world_point:
        return L"point";
    case KM_LightStyle::camera_spot:
    case KM_LightStyle::world_spot:
        return L"spot";
    case KM_LightStyle::ambient:
        return L"ambient";
    case KM_LightStyle::unknown:
        break;
    }
    return L"unknown";
}

KM_wString lineOf(const KM_Light& light, int index) {
    const KM_wString name = light.LightName().IsEmpty() ? KM_wString() : light.LightName() + L"  ";
    return name + KM_wString::FormatToString(L"light %d, %s%s\n", index, styleText(light.Style()),
                                             light.IsEnabled() ? L"" : L", off");
}

/// What to list; a line without words means everything but the ids.
struct ListWish {
    bool ids = false;
    bool objects_only = false;
    bool curves_only = false;
};

CQuarnCommand::result askWish(ListWish& wish) {
    if (!hasWordsLeft())
        return CQuarnCommand::success;
    CQuarnGetOption get;
    get.SetCommandPrompt(QnLocalizeString(L"What to list", 42106));
    const int objects = get.AddCommandOption(QnLocalizeCommandOptionName(L"Objects", 42104));
    const int ids = get.AddCommandOption(QnLocalizeCommandOptionName(L"Ids", 42105));
    const int curves = get.AddCommandOption(QnLocalizeCommandOptionName(L"Curves", 42106));
    const CQuarnGet::result answer = get.GetOption();
    if (answer == CQuarnGet::string)
        return CQuarnCommand::failure;
    if (answer != CQuarnGet::option)
        return get.CommandResult();
    const int picked = get.Option()->m_option_index;
    wish.objects_only = picked == objects;
    wish.ids = picked == ids;
    wish.curves_only = picked == curves;
    return CQuarnCommand::success;
}

ObjectCounts listObjects(Application& application, const Document& document, bool with_ids) {
    ObjectCounts counts;
    for (const auto& object : document.objects().objects()) {
        application.print(lineOf(*object, with_ids).View());
        counts.add(*object);
    }
    for (const NamedView& view : document.namedViews())
        application.print((view.name + L"  named view\n").View());
    return counts;
}

void listViewsAndLights(Application& application, Document& document) {
    for (const auto& view : document.views())
        application.print(lineOf(*view, view.get() == &document.activeView()).View());
    for (const auto& [index, light] : document.lights().live())
        application.print(lineOf(light.Light(), index).View());
    application.print(sunText(document.sun()).View());
}

} // namespace

CQuarnCommand::result runList(const CQuarnCommandContext& context) {
    ListWish wish;
    const CQuarnCommand::result asked = askWish(wish);
    if (asked != CQuarnCommand::success)
        return asked;
    Document& document = Document::of(context.Document());
    Application& application = *Application::current();
    if (wish.curves_only) {
        application.print(followableText(document).View());
        return CQuarnCommand::success;
    }
    const ObjectCounts counts = listObjects(application, document, wish.ids);
    if (!wish.objects_only)
        listViewsAndLights(application, document);
    application.print(counts.text().View());
    const KM_BoundingBox box = document.objects().visibleBox();
    if (box.IsValid())
        application.print(sizeText(box, document.units()).View());
    if (const KM_wString animation = animationText(document); !animation.IsEmpty())
        application.print((L"animation: " + animation + L"\n").View());
    return CQuarnCommand::success;
}

} // namespace quarn
