#include "host/commands/FollowableText.h"

#include "host/commands/ObjectNaming.h"
#include "host/commands/PointText.h"
#include "host/curves/CurveEditing.h"

namespace quarn {

namespace {

KM_wString lengthText(const KM_Curve& curve, UnitSystem units) {
    double length = 0.0;
    if (!curve.GetLength(&length))
        return L", without a length";
    const KM_wString number = KM_wString::FromUtf8(shortNumber(length));
    return L", length " + number +
           (units == UnitSystem::none ? KM_wString() : KM_wString(L" ") + unitName(units));
}

KM_wString curveText(const KM_Curve& curve, UnitSystem units) {
    const int points = movablePointCount(curve);
    return curve.TypeName() + lengthText(curve, units) +
           (curve.IsClosed() ? L", closed" : L", open") +
           KM_wString::FormatToString(L", %d point%s", points, points == 1 ? L"" : L"s");
}

} // namespace

KM_wString nameOrId(const DocumentObject& object) {
    return object.name.IsEmpty() ? KM_UuidToString(object.id) : object.name;
}

KM_wString followableText(const Document& document) {
    KM_wString text;
    for (const auto& object : document.objects().objects()) {
        if (!object->curve && !object->point)
            continue;
        text += nameOrId(*object) + L"  " +
                (object->curve ? curveText(*object->curve, document.units())
                               : L"point at " + pointText(*object->point)) +
                (object->visible ? L"\n" : L", hidden\n");
    }
    return text.IsEmpty() ? KM_wString(L"There is no curve and no point.\n") : text;
}

} // namespace quarn
