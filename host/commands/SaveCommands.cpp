#include "ground/PathText.h"
#include "host/app/Application.h"
#include "host/app/DocumentSaving.h"
#include "host/commands/CommandEnd.h"
#include "host/commands/FileAsking.h"
#include "host/commands/FileNameQuestion.h"
#include "host/commands/HostCommands.h"
#include "host/commands/WordsLeft.h"
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
    /// Whether a file that is protected from writing is replaced too.
    bool overwrite = false;
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

constexpr int VERSION_OPTION = 1;

/// Asks for the file, once, with options for the version and for replacing a protected file.
CQuarnGet::result askFile(CQuarnGetString& get, const std::filesystem::path& offered,
                          SaveTarget& target) {
    const KM_wString shown = numberText(target.version);
    get.SetCommandPrompt(QnLocalizeString(L"Document file", 42104));
    get.AddCommandOption(QnLocalizeCommandOptionName(L"Version", 42103), {shown, shown});
    get.AddCommandOptionToggle(QnLocalizeCommandOptionName(L"Overwrite", 42550),
                               QnLocalizeCommandOptionValue(L"No", 42001),
                               QnLocalizeCommandOptionValue(L"Yes", 42002), target.overwrite,
                               &target.overwrite);
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
        const CQuarnGet::result answer = askFile(get, offered, target);
        const bool is_version =
            answer == CQuarnGet::option && get.Option()->m_option_index == VERSION_OPTION;
        target.result = is_version ? askVersion(target.version) : get.CommandResult();
        if (target.result != CQuarnCommand::success)
            return target;
        if (answer != CQuarnGet::string)
            continue;
        if (tellWordsBehindFile())
            target.result = CQuarnCommand::failure;
        else
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

/// Tells what can be done where a protected file was not replaced.
/// @param command  the one that can replace it
CQuarnCommand::result failAtProtection(const std::filesystem::path& file, const wchar_t* command) {
    return fail(KM_wString::FormatToString(
        QnLocalizeString(L"%s is write-protected and was not replaced. Save under another name, or "
                         L"replace it all the same with _-%s [Overwrite=Yes] \"%s\"",
                         42551),
        textFromPath(file.filename()).Array(), command, textFromPath(file).Array()));
}

CQuarnCommand::result save(Document& document, const SaveTarget& target, bool only_selected) {
    const Protection protection =
        target.overwrite ? Protection::overridden : Application::current()->protection();
    if (protection == Protection::respected && isWriteProtected(target.file))
        return failAtProtection(target.file, only_selected ? L"SaveSelected" : L"SaveAs");
    const auto saved =
        saveDocument(document, target.file, {target.version, only_selected, protection});
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
    if (hasWordsLeft())
        return fail(QnLocalizeString(L"The document has a file, so Save takes no name. Save under "
                                     L"another name with SaveAs.",
                                     42552));
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
