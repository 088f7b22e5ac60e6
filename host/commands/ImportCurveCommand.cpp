#include "host/app/Application.h"
#include "host/app/PathText.h"
#include "host/commands/CommandEnd.h"
#include "host/commands/HostCommands.h"
#include "host/commands/ObjectNaming.h"
#include "host/document/Document.h"
#include "host/import/CurveFile.h"
#include "sdk/qncore/QnGet.h"

namespace quarn {

namespace {

struct CurveFileWish {
    std::filesystem::path file;
    KM_wString name; ///< empty: that of the file
};

CQuarnCommand::result askName(const ObjectTable& objects, KM_wString& name) {
    CQuarnGetString get;
    get.SetCommandPrompt(QnLocalizeString(L"Name of the new object", 42300));
    if (get.GetString() != CQuarnGet::string)
        return get.CommandResult();
    name = get.String();
    name.TrimLeftAndRight();
    const std::string why = whyNameRefused(objects, nullptr, name);
    return why.empty() ? CQuarnCommand::success : fail(why);
}

CQuarnCommand::result askFile(const ObjectTable& objects, CurveFileWish& wish) {
    CQuarnGetString get;
    get.SetCommandPrompt(QnLocalizeString(L"Curve file", 42314));
    get.AddCommandOption(QnLocalizeCommandOptionName(L"Name", 42300));
    CQuarnGet::result answer = get.GetString();
    while (answer == CQuarnGet::option) {
        const CQuarnCommand::result asked = askName(objects, wish.name);
        if (asked != CQuarnCommand::success)
            return asked;
        answer = get.GetString();
    }
    wish.file = pathFromText(get.String());
    return get.CommandResult();
}

/// The file's name without its extension, where an object can be called so.
KM_wString nameOf(const ObjectTable& objects, const std::filesystem::path& file) {
    const KM_wString name = textFromPath(file.stem());
    const bool is_taken = objects.findByName(name.View()) != nullptr;
    return is_taken || whyNameRefused(objects, nullptr, name).empty() ? name : L"Curve";
}

} // namespace

CQuarnCommand::result runImportCurve(const CQuarnCommandContext& context) {
    ObjectTable& objects = Document::of(context.Document()).objects();
    CurveFileWish wish;
    const CQuarnCommand::result asked = askFile(objects, wish);
    if (asked != CQuarnCommand::success)
        return asked;
    CurveResult curve = readCurveFile(wish.file);
    if (!curve)
        return fail(curve.message());
    const KM_wString name = wish.name.IsEmpty() ? nameOf(objects, wish.file) : wish.name;
    const DocumentObject& object = objects.addCurve(name, std::move(curve.value()));
    Application::current()->tell(newObjectText(object));
    return CQuarnCommand::success;
}

} // namespace quarn
