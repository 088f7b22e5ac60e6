#include "desktop/views/PickLines.h"

#include "desktop/texts/Texts.h"

namespace quarn::desktop {

KM_wString objectWord(const CQuarnDoc& document, const PickedObject& picked) {
    const CQuarnObject* const named = document.FindObjectByName(picked.name);
    const bool finds_it = named && named->Id() == picked.id;
    return finds_it ? picked.name : KM_UuidToString(picked.id);
}

/// No word of a line can hold a double quote.
QString selectLine(const CQuarnDoc& document, const std::optional<PickedObject>& picked,
                   bool adds) {
    if (!picked)
        return adds ? QString() : QString("_-Select _None");
    const QString name = qtText(objectWord(document, *picked));
    const QString word = name.contains('"') ? qtText(KM_UuidToString(picked->id)) : name;
    return QString(adds ? "_-Select \"%1\"" : "_-Select _None \"%1\"").arg(word);
}

KM_wString pointText(const KM_3dPoint& point) {
    return KM_wString::FormatToString(L"%.10g,%.10g,%.10g", point.x, point.y, point.z);
}

} // namespace quarn::desktop
