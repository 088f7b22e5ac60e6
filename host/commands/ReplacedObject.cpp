#include "host/commands/ReplacedObject.h"

#include "host/app/Application.h"
#include "host/commands/ObjectNaming.h"
#include "host/commands/WordsLeft.h"
#include "sdk/qncore/QnGet.h"

namespace quarn {

namespace {

using IsReplaceable = bool (*)(const DocumentObject&);

std::string whyRefused(const ObjectTable& objects, const KM_wString& name,
                       IsReplaceable is_replaceable) {
    const DocumentObject* owner = objects.findByName(name.View());
    return owner && is_replaceable(*owner) ? std::string() : whyNameRefused(objects, nullptr, name);
}

CQuarnCommand::result askReplaced(const ObjectTable& objects, IsReplaceable is_replaceable,
                                  KM_wString& name) {
    CQuarnGetString get;
    get.SetCommandPrompt(
        QnLocalizeString(L"Name of the object to replace, or of a new one", 42315));
    for (;;) {
        const bool from_line = hasWordsLeft();
        if (get.GetString() != CQuarnGet::string)
            return get.CommandResult();
        name = get.String();
        name.TrimLeftAndRight();
        const std::string why = whyRefused(objects, name, is_replaceable);
        if (why.empty())
            return CQuarnCommand::success;
        Application::current()->tell(why);
        if (!mayAskAgain(from_line))
            return CQuarnCommand::failure;
    }
}

} // namespace

CQuarnCommand::result askReplacedCurve(const ObjectTable& objects, KM_wString& name) {
    return askReplaced(
        objects, [](const DocumentObject& object) { return object.curve != nullptr; }, name);
}

CQuarnCommand::result askReplacedPoint(const ObjectTable& objects, KM_wString& name) {
    return askReplaced(
        objects, [](const DocumentObject& object) { return object.point.has_value(); }, name);
}

} // namespace quarn
