#include "host/document/ObjectTable.h"

#include <algorithm>

namespace quarn {

namespace {

KM_wString lowerCase(std::wstring_view text) {
    KM_wString lower(text);
    lower.MakeLower();
    return lower;
}

} // namespace

DocumentObject& ObjectTable::addMesh(const KM_wString& name, PlacedMesh placed, const KM_UUID& id) {
    DocumentObject& object = add(name, id);
    object.placed = std::move(placed);
    return object;
}

DocumentObject& ObjectTable::addCurve(const KM_wString& name, std::unique_ptr<KM_Curve> curve,
                                      const KM_UUID& id) {
    DocumentObject& object = add(name, id);
    object.curve = std::move(curve);
    return object;
}

DocumentObject& ObjectTable::addPoint(const KM_wString& name, const KM_3dPoint& point,
                                      const KM_UUID& id) {
    DocumentObject& object = add(name, id);
    object.point = point;
    return object;
}

DocumentObject& ObjectTable::add(const KM_wString& name, const KM_UUID& id) {
    DocumentObject& object = *m_objects.emplace_back(std::make_unique<DocumentObject>());
    object.id = KM_UuidIsNil(id) || find(id) ? KM_CreateUuid() : id;
    object.name = freeName(name);
    m_by_id[object.id] = &object;
    if (!object.name.IsEmpty())
        m_by_name[lowerCase(object.name.View())] = &object;
    ++m_revision;
    return object;
}

KM_wString ObjectTable::freeName(const KM_wString& wish) {
    if (wish.IsEmpty() || !findByName(wish.View()))
        return wish;
    // The number that was given last is kept, so that a thousand equal names stay quick.
    int& number = m_last_number.try_emplace(lowerCase(wish.View()), 1).first->second;
    KM_wString numbered;
    do {
        numbered = wish + KM_wString::FormatToString(L" %d", ++number);
    } while (findByName(numbered.View()));
    return numbered;
}

bool ObjectTable::remove(const KM_UUID& id) {
    return remove(std::span(&id, 1)) == 1;
}

std::size_t ObjectTable::remove(std::span<const KM_UUID> ids) {
    const auto removed = [&](const auto& object) { return !m_by_id.contains(object->id); };
    for (const KM_UUID& id : ids) {
        if (const DocumentObject* object = find(id); object && !object->name.IsEmpty())
            m_by_name.erase(lowerCase(object->name.View()));
        m_by_id.erase(id);
    }
    const std::size_t count = std::erase_if(m_objects, removed);
    m_revision += count > 0 ? 1 : 0;
    return count;
}

bool ObjectTable::rename(const KM_UUID& id, const KM_wString& name) {
    DocumentObject* object = find(id);
    const DocumentObject* owner = name.IsEmpty() ? nullptr : findByName(name.View());
    if (!object || (owner && owner != object))
        return false;
    if (!object->name.IsEmpty())
        m_by_name.erase(lowerCase(object->name.View()));
    object->name = name;
    if (!name.IsEmpty())
        m_by_name[lowerCase(name.View())] = object;
    noteChange(*object, m_small_changes);
    return true;
}

bool ObjectTable::replaceCurve(const KM_UUID& id, std::unique_ptr<KM_Curve> curve) {
    DocumentObject* object = find(id);
    if (!object || !object->curve || !curve)
        return false;
    object->curve = std::move(curve);
    noteChange(*object, m_revision);
    return true;
}

bool ObjectTable::movePoint(const KM_UUID& id, const KM_3dPoint& point) {
    DocumentObject* object = find(id);
    if (!object || !object->point)
        return false;
    object->point = point;
    noteChange(*object, m_revision);
    return true;
}

void ObjectTable::noteChange(DocumentObject& object, std::uint64_t& count) {
    object.copy.reset();
    ++count;
}

DocumentObject* ObjectTable::find(const KM_UUID& id) const {
    const auto found = m_by_id.find(id);
    return found == m_by_id.end() ? nullptr : found->second;
}

DocumentObject* ObjectTable::findByName(std::wstring_view name) const {
    const auto found = m_by_name.find(lowerCase(name));
    return found == m_by_name.end() ? nullptr : found->second;
}

bool ObjectTable::setVisible(const KM_UUID& id, bool visible) {
    DocumentObject* object = find(id);
    if (!object || object->visible == visible)
        return false;
    object->visible = visible;
    noteChange(*object, m_small_changes);
    return true;
}

bool ObjectTable::select(const KM_UUID& id, bool selected) {
    DocumentObject* object = find(id);
    if (object)
        object->selected = selected;
    return object != nullptr;
}

void ObjectTable::selectAll() {
    for (const auto& object : m_objects)
        object->selected = object->selected || object->visible;
}

void ObjectTable::selectNone() {
    for (const auto& object : m_objects)
        object->selected = false;
}

int ObjectTable::selectedCount() const {
    return static_cast<int>(
        std::ranges::count_if(m_objects, [](const auto& object) { return object->selected; }));
}

KM_BoundingBox ObjectTable::visibleBox() const {
    KM_BoundingBox box;
    for (const auto& object : m_objects)
        if (object->visible)
            box.Union(object->boundingBox());
    return box;
}

} // namespace quarn
