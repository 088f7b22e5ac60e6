#include "ground/PathText.h"
#include "host/app/Application.h"
#include "host/commands/CommandEnd.h"
#include "host/commands/FileAsking.h"
#include "host/commands/HostCommands.h"
#include "host/commands/ObjectNaming.h"
#include "host/commands/ReplacedObject.h"
#include "host/curves/CurveFile.h"
#include "host/document/Document.h"
#include "sdk/qncore/QnGet.h"

namespace quarn {

namespace {

struct CurveFileWish {
    std::filesystem::path file;
    KM_wString name;       ///< empty: that of the file
    bool replaces = false; ///< a curve that has the name already
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

CQuarnCommand::result promptForFile(const ObjectTable& objects, CurveFileWish& wish) {
    CQuarnGetString get;
    get.SetCommandPrompt(QnLocalizeString(L"Curve file", 42314));
    get.AddCommandOption(QnLocalizeCommandOptionName(L"Name", 42300));
    const int replace = get.AddCommandOption(QnLocalizeCommandOptionName(L"Replace", 42305));
    CQuarnGet::result answer = get.GetString();
    while (answer == CQuarnGet::option) {
        wish.replaces = get.Option()->m_option_index == replace;
        const CQuarnCommand::result asked =
            wish.replaces ? askReplacedCurve(objects, wish.name) : askName(objects, wish.name);
        if (asked != CQuarnCommand::success)
            return asked;
        answer = get.GetString();
    }
    wish.file = pathFromText(get.String());
    return get.CommandResult();
}

CQuarnCommand::result askFile(const CQuarnCommandContext& context, const ObjectTable& objects,
                              CurveFileWish& wish) {
    const FileChoice choice = chooseFile(context, FileUse::import_curve);
    if (choice.kind == FileChoice::Kind::nobody)
        return promptForFile(objects, wish);
    wish.file = choice.file;
    return choice.kind == FileChoice::Kind::chosen ? CQuarnCommand::success : CQuarnCommand::cancel;
}

/// The file's name without its extension, where an object can be called so.
KM_wString nameOf(const ObjectTable& objects, const std::filesystem::path& file) {
    const KM_wString name = textFromPath(file.stem());
    const bool is_taken = objects.findByName(name.View()) != nullptr;
    return is_taken || whyNameRefused(objects, nullptr, name).empty() ? name : L"Curve";
}

const DocumentObject& put(ObjectTable& objects, const CurveFileWish& wish,
                          std::unique_ptr<KM_Curve> curve) {
    const DocumentObject* replaced = wish.replaces ? objects.findByName(wish.name.View()) : nullptr;
    if (replaced) {
        objects.replaceCurve(replaced->id, std::move(curve));
        return *replaced;
    }
    const KM_wString name = wish.name.IsEmpty() ? nameOf(objects, wish.file) : wish.name;
    return objects.addCurve(name, std::move(curve));
}

} // namespace

CQuarnCommand::result runImportCurve(const CQuarnCommandContext& context) {
    ObjectTable& objects = Document::of(context.Document()).objects();
    CurveFileWish wish;
    const CQuarnCommand::result asked = askFile(context, objects, wish);
    if (asked != CQuarnCommand::success)
        return asked;
    CurveResult curve = readCurveFile(wish.file);
    if (!curve)
        return fail(curve.message());
    const DocumentObject& object = put(objects, wish, std::move(curve.value()));
    Application::current()->tell(newObjectText(object));
    return CQuarnCommand::success;
}

} // namespace quarn
