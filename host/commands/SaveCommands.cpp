#include "ground/PathText.h"
#include "host/app/Application.h"
#include "host/app/DocumentSaving.h"
#include "host/commands/CommandEnd.h"
#include "host/commands/FileAsking.h"
#include "host/commands/FileNameQuestion.h"
#include "host/commands/HostCommands.h"
#include "host/document/Document.h"
#include "host/document/file/DocumentExtension.h"
#include "host/prompt/NumberText.h"
#include "sdk/qncore/QnGet.h"

namespace quarn {

namespace {

/// Where to save to, or how the command ends without that.
struct SaveTarget {
    CQuarnCommand::result result = CQuarnCommand::success;
    std::filesystem::path file; ///< absolute
    int version = KM_CURRENT_ARCHIVE_VERSION;
};

/// The document file that a path names: a name without an ending gets that of documents.
Result<std::filesystem::path> documentPath(std::filesystem::path file) {
    const std::filesystem::path name = file.filename();
    if (name.empty() || name == "." || name == "..")
        return Error{"\"" + textFromPath(file).ToUtf8() +
                     "\" names a folder. Give the name of a file."};
    if (!file.has_extension())
        file += DOCUMENT_EXTENSION;
    if (!isDocumentFile(file))
        return Error{"Documents are saved as NAME" + std::string(DOCUMENT_EXTENSION) +
                     " files only, not as \"" + textFromPath(name).ToUtf8() + "\"."};
    std::error_code error;
    const std::filesystem::path absolute = std::filesystem::absolute(file, error);
    return error ? file : absolute;
}

CQuarnCommand::result askVersion(int& version) {
    CQuarnGetInteger get;
    get.SetCommandPrompt(QnLocalizeString(L"Version of the file", 42105));
    get.SetDefaultInteger(version);
    get.SetLowerLimit(OLDEST_DOCUMENT_VERSION);
    get.SetUpperLimit(KM_CURRENT_ARCHIVE_VERSION);
    if (get.GetNumber() == CQuarnGet::number)
        version = get.Number();
    return get.CommandResult();
}

/// Asks for the file, once, with an option for the version.
CQuarnGet::result askFile(CQuarnGetString& get, const std::filesystem::path& offered, int version) {
    const KM_wString shown = numberText(version);
    get.SetCommandPrompt(QnLocalizeString(L"Document file", 42104));
    get.AddCommandOption(QnLocalizeCommandOptionName(L"Version", 42103), {shown, shown});
    if (!offered.empty())
        get.SetDefaultString(textFromPath(offered));
    return get.GetString();
}

void setFile(SaveTarget& target, const std::filesystem::path& file) {
    const auto path = documentPath(file);
    if (path)
        target.file = path.value();
    else
        target.result = fail(path.message());
}

/// @param offered  the file that Enter takes; empty for none
SaveTarget promptForTarget(const std::filesystem::path& offered) {
    SaveTarget target;
    for (;;) {
        FileNameQuestion get;
        const CQuarnGet::result answer = askFile(get, offered, target.version);
        target.result =
            answer == CQuarnGet::option ? askVersion(target.version) : get.CommandResult();
        if (target.result != CQuarnCommand::success)
            return target;
        if (answer != CQuarnGet::string)
            continue;
        setFile(target, pathFromText(get.String()));
        return target;
    }
}

/// @param offered  the file that is there already; empty for none
SaveTarget askTarget(const CQuarnCommandContext& context, FileUse use,
                     const std::filesystem::path& offered) {
    const FileChoice choice = chooseFile(context, use, offered);
    if (choice.kind == FileChoice::Kind::nobody)
        return promptForTarget(offered);
    SaveTarget target;
    if (choice.kind == FileChoice::Kind::given_up)
        target.result = CQuarnCommand::cancel;
    else
        setFile(target, choice.file);
    return target;
}

CQuarnCommand::result save(Document& document, const SaveTarget& target, bool only_selected) {
    const auto saved = saveDocument(document, target.file, {target.version, only_selected});
    if (!saved)
        return fail(saved.message());
    Application::current()->tell("Saved " + textFromPath(target.file.filename()).ToUtf8() + ".");
    return CQuarnCommand::success;
}

/// Saves the whole document. A file of an older version holds less than the document may, so it
/// does not become the document's file.
CQuarnCommand::result saveWhole(Document& document, const SaveTarget& target) {
    if (target.result != CQuarnCommand::success)
        return target.result;
    const CQuarnCommand::result saved = save(document, target, false);
    if (saved == CQuarnCommand::success && target.version == KM_CURRENT_ARCHIVE_VERSION) {
        document.setFile(target.file);
        document.markSaved();
    }
    return saved;
}

bool isFileOf(const Document& document, const std::filesystem::path& file) {
    std::error_code ignored;
    return !document.file().empty() &&
           (file == document.file() || std::filesystem::equivalent(file, document.file(), ignored));
}

} // namespace

CQuarnCommand::result runSave(const CQuarnCommandContext& context) {
    Document& document = Document::of(context.Document());
    if (document.file().empty())
        return saveWhole(document, askTarget(context, FileUse::save, {}));
    SaveTarget target;
    target.file = document.file();
    return saveWhole(document, target);
}

CQuarnCommand::result runSaveAs(const CQuarnCommandContext& context) {
    Document& document = Document::of(context.Document());
    return saveWhole(document, askTarget(context, FileUse::save, document.file()));
}

CQuarnCommand::result runSaveSelected(const CQuarnCommandContext& context) {
    Document& document = Document::of(context.Document());
    if (document.objects().selectedCount() == 0)
        return fail("Nothing is selected. Select what is to be saved with Select first.");
    const SaveTarget target = askTarget(context, FileUse::save_selected, {});
    if (target.result != CQuarnCommand::success)
        return target.result;
    if (isFileOf(document, target.file))
        return fail("The selected objects cannot be saved over the document's own file. Give "
                    "another name.");
    return save(document, target, true);
}

} // namespace quarn
