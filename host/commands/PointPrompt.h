#pragma once

#include "host/commands/PointQuestion.h"
#include "host/curves/CurveMaking.h"
#include "host/document/ObjectTable.h"
#include "sdk/qncore/QnGet.h"

#include <string_view>

namespace quarn {

/// What a person gave where a point was asked for.
struct PointAnswer {
    enum class Kind {
        point,
        option, ///< one of the asker's own options
        end,    ///< Enter, or the end of the command's line
        stop,   ///< the command ends with `result`
    };
    Kind kind = Kind::stop;
    KM_3dPoint point;
    int option = 0;
    CQuarnCommand::result result = CQuarnCommand::cancel;
};

/// Asks for points, written x,y,z, beside options.
class PointPrompt {
public:
    explicit PointPrompt(const wchar_t* question) { m_get.SetCommandPrompt(question); }

    void setQuestion(const wchar_t* question) { m_get.SetCommandPrompt(question); }
    /// @return what PointAnswer::option is when it is picked
    int addOption(const CQuarnCommandOptionName& name) { return m_get.AddCommandOption(name); }
    /// Lets Enter, and the end of a line that had words, be an answer.
    void acceptEnd();

    /// Asks. A person is asked again for a text that is no point; in a script it ends the command.
    PointAnswer ask();

    /// Tells why the last answer cannot be taken.
    /// @return whether to ask again; else the command fails
    bool refuse(std::string_view why);

private:
    PointQuestion<CQuarnGetOption> m_get;
    bool m_accepts_end = false;
    bool m_is_line = false;
    bool m_from_line = false;
};

/// A PointPrompt of a command that draws an object, with the option to name it.
class DrawingPrompt {
public:
    DrawingPrompt(ObjectTable& objects, const wchar_t* question);

    PointPrompt& points() { return m_points; }
    /// @param name  one that no object has
    void setName(const KM_wString& name) { m_name = name; }
    /// As PointPrompt::ask; names are taken on the way.
    PointAnswer ask();

    /// Adds the curve to the document and tells what it is. Without a name given it is called
    /// "Curve", with a number where there is one already.
    /// @return failure, with the error told, where there is none
    CQuarnCommand::result add(CurveResult curve);
    /// As above; without a name given a point is called "Point".
    CQuarnCommand::result add(const KM_3dPoint& point);

private:
    CQuarnCommand::result askName();

    ObjectTable& m_objects;
    PointPrompt m_points;
    int m_naming = 0;
    KM_wString m_name;
};

} // namespace quarn
