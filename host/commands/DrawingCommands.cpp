#include "host/app/Application.h"
#include "host/commands/HostCommands.h"
#include "host/commands/ObjectNaming.h"
#include "host/commands/PointPrompt.h"
#include "host/commands/ReplacedObject.h"
#include "host/commands/WordsLeft.h"
#include "host/document/Document.h"

namespace quarn {

namespace {

/// A circle by centre and radius, around the vertical unless another axis is given.
class CircleQuestion {
public:
    explicit CircleQuestion(ObjectTable& objects)
        : m_prompt(objects, QnLocalizeString(L"Centre of the circle", 42306)) {
        m_axis = m_prompt.points().addOption(QnLocalizeCommandOptionName(L"Normal", 42304));
    }

    CQuarnCommand::result run() {
        PointAnswer centre = m_prompt.ask();
        while (centre.kind == PointAnswer::Kind::option) {
            const CQuarnCommand::result asked = askNormal();
            if (asked != CQuarnCommand::success)
                return asked;
            centre = m_prompt.ask();
        }
        return centre.kind == PointAnswer::Kind::point ? askRadius(centre.point) : centre.result;
    }

private:
    CQuarnCommand::result askNormal() {
        PointPrompt prompt(QnLocalizeString(L"Direction of the axis", 42307));
        for (;;) {
            const PointAnswer answer = prompt.ask();
            if (answer.kind != PointAnswer::Kind::point)
                return answer.result;
            m_normal = answer.point - KM_3dPoint::Origin;
            if (makeCircle(KM_3dPoint::Origin, m_normal, 1.0))
                return CQuarnCommand::success;
            if (!prompt.refuse("The axis of a circle needs a direction, such as 0,0,1."))
                return CQuarnCommand::failure;
        }
    }

    CQuarnCommand::result askRadius(const KM_3dPoint& centre) {
        CQuarnGetNumber get;
        get.SetCommandPrompt(QnLocalizeString(L"Radius", 42308));
        for (;;) {
            const bool from_line = hasWordsLeft();
            if (get.GetNumber() != CQuarnGet::number)
                return get.CommandResult();
            CurveResult circle = makeCircle(centre, m_normal, get.Number());
            if (circle)
                return m_prompt.add(std::move(circle));
            Application::current()->tell(circle.message());
            if (!mayAskAgain(from_line))
                return CQuarnCommand::failure;
        }
    }

    DrawingPrompt m_prompt;
    int m_axis = 0;
    KM_3dVector m_normal{0.0, 0.0, 1.0};
};

} // namespace

CQuarnCommand::result runLine(const CQuarnCommandContext& context) {
    DrawingPrompt prompt(Document::of(context.Document()).objects(),
                         QnLocalizeString(L"Start of the line", 42301));
    const PointAnswer start = prompt.ask();
    if (start.kind != PointAnswer::Kind::point)
        return start.result;
    prompt.points().setQuestion(QnLocalizeString(L"End of the line", 42302));
    for (;;) {
        const PointAnswer end = prompt.ask();
        if (end.kind != PointAnswer::Kind::point)
            return end.result;
        CurveResult line = makeLine(start.point, end.point);
        if (line)
            return prompt.add(std::move(line));
        if (!prompt.points().refuse(line.message()))
            return CQuarnCommand::failure;
    }
}

CQuarnCommand::result runCircle(const CQuarnCommandContext& context) {
    return CircleQuestion(Document::of(context.Document()).objects()).run();
}

CQuarnCommand::result runPoint(const CQuarnCommandContext& context) {
    ObjectTable& objects = Document::of(context.Document()).objects();
    DrawingPrompt prompt(objects, QnLocalizeString(L"Place of the point", 42309));
    prompt.points().addOption(QnLocalizeCommandOptionName(L"Replace", 42305));
    KM_wString replaced;
    PointAnswer place = prompt.ask();
    while (place.kind == PointAnswer::Kind::option) {
        const CQuarnCommand::result asked = askReplacedPoint(objects, replaced);
        if (asked != CQuarnCommand::success)
            return asked;
        place = prompt.ask();
    }
    if (place.kind != PointAnswer::Kind::point)
        return place.result;
    const DocumentObject* present =
        replaced.IsEmpty() ? nullptr : objects.findByName(replaced.View());
    if (present) {
        objects.movePoint(present->id, place.point);
        Application::current()->tell(newObjectText(*present));
        return CQuarnCommand::success;
    }
    if (!replaced.IsEmpty())
        prompt.setName(replaced);
    return prompt.add(place.point);
}

} // namespace quarn
