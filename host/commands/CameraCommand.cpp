#include "host/commands/CommandEnd.h"
#include "host/commands/HostCommands.h"
#include "host/commands/PointText.h"
#include "host/document/CameraMove.h"
#include "host/document/Document.h"
#include "sdk/qncore/QnGet.h"

#include <optional>

namespace quarn {

namespace {

constexpr double SHORTEST_LENS_MM = 1.0;
constexpr double LONGEST_LENS_MM = 10000.0;

/// What the person wants of the camera; what is not there stays as it is.
struct CameraWish {
    std::optional<KM_3dPoint> location;
    std::optional<KM_3dPoint> target;
    std::optional<double> lens_mm;
    bool parallel = false;
};

KM_3dPoint targetOf(const KM_Viewport& viewport) {
    const KM_3dPoint& target = viewport.TargetPoint();
    return target.IsValid() ? target : viewport.CameraLocation() + viewport.CameraDirection();
}

/// Turns a wish into prompts, and the answers into a viewport.
class CameraQuestion {
public:
    explicit CameraQuestion(ViewState& view) : m_view(view) {
        m_wish.parallel = view.viewport().IsParallelProjection();
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
                return moveView();
            if (answer == CQuarnGet::string)
                return failForWord(m_get.String(), "Location, Target, Lens, Parallel or _Enter");
            if (answer != CQuarnGet::option)
                return m_get.CommandResult();
            const CQuarnCommand::result asked = askPart(m_get.Option()->m_option_index);
            if (asked != CQuarnCommand::success)
                return asked;
        }
    }

private:
    CQuarnCommand::result askPart(int option) {
        const KM_Viewport& viewport = m_view.viewport();
        if (option == m_location)
            return askPoint(QnLocalizeString(L"Camera location", 42002), viewport.CameraLocation(),
                            m_wish.location);
        if (option == m_target)
            return askPoint(QnLocalizeString(L"Camera target", 42003), targetOf(viewport),
                            m_wish.target);
        return option == m_lens ? askLens() : CQuarnCommand::success;
    }

    static CQuarnCommand::result askPoint(const wchar_t* prompt, const KM_3dPoint& present,
                                          std::optional<KM_3dPoint>& wish) {
        CQuarnGetString get;
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
        if (m_view.viewport().GetCamera35mmLensLength(&present_mm))
            get.SetDefaultNumber(present_mm);
        if (get.GetNumber() != CQuarnGet::number)
            return get.CommandResult();
        m_wish.lens_mm = get.Number();
        return CQuarnCommand::success;
    }

    CQuarnCommand::result moveView() {
        KM_Viewport viewport = m_view.viewport();
        const KM_3dPoint target = m_wish.target.value_or(targetOf(viewport));
        const KM_3dPoint location = m_wish.location.value_or(viewport.CameraLocation());
        if (m_wish.location || m_wish.target) {
            if (!moveCamera(viewport, target, location, true))
                return fail("The camera cannot stand at its target. Give another location or "
                            "target.");
            viewport.SetTargetPoint(target);
        }
        viewport.SetProjection(m_wish.parallel ? KM_parallel_view : KM_perspective_view);
        if (m_wish.lens_mm && !viewport.SetCamera35mmLensLength(*m_wish.lens_mm))
            return fail("A parallel view has no lens. Set Parallel=No or leave Lens out.");
        m_view.setViewport(viewport, true, true);
        return CQuarnCommand::success;
    }

    ViewState& m_view;
    CameraWish m_wish;
    CQuarnGetOption m_get;
    int m_location = 0;
    int m_target = 0;
    int m_lens = 0;
};

} // namespace

CQuarnCommand::result runCamera(const CQuarnCommandContext& context) {
    return CameraQuestion(Document::of(context.Document()).activeView()).run();
}

} // namespace quarn
