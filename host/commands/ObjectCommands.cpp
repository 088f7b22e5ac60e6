#include "host/app/Application.h"
#include "host/commands/CommandEnd.h"
#include "host/commands/HostCommands.h"
#include "host/commands/ObjectNaming.h"
#include "host/commands/ObjectPicking.h"
#include "host/commands/WordsLeft.h"
#include "host/document/Document.h"

namespace quarn {

namespace {

CQuarnCommand::result askObject(KM_UUID& id) {
    CQuarnGetObject get;
    get.SetCommandPrompt(QnLocalizeString(L"Object to rename", 42102));
    get.EnablePreSelect(!hasWordsLeft(), false);
    if (get.GetObjects(1, 1) == CQuarnGet::object)
        id = get.Object(0).ObjectUuid();
    return get.CommandResult();
}

CQuarnCommand::result askName(const DocumentObject& object, KM_wString& name) {
    CQuarnGetString get;
    get.SetCommandPrompt(QnLocalizeString(L"New name", 42103));
    if (!object.name.IsEmpty())
        get.SetDefaultString(object.name);
    get.GetString();
    name = get.String();
    name.TrimLeftAndRight();
    return get.CommandResult();
}

} // namespace

CQuarnCommand::result runDelete(const CQuarnCommandContext& context) {
    const PickedObjects picked = askObjects(QnLocalizeString(L"Objects to delete", 42101));
    if (picked.result != CQuarnCommand::success)
        return picked.result;
    const std::size_t count = Document::of(context.Document()).objects().remove(picked.ids);
    Application::current()->tell(objectCountText(count) + " deleted.");
    return CQuarnCommand::success;
}

CQuarnCommand::result runRename(const CQuarnCommandContext& context) {
    ObjectTable& objects = Document::of(context.Document()).objects();
    KM_UUID id = KM_nil_uuid;
    CQuarnCommand::result asked = askObject(id);
    const DocumentObject* object = objects.find(id);
    if (asked != CQuarnCommand::success || !object)
        return asked;
    KM_wString name;
    asked = askName(*object, name);
    if (asked != CQuarnCommand::success)
        return asked;
    if (const std::string reason = whyNameRefused(objects, object, name); !reason.empty())
        return fail(reason);
    objects.rename(id, name);
    return CQuarnCommand::success;
}

} // namespace quarn
