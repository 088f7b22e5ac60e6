#include "host/commands/ModelReading.h"

#include "host/app/Application.h"
#include "host/app/PathText.h"
#include "host/commands/CommandEnd.h"
#include "host/document/Document.h"
#include "host/document/ViewFit.h"
#include "sdk/qncore/QnGet.h"
#include "sdk/qncore/QnLocalize.h"

namespace quarn {

namespace {

std::string counted(std::size_t count, const std::string& noun) {
    return std::to_string(count) + " " + noun + (count == 1 ? "" : "s");
}

std::string contentText(const ImportedModel& model) {
    std::string text = counted(model.meshes.size(), "object") + " with " +
                       counted(model.triangleCount(), "triangle");
    if (!model.curves.empty())
        text += ", " + counted(model.curves.size(), "curve");
    if (!model.points.IsEmpty())
        text += ", " + counted(static_cast<std::size_t>(model.points.Count()), "point");
    if (!model.cameras.empty())
        text += ", " + counted(model.cameras.size(), "camera");
    return text;
}

void fitViews(Document& document) {
    for (const auto& view : document.views()) {
        const auto fitted = fitViewport(view->viewport(), document.objects(), {});
        if (fitted)
            view->setViewport(fitted.value(), true, true);
    }
}

bool isDocumentFile(const std::filesystem::path& file) {
    return textFromPath(file.extension()).CompareNoCase(L".quarn") == 0;
}

/// @param up  receives the answer
CQuarnCommand::result askUpAxis(UpAxis& up) {
    CQuarnGetOption get;
    get.SetCommandPrompt(QnLocalizeString(L"Axis that points up in the file", 42051));
    const int by_format = get.AddCommandOption(QnLocalizeCommandOptionName(L"ByFormat", 42050));
    const int y = get.AddCommandOption(QnLocalizeCommandOptionName(L"Y", 0));
    get.AddCommandOption(QnLocalizeCommandOptionName(L"Z", 0));
    const CQuarnGet::result answer = get.GetOption();
    if (answer == CQuarnGet::string)
        return failForWord(get.String(), "ByFormat, Y or Z");
    if (answer != CQuarnGet::option)
        return get.CommandResult();
    const int picked = get.Option()->m_option_index;
    up = picked == by_format ? UpAxis::by_format : picked == y ? UpAxis::y : UpAxis::z;
    return CQuarnCommand::success;
}

/// Asks for the file and, where the option is picked, for the axis that points up in it.
CQuarnCommand::result askFile(std::filesystem::path& file, UpAxis& up) {
    CQuarnGetString get;
    get.SetCommandPrompt(QnLocalizeString(L"Model file", 42050));
    get.AddCommandOption(QnLocalizeCommandOptionName(L"Up", 42051));
    CQuarnGet::result answer = get.GetString();
    while (answer == CQuarnGet::option) {
        const CQuarnCommand::result asked = askUpAxis(up);
        if (asked != CQuarnCommand::success)
            return asked;
        answer = get.GetString();
    }
    if (answer == CQuarnGet::string)
        file = pathFromText(get.String());
    return get.CommandResult();
}

} // namespace

AskedModel askModel() {
    AskedModel asked;
    UpAxis up = UpAxis::by_format;
    asked.result = askFile(asked.file, up);
    if (asked.result != CQuarnCommand::success)
        return asked;
    if (isDocumentFile(asked.file)) {
        asked.result = fail("Cannot read " + textFromPath(asked.file).ToUtf8() +
                            ": this version reads model files only, no documents.");
        return asked;
    }
    auto model = readModelFile(asked.file, up);
    if (!model) {
        asked.result = fail(model.message());
        return asked;
    }
    asked.model = std::move(model.value());
    return asked;
}

void addToDocument(Document& document, const AskedModel& asked) {
    Application& application = *Application::current();
    const bool was_empty = document.objects().empty();
    document.addModel(asked.model);
    for (const std::string& warning : asked.model.warnings)
        application.tell(warning);
    application.tell(textFromPath(asked.file.filename()).ToUtf8() + ": " +
                     contentText(asked.model));
    if (was_empty)
        fitViews(document);
}

} // namespace quarn
