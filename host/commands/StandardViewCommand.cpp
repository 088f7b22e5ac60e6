#include "host/commands/CommandEnd.h"
#include "host/commands/HostCommands.h"
#include "host/document/Document.h"
#include "host/document/StandardViews.h"
#include "sdk/qncore/QnGet.h"

#include <algorithm>

namespace quarn {

namespace {

const NamedView* findNamedView(const Document& document, const wchar_t* name) {
    const auto& views = document.namedViews();
    const auto found = std::find_if(views.begin(), views.end(), [&](const NamedView& view) {
        return view.name.CompareNoCase(name) == 0;
    });
    return found == views.end() ? nullptr : &*found;
}

} // namespace

CQuarnCommand::result runStandardView(const CQuarnCommandContext& context) {
    const Document& document = Document::of(context.Document());
    ViewState& view = document.activeView();
    CQuarnGetOption get;
    get.SetCommandPrompt(QnLocalizeString(L"View direction", 42060));
    get.AcceptString();
    for (const StandardView& standard : standardViews())
        get.AddCommandOption(QnLocalizeCommandOptionName(standard.name, standard.text_id));
    const CQuarnGet::result answer = get.GetOption();
    if (answer == CQuarnGet::option) {
        const auto index = static_cast<std::size_t>(get.Option()->m_option_index - 1);
        view.setViewport(turnedTo(standardViews()[index], view.viewport()), true, true);
        return CQuarnCommand::success;
    }
    if (answer != CQuarnGet::string)
        return get.CommandResult();
    const NamedView* named = findNamedView(document, get.String());
    if (!named)
        return fail("\"" + KM_wString(get.String()).ToUtf8() +
                    "\" is no option here. Give Top, Front, Right, Perspective or the name of a "
                    "camera of the model.");
    view.setViewport(named->viewport, true, true);
    return CQuarnCommand::success;
}

} // namespace quarn
