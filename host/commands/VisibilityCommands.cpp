#include "host/commands/CommandEnd.h"
#include "host/commands/HostCommands.h"
#include "host/document/Document.h"
#include "sdk/qncore/QnGet.h"

namespace quarn {

namespace {

/// @param text  an object's name, in any case, or its id
DocumentObject* findObject(const ObjectTable& objects, const KM_wString& text) {
    if (DocumentObject* named = objects.findByName(text.View()))
        return named;
    const KM_UUID id = KM_UuidFromString(text.ToUtf8());
    return KM_UuidIsNil(id) ? nullptr : objects.find(id);
}

CQuarnCommand::result setVisibility(CQuarnDoc& doc, const wchar_t* prompt, bool visible) {
    CQuarnGetString get;
    get.SetCommandPrompt(prompt);
    if (get.GetString() != CQuarnGet::string)
        return get.CommandResult();
    const KM_wString text = get.String();
    ObjectTable& objects = Document::of(doc).objects();
    const DocumentObject* const object = findObject(objects, text);
    if (!object)
        return fail("There is no object \"" + text.ToUtf8() + "\". List shows the names.");
    objects.setVisible(object->id, visible);
    return CQuarnCommand::success;
}

} // namespace

CQuarnCommand::result runHide(const CQuarnCommandContext& context) {
    return setVisibility(context.Document(), QnLocalizeString(L"Object to hide", 42070), false);
}

CQuarnCommand::result runShow(const CQuarnCommandContext& context) {
    return setVisibility(context.Document(), QnLocalizeString(L"Object to show", 42071), true);
}

} // namespace quarn
