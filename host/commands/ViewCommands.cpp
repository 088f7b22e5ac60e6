#include "host/commands/CommandEnd.h"
#include "host/commands/HostCommands.h"
#include "host/document/Document.h"
#include "host/document/StandardViews.h"
#include "sdk/qncore/QnGet.h"

namespace quarn {

namespace {

/// What a new view looks like at first.
struct ViewStart {
    CQuarnCommand::result asked = CQuarnCommand::cancel;
    const StandardView* direction = nullptr; ///< null: as the active view
};

ViewStart askViewStart() {
    CQuarnGetOption get;
    get.SetCommandPrompt(QnLocalizeString(L"What the view starts with", 42251));
    const CQuarnCommandOptionName copy = QnLocalizeCommandOptionName(L"Copy", 42250);
    get.AddCommandOption(copy);
    for (const StandardView& standard : standardViews())
        get.AddCommandOption(QnLocalizeCommandOptionName(standard.name, standard.text_id));
    get.SetDefaultString(copy.m_local);
    const CQuarnGet::result answer = get.GetOption();
    if (answer == CQuarnGet::string)
        return {CQuarnCommand::failure};
    if (answer != CQuarnGet::option)
        return {get.CommandResult()};
    const int index = get.Option()->m_option_index;
    if (index == 1)
        return {CQuarnCommand::success};
    return {CQuarnCommand::success, &standardViews()[static_cast<std::size_t>(index) - 2]};
}

Result<ViewState*> addView(Document& document, const KM_wString& name, const ViewStart& start) {
    const ViewState& active = document.activeView();
    const KM_Viewport viewport =
        start.direction ? turnedTo(*start.direction, active.viewport()) : active.viewport();
    const Result<ViewState*> added = document.addView(name, viewport);
    if (!added)
        return added;
    ViewState& view = *added.value();
    view.setFrameSize(active.frameWidth(), active.frameHeight());
    if (!start.direction && active.displayMode())
        view.setDisplayMode(active.displayMode()->Id());
    return added;
}

} // namespace

CQuarnCommand::result runAddView(const CQuarnCommandContext& context) {
    Document& document = Document::of(context.Document());
    CQuarnGetString get;
    get.SetCommandPrompt(QnLocalizeString(L"Name of the new view", 42250));
    if (get.GetString() != CQuarnGet::string)
        return get.CommandResult();
    const KM_wString name = get.String();
    if (const auto free = document.checkNewViewName(name); !free)
        return fail(free.message());
    const ViewStart start = askViewStart();
    if (start.asked != CQuarnCommand::success)
        return start.asked;
    const Result<ViewState*> added = addView(document, name, start);
    if (!added)
        return fail(added.message());
    document.activateView(name.View());
    return CQuarnCommand::success;
}

CQuarnCommand::result runRemoveView(const CQuarnCommandContext& context) {
    CQuarnGetString get;
    get.SetCommandPrompt(QnLocalizeString(L"View to remove", 42252));
    if (get.GetString() != CQuarnGet::string)
        return get.CommandResult();
    const auto closed = Document::of(context.Document()).closeView(get.String());
    return closed ? CQuarnCommand::success : fail(closed.message());
}

} // namespace quarn
