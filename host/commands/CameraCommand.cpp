#include "host/commands/CameraForm.h"
#include "host/commands/CommandEnd.h"
#include "host/commands/FormAsking.h"
#include "host/commands/HostCommands.h"
#include "host/commands/PointQuestion.h"
#include "host/commands/PointText.h"
#include "host/document/Document.h"
#include "sdk/qncore/QnGet.h"

namespace quarn {

namespace {

/// Asks for the parts of a wish until Enter.
class CameraQuestion {
public:
    explicit CameraQuestion(const KM_Viewport& viewport) : m_viewport(viewport) {
        m_wish.parallel = viewport.IsParallelProjection();
        m_get.SetCommandPrompt(QnLocalizeString(L"Camera", 42001));
        m_get.AcceptNothing();
        m_location = m_get.AddCommandOption(QnLocalizeCommandOptionName(L"Location", 42001));
        m_target = m_get.AddCommandOption(QnLocalizeCommandOptionName(L"Target", 42002));
        m_lens = m_get.AddCommandOption(QnLocalizeCommandOptionName(L"Lens", 42003));
        m_get.AddCommandOptionToggle(QnLocalizeCommandOptionName(L"Parallel", 42004),
                                     QnLocalizeCommandOptionValue(L"No", 42001),
                                     QnLocalizeCommandOptionValue(L"Yes", 42002), m_wish.parallel,
                                     &m_wish.parallel);
    }

    CQuarnCommand::result run() {
        for (;;) {
            const CQuarnGet::result answer = m_get.GetOption();
            if (answer == CQuarnGet::nothing)
                return CQuarnCommand::success;
            if (answer == CQuarnGet::string)
                return CQuarnCommand::failure;
            if (answer != CQuarnGet::option)
                return m_get.CommandResult();
            const CQuarnCommand::result asked = askPart(m_get.Option()->m_option_index);
            if (asked != CQuarnCommand::success)
                return asked;
        }
    }

    const CameraWish& wish() const { return m_wish; }

private:
    CQuarnCommand::result askPart(int option) {
        if (option == m_location)
            return askPoint(QnLocalizeString(L"Camera location", 42002),
                            m_viewport.CameraLocation(), m_wish.location);
        if (option == m_target)
            return askPoint(QnLocalizeString(L"Camera target", 42003), cameraTarget(m_viewport),
                            m_wish.target);
        return option == m_lens ? askLens() : CQuarnCommand::success;
    }

    static CQuarnCommand::result askPoint(const wchar_t* prompt, const KM_3dPoint& present,
                                          std::optional<KM_3dPoint>& wish) {
        PointQuestion<CQuarnGetString> get;
        get.SetCommandPrompt(prompt);
        get.SetDefaultString(pointText(present));
        if (get.GetString() != CQuarnGet::string)
            return get.CommandResult();
        const auto point = readPoint(get.String());
        if (!point)
            return fail(point.message());
        wish = point.value();
        return CQuarnCommand::success;
    }

    CQuarnCommand::result askLens() {
        CQuarnGetNumber get;
        get.SetCommandPrompt(QnLocalizeString(L"Lens length in millimetres", 42004));
        get.SetLowerLimit(SHORTEST_LENS_MM);
        get.SetUpperLimit(LONGEST_LENS_MM);
        double present_mm = 0.0;
        if (m_viewport.GetCamera35mmLensLength(&present_mm))
            get.SetDefaultNumber(present_mm);
        if (get.GetNumber() != CQuarnGet::number)
            return get.CommandResult();
        m_wish.lens_mm = get.Number();
        return CQuarnCommand::success;
    }

    const KM_Viewport& m_viewport;
    CameraWish m_wish;
    CQuarnGetOption m_get;
    int m_location = 0;
    int m_target = 0;
    int m_lens = 0;
};

CQuarnCommand::result askCamera(const CQuarnCommandContext& context, const KM_Viewport& viewport,
                                CameraWish& wish) {
    CameraForm form(viewport);
    if (const auto answered = askInForm(context, form)) {
        wish = form.wish();
        return *answered;
    }
    CameraQuestion question(viewport);
    const CQuarnCommand::result asked = question.run();
    wish = question.wish();
    return asked;
}

} // namespace

CQuarnCommand::result runCamera(const CQuarnCommandContext& context) {
    ViewState& view = Document::of(context.Document()).activeView();
    KM_Viewport viewport = view.viewport();
    CameraWish wish;
    const CQuarnCommand::result asked = askCamera(context, viewport, wish);
    if (asked != CQuarnCommand::success)
        return asked;
    if (const Result<void> moved = fulfil(wish, viewport); !moved)
        return fail(moved.message());
    view.setViewport(viewport, true, true);
    return CQuarnCommand::success;
}

} // namespace quarn
