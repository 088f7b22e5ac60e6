#include "host/commands/HostCommands.h"
#include "host/commands/PointPrompt.h"
#include "host/document/Document.h"

#include <vector>

namespace quarn {

namespace {

constexpr int STANDARD_DEGREE = 3;

/// What a person gave for a curve.
struct Drawn {
    std::vector<KM_3dPoint> points;
    int degree = STANDARD_DEGREE;
};

/// A kind of curve that is drawn by any number of points.
struct DrawnKind {
    CurveResult (*make)(const Drawn& drawn, bool closed);
    bool points_may_repeat;
    bool has_degree;
};

CurveResult drawnPolyline(const Drawn& drawn, bool closed) {
    return makePolyline(drawn.points, closed);
}

CurveResult drawnSpline(const Drawn& drawn, bool closed) {
    return makeSpline(drawn.points, drawn.degree, closed);
}

CurveResult drawnSplineThrough(const Drawn& drawn, bool closed) {
    return makeSplineThrough(drawn.points, closed);
}

/// Gathers points until Enter or Close; the document is not touched before.
class PointListQuestion {
public:
    PointListQuestion(ObjectTable& objects, const DrawnKind& kind)
        : m_kind(kind), m_prompt(objects, QnLocalizeString(L"First point", 42303)) {
        m_close = m_prompt.points().addOption(QnLocalizeCommandOptionName(L"Close", 42301));
        m_undo = m_prompt.points().addOption(QnLocalizeCommandOptionName(L"Undo", 42302));
        if (kind.has_degree)
            m_degree = m_prompt.points().addOption(QnLocalizeCommandOptionName(L"Degree", 42303));
        m_prompt.points().acceptEnd();
    }

    CQuarnCommand::result run() {
        while (!m_ended) {
            m_prompt.points().setQuestion(m_drawn.points.empty()
                                              ? QnLocalizeString(L"First point", 42303)
                                              : QnLocalizeString(L"Next point", 42304));
            const PointAnswer answer = m_prompt.ask();
            if (answer.kind == PointAnswer::Kind::stop)
                return answer.result;
            take(answer);
        }
        return m_result;
    }

private:
    void take(const PointAnswer& answer) {
        if (answer.kind == PointAnswer::Kind::point)
            takePoint(answer.point);
        else if (answer.kind == PointAnswer::Kind::end)
            make(false);
        else if (answer.option == m_close)
            make(true);
        else if (answer.option == m_undo)
            undo();
        else
            askDegree();
    }

    void end(CQuarnCommand::result result) {
        m_result = result;
        m_ended = true;
    }

    void refuse(std::string_view why) {
        if (!m_prompt.points().refuse(why))
            end(CQuarnCommand::failure);
    }

    void takePoint(const KM_3dPoint& point) {
        if (!m_kind.points_may_repeat && !m_drawn.points.empty() && m_drawn.points.back() == point)
            return refuse("The point is where the last one is. Give another one.");
        m_drawn.points.push_back(point);
    }

    void undo() {
        if (m_drawn.points.empty())
            return refuse("There is no point to undo.");
        m_drawn.points.pop_back();
    }

    void askDegree() {
        CQuarnGetInteger get;
        get.SetCommandPrompt(QnLocalizeString(L"Degree", 42305));
        get.SetDefaultInteger(m_drawn.degree);
        get.SetLowerLimit(1);
        get.SetUpperLimit(HIGHEST_DEGREE);
        if (get.GetNumber() != CQuarnGet::number)
            return end(get.CommandResult());
        m_drawn.degree = get.Number();
    }

    /// A person may mend what makes no curve.
    void make(bool closed) {
        CurveResult curve = m_kind.make(m_drawn, closed);
        if (!curve)
            return refuse(curve.message());
        end(m_prompt.add(std::move(curve)));
    }

    DrawnKind m_kind;
    DrawingPrompt m_prompt;
    Drawn m_drawn;
    int m_close = 0;
    int m_undo = 0;
    int m_degree = 0;
    bool m_ended = false;
    CQuarnCommand::result m_result = CQuarnCommand::cancel;
};

CQuarnCommand::result draw(const CQuarnCommandContext& context, const DrawnKind& kind) {
    return PointListQuestion(Document::of(context.Document()).objects(), kind).run();
}

} // namespace

CQuarnCommand::result runPolyline(const CQuarnCommandContext& context) {
    return draw(context, {drawnPolyline, false, false});
}

CQuarnCommand::result runSpline(const CQuarnCommandContext& context) {
    return draw(context, {drawnSpline, true, true});
}

CQuarnCommand::result runSplineThrough(const CQuarnCommandContext& context) {
    return draw(context, {drawnSplineThrough, false, false});
}

} // namespace quarn
