#include "desktop/views/PickLines.h"

#include "desktop/Texts.h"

namespace quarn::desktop {

namespace {

/// The name where it finds this very object, as a person would type it; else the id.
QString wordFor(const CQuarnDoc& document, const PickedObject& picked) {
    const CQuarnObject* const named = document.FindObjectByName(picked.name);
    const bool finds_it = named && named->Id() == picked.id;
    if (finds_it && picked.name.Find(L'"') < 0)
        return '"' + qtText(picked.name) + '"';
    return qtText(KM_UuidToString(picked.id));
}

} // namespace

QString selectLine(const CQuarnDoc& document, const std::optional<PickedObject>& picked,
                   bool adds) {
    if (!picked)
        return adds ? QString() : QString("_-Select _None");
    return (adds ? "_-Select " : "_-Select _None ") + wordFor(document, *picked);
}

KM_wString pointText(const KM_3dPoint& point) {
    return KM_wString::FormatToString(L"%.10g,%.10g,%.10g", point.x, point.y, point.z);
}

} // namespace quarn::desktop
