#include "host/app/Application.h"
#include "host/commands/CommandEnd.h"
#include "host/commands/HostCommands.h"
#include "host/commands/ObjectNaming.h"
#include "host/commands/PointPrompt.h"
#include "host/commands/WordsLeft.h"
#include "host/curves/CurveEditing.h"
#include "host/curves/EvenSpeed.h"
#include "host/document/Document.h"

#include <algorithm>

namespace quarn {

namespace {

/// Asks for one object of some kinds. @return success, and an object of them
CQuarnCommand::result askObject(const wchar_t* question, unsigned kinds, KM_UUID& id) {
    CQuarnGetObject get;
    get.SetCommandPrompt(question);
    get.SetGeometryFilter(kinds);
    get.EnablePreSelect(!hasWordsLeft(), false);
    if (get.GetObjects(1, 1) == CQuarnGet::object)
        id = get.Object(0).ObjectUuid();
    return get.CommandResult();
}

CQuarnCommand::result askPlace(KM_3dPoint& place) {
    const PointAnswer answer = PointPrompt(QnLocalizeString(L"New place", 42312)).ask();
    place = answer.point;
    return answer.kind == PointAnswer::Kind::point ? CQuarnCommand::success : answer.result;
}

CQuarnCommand::result movePointObject(ObjectTable& objects, const KM_UUID& id) {
    KM_3dPoint place;
    const CQuarnCommand::result asked = askPlace(place);
    if (asked != CQuarnCommand::success)
        return asked;
    objects.movePoint(id, place);
    Application::current()->tell(newObjectText(*objects.find(id)));
    return CQuarnCommand::success;
}

CQuarnCommand::result askIndex(const KM_Curve& curve, int& index) {
    CQuarnGetInteger get;
    get.SetCommandPrompt(QnLocalizeString(L"Number of the point, from 0", 42311));
    get.SetLowerLimit(0);
    get.SetUpperLimit(movablePointCount(curve) - 1);
    get.GetNumber();
    index = get.Number();
    return get.CommandResult();
}

CQuarnCommand::result movePointOfCurve(ObjectTable& objects, const DocumentObject& object) {
    int index = 0;
    KM_3dPoint place;
    CQuarnCommand::result asked = askIndex(*object.curve, index);
    if (asked == CQuarnCommand::success)
        asked = askPlace(place);
    if (asked != CQuarnCommand::success)
        return asked;
    CurveResult moved = withMovedPoint(*object.curve, index, place);
    if (!moved)
        return fail(moved.message());
    objects.replaceCurve(object.id, std::move(moved.value()));
    Application::current()->tell(newObjectText(object));
    return CQuarnCommand::success;
}

/// A hundred-thousandth of the curve's extent, or the document's tolerance where that is less.
double evenSpeedTolerance(const Document& document, const KM_Curve& curve) {
    return std::min(document.absoluteTolerance(), 1e-5 * curve.BoundingBox().Diagonal().Length());
}

} // namespace

CQuarnCommand::result runMovePoint(const CQuarnCommandContext& context) {
    ObjectTable& objects = Document::of(context.Document()).objects();
    KM_UUID id = KM_nil_uuid;
    const CQuarnCommand::result asked =
        askObject(QnLocalizeString(L"Curve or point to change", 42310),
                  CQuarnGetObject::curve_object | CQuarnGetObject::point_object, id);
    const DocumentObject* object = objects.find(id);
    if (asked != CQuarnCommand::success || !object)
        return asked;
    return object->curve ? movePointOfCurve(objects, *object) : movePointObject(objects, id);
}

CQuarnCommand::result runEvenSpeed(const CQuarnCommandContext& context) {
    Document& document = Document::of(context.Document());
    KM_UUID id = KM_nil_uuid;
    const CQuarnCommand::result asked =
        askObject(QnLocalizeString(L"Curve to run through at even speed", 42313),
                  CQuarnGetObject::curve_object, id);
    const DocumentObject* object = document.objects().find(id);
    if (asked != CQuarnCommand::success || !object)
        return asked;
    CurveResult even = evenSpeedCurve(*object->curve, evenSpeedTolerance(document, *object->curve));
    if (!even)
        return fail(object->name.ToUtf8() + ": " + even.message());
    document.objects().replaceCurve(id, std::move(even.value()));
    Application::current()->tell(newObjectText(*object));
    return CQuarnCommand::success;
}

} // namespace quarn
