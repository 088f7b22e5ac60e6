#include "host/commands/FileAsking.h"

#include "ground/PathText.h"
#include "host/app/Application.h"
#include "host/app/DocumentsFolder.h"
#include "host/commands/WordsLeft.h"
#include "host/document/file/DocumentExtension.h"
#include "import/ModelFormats.h"
#include "sdk/qncore/QnGet.h"
#include "sdk/qncore/QnLocalize.h"

namespace quarn {

namespace {

const wchar_t* titleFor(FileUse use) {
    switch (use) {
    case FileUse::open:
        return QnLocalizeString(L"Open a document or model", 42500);
    case FileUse::import:
        return QnLocalizeString(L"Import objects", 42501);
    case FileUse::save:
        return QnLocalizeString(L"Save the document", 42502);
    case FileUse::save_selected:
        return QnLocalizeString(L"Save the selected objects", 42503);
    case FileUse::save_frame:
        return QnLocalizeString(L"Save the frame as a picture", 42504);
    case FileUse::save_rendering:
        return QnLocalizeString(L"Save the rendered picture", 42505);
    case FileUse::export_camera:
        return QnLocalizeString(L"Export the camera", 42823);
    case FileUse::import_curve:
        return QnLocalizeString(L"Import a curve", 42506);
    case FileUse::load_plug_in:
        return QnLocalizeString(L"Load a plug-in", 42507);
    case FileUse::save_film:
        return QnLocalizeString(L"Save the film", 42765);
    case FileUse::surroundings:
        return QnLocalizeString(L"Choose a picture of the surroundings", 42917);
    case FileUse::run:
        break;
    }
    return QnLocalizeString(L"Open a file with its program", 42508);
}

/// Without the dot.
std::string documentExtension() {
    return DOCUMENT_EXTENSION + 1;
}

FileKind documents() {
    return {QnLocalizeString(L"Quarn documents", 42511), {documentExtension()}};
}

FileKind models() {
    return {QnLocalizeString(L"Model files", 42512), modelFileExtensions()};
}

FileKind documentsAndModels() {
    FileKind both{QnLocalizeString(L"Documents and models", 42510), modelFileExtensions()};
    both.extensions.insert(both.extensions.begin(), documentExtension());
    return both;
}

FileKind allFiles() {
    return {QnLocalizeString(L"All files", 42519), {}};
}

/// The formats that pictures are written in.
std::vector<FileKind> pictures() {
    return {{QnLocalizeString(L"PNG pictures", 42514), {"png"}},
            {QnLocalizeString(L"JPEG pictures", 42513), {"jpg", "jpeg"}},
            {QnLocalizeString(L"BMP pictures", 42515), {"bmp"}},
            {QnLocalizeString(L"TGA pictures", 42516), {"tga"}}};
}

/// What the camera of an animation is written to.
std::vector<FileKind> cameras() {
    return {{QnLocalizeString(L"glTF in one binary file", 42824), {"glb"}},
            {QnLocalizeString(L"glTF files", 42825), {"gltf"}},
            {QnLocalizeString(L"JSON files", 42826), {"json"}},
            {QnLocalizeString(L"CSV tables", 42827), {"csv"}}};
}

std::vector<FileKind> films() {
    return {{QnLocalizeString(L"MP4 films", 42766), {"mp4"}},
            {QnLocalizeString(L"WebM films", 42767), {"webm"}},
            {QnLocalizeString(L"GIF films", 42768), {"gif"}},
            {QnLocalizeString(L"WebP films", 42769), {"webp"}},
            {QnLocalizeString(L"APNG films", 42786), {"apng"}}};
}

std::vector<FileKind> kindsFor(FileUse use) {
    switch (use) {
    case FileUse::open:
    case FileUse::import:
        return {documentsAndModels(), documents(), models(), allFiles()};
    case FileUse::save:
    case FileUse::save_selected:
        return {documents()};
    case FileUse::save_frame:
    case FileUse::save_rendering:
        return pictures();
    case FileUse::export_camera:
        return cameras();
    case FileUse::import_curve:
        return {{QnLocalizeString(L"Curve files", 42517), {"txt", "csv", "json"}}, allFiles()};
    case FileUse::load_plug_in:
        return {{QnLocalizeString(L"Plug-ins", 42518), {"qnp"}}, allFiles()};
    case FileUse::save_film:
        return films();
    case FileUse::surroundings:
        return {{QnLocalizeString(L"Radiance pictures", 42918), {"hdr"}}, allFiles()};
    case FileUse::run:
        break;
    }
    return {allFiles()};
}

bool isSaving(FileUse use) {
    return use == FileUse::save || use == FileUse::save_selected || use == FileUse::save_frame ||
           use == FileUse::save_rendering || use == FileUse::export_camera ||
           use == FileUse::save_film;
}

/// A file to save that was chosen without an ending gets that of the first kind.
void addEnding(FileChoice& choice, const FileQuestion& question) {
    if (choice.kind == FileChoice::Kind::chosen && !choice.file.has_extension())
        choice.file += "." + question.file_kinds.front().extensions.front();
}

} // namespace

std::filesystem::path firstChooserFolder() {
    Application& application = *Application::current();
    const Document* document = application.documents().active();
    if (document && !document->file().empty())
        return document->file().parent_path();
    return documentsFolder(application.options().documents_folder).value_or("");
}

FileChoice chooseFile(const CQuarnCommandContext& context, FileUse use,
                      const std::filesystem::path& offered) {
    if (!context.IsInteractive() || hasWordsLeft())
        return {};
    Application& application = *Application::current();
    FileQuestion question;
    question.kind = isSaving(use) ? FileQuestion::Kind::save : FileQuestion::Kind::open;
    question.title = titleFor(use);
    question.file_kinds = kindsFor(use);
    question.start = offered.empty() ? firstChooserFolder() : offered;
    FileChoice choice = application.frontEnd().chooseFile(question);
    if (isSaving(use))
        addEnding(choice, question);
    return choice;
}

CQuarnCommand::result askFile(const CQuarnCommandContext& context, FileUse use,
                              const wchar_t* prompt, std::filesystem::path& file) {
    const FileChoice choice = chooseFile(context, use);
    if (choice.kind == FileChoice::Kind::given_up)
        return CQuarnCommand::cancel;
    if (choice.kind == FileChoice::Kind::chosen) {
        file = choice.file;
        return CQuarnCommand::success;
    }
    CQuarnGetString get;
    get.SetCommandPrompt(prompt);
    if (get.GetString() == CQuarnGet::string)
        file = pathFromText(get.String());
    else if (get.CommandResult() == CQuarnCommand::success)
        return CQuarnCommand::nothing;
    return isSaving(use) && tellWordsBehindFile() ? CQuarnCommand::failure : get.CommandResult();
}

} // namespace quarn
