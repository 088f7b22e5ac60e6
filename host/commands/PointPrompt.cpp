#include "host/commands/PointPrompt.h"

#include "host/app/Application.h"
#include "host/commands/CommandEnd.h"
#include "host/commands/ObjectNaming.h"
#include "host/commands/PointText.h"
#include "host/commands/WordsLeft.h"

namespace quarn {

namespace {

PointAnswer stop(CQuarnCommand::result result) {
    PointAnswer answer;
    answer.result = result;
    return answer;
}

PointAnswer answerOf(PointAnswer::Kind kind) {
    PointAnswer answer;
    answer.kind = kind;
    return answer;
}

} // namespace

void PointPrompt::acceptEnd() {
    m_get.AcceptNothing();
    m_accepts_end = true;
    m_is_line = hasWordsLeft();
}

PointAnswer PointPrompt::ask() {
    for (;;) {
        if (m_is_line && !hasWordsLeft())
            return answerOf(PointAnswer::Kind::end);
        m_from_line = hasWordsLeft();
        const CQuarnGet::result got = m_get.GetOption();
        if (got == CQuarnGet::nothing)
            return answerOf(PointAnswer::Kind::end);
        if (got == CQuarnGet::option) {
            PointAnswer answer = answerOf(PointAnswer::Kind::option);
            answer.option = m_get.Option()->m_option_index;
            return answer;
        }
        if (got != CQuarnGet::string)
            return stop(m_get.CommandResult());
        const auto point = readPoint(m_get.String());
        if (point) {
            PointAnswer answer = answerOf(PointAnswer::Kind::point);
            answer.point = point.value();
            return answer;
        }
        if (!refuse(point.message()))
            return stop(CQuarnCommand::failure);
    }
}

bool PointPrompt::refuse(std::string_view why) {
    Application::current()->tell(why);
    const bool again = mayAskAgain(m_from_line);
    // A person goes on where the line broke off.
    m_is_line = false;
    return again;
}

DrawingPrompt::DrawingPrompt(ObjectTable& objects, const wchar_t* question)
    : m_objects(objects), m_points(question) {
    m_naming = m_points.addOption(QnLocalizeCommandOptionName(L"Name", 42300));
}

PointAnswer DrawingPrompt::ask() {
    for (;;) {
        const PointAnswer answer = m_points.ask();
        if (answer.kind != PointAnswer::Kind::option || answer.option != m_naming)
            return answer;
        const CQuarnCommand::result named = askName();
        if (named != CQuarnCommand::success)
            return stop(named);
    }
}

CQuarnCommand::result DrawingPrompt::askName() {
    CQuarnGetString get;
    get.SetCommandPrompt(QnLocalizeString(L"Name of the new object", 42300));
    for (;;) {
        const bool from_line = hasWordsLeft();
        if (get.GetString() != CQuarnGet::string)
            return get.CommandResult();
        KM_wString name = get.String();
        name.TrimLeftAndRight();
        const std::string why = whyNameRefused(m_objects, nullptr, name);
        if (why.empty()) {
            m_name = name;
            return CQuarnCommand::success;
        }
        Application::current()->tell(why);
        if (!mayAskAgain(from_line))
            return CQuarnCommand::failure;
    }
}

CQuarnCommand::result DrawingPrompt::add(CurveResult curve) {
    if (!curve)
        return fail(curve.message());
    const KM_wString name = m_name.IsEmpty() ? KM_wString(L"Curve") : m_name;
    const DocumentObject& object = m_objects.addCurve(name, std::move(curve.value()));
    Application::current()->tell(newObjectText(object));
    return CQuarnCommand::success;
}

CQuarnCommand::result DrawingPrompt::add(const KM_3dPoint& point) {
    const KM_wString name = m_name.IsEmpty() ? KM_wString(L"Point") : m_name;
    Application::current()->tell(newObjectText(m_objects.addPoint(name, point)));
    return CQuarnCommand::success;
}

} // namespace quarn
