#include "host/commands/CommandEnd.h"
#include "host/commands/HostCommands.h"
#include "host/document/Document.h"
#include "host/document/DocumentDrawing.h"
#include "host/document/ViewFit.h"
#include "sdk/qncore/QnGet.h"

namespace quarn {

namespace {

constexpr double LEAST_DISTANCE = 0.01;
constexpr double GREATEST_DISTANCE = 1000.0;

CQuarnCommand::result askDistance(double& distance) {
    CQuarnGetNumber get;
    get.SetCommandPrompt(QnLocalizeString(L"Distance, 1 for the fitted one", 42011));
    get.SetDefaultNumber(distance);
    get.SetLowerLimit(LEAST_DISTANCE);
    get.SetUpperLimit(GREATEST_DISTANCE);
    if (get.GetNumber() != CQuarnGet::number)
        return get.CommandResult();
    distance = get.Number();
    return CQuarnCommand::success;
}

void addToggle(CQuarnGetOption& get, const wchar_t* name, int name_id, bool& variable) {
    get.AddCommandOptionToggle(QnLocalizeCommandOptionName(name, name_id),
                               QnLocalizeCommandOptionValue(L"No", 42001),
                               QnLocalizeCommandOptionValue(L"Yes", 42002), variable, &variable);
}

CQuarnCommand::result fitActiveView(Document& document, const ViewFit& fit) {
    ViewState& view = document.activeView();
    document.drawing().tellObjectsOutOfRange();
    const auto fitted = fitViewport(view.viewport(), document.objects(), fit);
    if (!fitted)
        return fail(fitted.message());
    view.setViewport(fitted.value(), true, true);
    return CQuarnCommand::success;
}

} // namespace

CQuarnCommand::result runFitView(const CQuarnCommandContext& context) {
    ViewFit fit;
    CQuarnGetOption get;
    get.SetCommandPrompt(QnLocalizeString(L"Fit view", 42010));
    get.AcceptNothing();
    addToggle(get, L"Turn", 42011, fit.turn);
    addToggle(get, L"KeepTarget", 42012, fit.keep_target);
    const int distance = get.AddCommandOption(QnLocalizeCommandOptionName(L"Distance", 42013));
    for (;;) {
        const CQuarnGet::result answer = get.GetOption();
        if (answer == CQuarnGet::nothing)
            return fitActiveView(Document::of(context.Document()), fit);
        if (answer == CQuarnGet::string)
            return CQuarnCommand::failure;
        if (answer != CQuarnGet::option)
            return get.CommandResult();
        if (get.Option()->m_option_index != distance)
            continue;
        const CQuarnCommand::result asked = askDistance(fit.distance);
        if (asked != CQuarnCommand::success)
            return asked;
    }
}

} // namespace quarn
