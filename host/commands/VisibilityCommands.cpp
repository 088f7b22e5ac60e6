#include "host/commands/HostCommands.h"
#include "host/commands/ObjectPicking.h"
#include "host/document/Document.h"

namespace quarn {

namespace {

CQuarnCommand::result setVisibility(CQuarnDoc& doc, const wchar_t* prompt, bool visible) {
    const PickedObjects picked = askObjects(prompt);
    ObjectTable& objects = Document::of(doc).objects();
    for (const KM_UUID& id : picked.ids) {
        objects.setVisible(id, visible);
        if (!visible)
            objects.select(id, false); // so that no later command works on what nobody sees
    }
    return picked.result;
}

} // namespace

CQuarnCommand::result runHide(const CQuarnCommandContext& context) {
    return setVisibility(context.Document(), QnLocalizeString(L"Objects to hide", 42070), false);
}

CQuarnCommand::result runShow(const CQuarnCommandContext& context) {
    return setVisibility(context.Document(), QnLocalizeString(L"Objects to show", 42071), true);
}

} // namespace quarn
