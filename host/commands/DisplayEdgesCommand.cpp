#include "engine/display/DisplayMode.h"
#include "host/commands/CommandEnd.h"
#include "host/commands/HostCommands.h"
#include "host/document/Document.h"
#include "sdk/qncore/QnGet.h"

namespace quarn {

namespace {

/// In the order of MeshEdgeChoice.
constexpr struct {
    const wchar_t* name;
    int text_id;
} CHOICES[] = {{L"Standard", 42390}, {L"None", 42391}, {L"Features", 42392}, {L"All", 42393}};

} // namespace

CQuarnCommand::result runDisplayEdges(const CQuarnCommandContext& context) {
    Document& document = Document::of(context.Document());
    const CDisplayPipelineAttributes* const mode = document.activeView().displayMode();
    if (!mode)
        return fail("The active view has no display mode. Choose one with DisplayMode.");
    CQuarnGetOption get;
    get.SetCommandPrompt(QnLocalizeString(L"Edges of meshes", 42390) + KM_wString(L" (") +
                         mode->LocalName() + KM_wString(L")"));
    const auto& present = CHOICES[static_cast<std::size_t>(document.edgesOf(mode->Id()))];
    get.SetDefaultString(QnLocalizeCommandOptionName(present.name, present.text_id).m_local);
    get.AcceptNothing();
    for (const auto& choice : CHOICES)
        get.AddCommandOption(QnLocalizeCommandOptionName(choice.name, choice.text_id));
    const CQuarnGet::result answer = get.GetOption();
    if (answer == CQuarnGet::nothing)
        return CQuarnCommand::success;
    if (answer == CQuarnGet::string)
        return CQuarnCommand::failure;
    if (answer != CQuarnGet::option)
        return get.CommandResult();
    document.setEdgesOf(mode->Id(), static_cast<MeshEdgeChoice>(get.Option()->m_option_index - 1));
    return CQuarnCommand::success;
}

} // namespace quarn
