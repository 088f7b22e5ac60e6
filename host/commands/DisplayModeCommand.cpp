#include "host/commands/CommandEnd.h"
#include "host/commands/HostCommands.h"
#include "host/document/DisplayModeList.h"
#include "host/document/Document.h"
#include "sdk/qncore/QnGet.h"

namespace quarn {

namespace {

void addModes(CQuarnGetOption& get) {
    for (const CDisplayPipelineAttributes& mode : DisplayModeList::instance().modes())
        get.AddCommandOption(
            {QnCleanedModeName(mode.EnglishName()), QnCleanedModeName(mode.LocalName())});
}

std::string modeNames() {
    std::string names;
    for (const CDisplayPipelineAttributes& mode : DisplayModeList::instance().modes())
        names += (names.empty() ? "" : ", ") + mode.LocalName().ToUtf8();
    return names;
}

} // namespace

CQuarnCommand::result runDisplayMode(const CQuarnCommandContext& context) {
    ViewState& view = Document::of(context.Document()).activeView();
    const DisplayModeList& list = DisplayModeList::instance();
    CQuarnGetOption get;
    get.SetCommandPrompt(QnLocalizeString(L"Display mode", 42030));
    get.AcceptString();
    if (view.displayMode())
        get.SetDefaultString(view.displayMode()->LocalName());
    addModes(get);

    const CQuarnGet::result answer = get.GetOption();
    if (answer != CQuarnGet::option && answer != CQuarnGet::string)
        return get.CommandResult();
    const CDisplayPipelineAttributes* mode =
        answer == CQuarnGet::option
            ? &list.modes()[static_cast<std::size_t>(get.Option()->m_option_index - 1)]
            : list.findByName(get.String());
    if (!mode)
        return fail("There is no display mode \"" + KM_wString(get.String()).ToUtf8() +
                    "\". The modes are " + modeNames() + ".");
    view.setDisplayMode(mode->Id());
    return CQuarnCommand::success;
}

} // namespace quarn
