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

} // namespace

AskedModel askModel() {
    CQuarnGetString get;
    get.SetCommandPrompt(QnLocalizeString(L"Model file", 42050));
    AskedModel asked;
    if (get.GetString() != CQuarnGet::string) {
        asked.result = get.CommandResult();
        return asked;
    }
    asked.file = pathFromText(get.String());
    if (isDocumentFile(asked.file)) {
        asked.result = fail("Cannot read " + textFromPath(asked.file).ToUtf8() +
                            ": this version reads model files only, no documents.");
        return asked;
    }
    auto model = readModelFile(asked.file);
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
