#include "host/prompt/ObjectAnswer.h"

#include "host/document/DocumentList.h"

#include <algorithm>

namespace quarn {

namespace {

/// The objects that a question is about; null without an open document.
const ObjectTable* activeObjects() {
    const DocumentList* list = DocumentList::current();
    const Document* document = list ? list->active() : nullptr;
    return document ? &document->objects() : nullptr;
}

unsigned kindOf(const DocumentObject& object) {
    if (object.placed.mesh)
        return CQuarnGetObject::mesh_object;
    return object.curve ? CQuarnGetObject::curve_object : CQuarnGetObject::point_object;
}

bool admits(const ObjectPick& pick, const DocumentObject& object) {
    return (pick.filter & kindOf(object)) != 0;
}

bool holds(const ObjectPick& pick, const KM_UUID& id) {
    return std::ranges::find(pick.ids, id) != pick.ids.end();
}

const DocumentObject* findObject(const KM_wString& text) {
    const ObjectTable* objects = activeObjects();
    if (!objects || text.IsEmpty())
        return nullptr;
    if (const DocumentObject* named = objects->findByName(text.View()))
        return named;
    const KM_UUID id = KM_UuidFromString(text.ToUtf8());
    return KM_UuidIsNil(id) ? nullptr : objects->find(id);
}

/// "a point, a curve or a mesh", as far as the filter admits them.
KM_wString admittedKinds(unsigned filter) {
    std::vector<KM_wString> kinds;
    if (filter & CQuarnGetObject::point_object)
        kinds.emplace_back(L"a point");
    if (filter & CQuarnGetObject::curve_object)
        kinds.emplace_back(L"a curve");
    if (filter & CQuarnGetObject::mesh_object)
        kinds.emplace_back(L"a mesh");
    KM_wString text;
    for (std::size_t i = 0; i < kinds.size(); ++i)
        text += (i == 0 ? L"" : i + 1 == kinds.size() ? L" or " : L", ") + kinds[i];
    return text.IsEmpty() ? KM_wString(L"nothing") : text;
}

} // namespace

std::optional<KM_wString> takeObject(ObjectPick& pick, const KM_wString& text) {
    const DocumentObject* object = findObject(text);
    if (!object)
        return L"There is no object called \"" + text + L"\"; List shows the names";
    if (!admits(pick, *object))
        return text + L" is a " + object->kind() + L"; pick " + admittedKinds(pick.filter);
    if (!holds(pick, object->id))
        pick.ids.push_back(object->id);
    return std::nullopt;
}

bool takeSelection(ObjectPick& pick) {
    const ObjectTable* objects = activeObjects();
    if (!pick.takes_selection || !pick.ids.empty() || !objects)
        return false;
    std::vector<KM_UUID> taken;
    for (const auto& object : objects->objects()) {
        if (!object->selected)
            continue;
        if (admits(pick, *object))
            taken.push_back(object->id);
        else if (!pick.ignores_unacceptable)
            return false;
    }
    if (taken.size() < pick.minimum || (pick.maximum > 0 && taken.size() > pick.maximum))
        return false;
    pick.ids = std::move(taken);
    return true;
}

std::vector<KM_wString> objectNames(const ObjectPick& pick) {
    std::vector<KM_wString> names;
    if (const ObjectTable* objects = activeObjects())
        for (const auto& object : objects->objects())
            if (!object->name.IsEmpty() && admits(pick, *object) && !holds(pick, object->id))
                names.push_back(object->name);
    return names;
}

} // namespace quarn
