#include "host/commands/ModelReading.h"

#include "ground/PathText.h"
#include "host/app/Application.h"
#include "host/app/DocumentSaving.h"
#include "host/commands/CommandEnd.h"
#include "host/commands/FileNameQuestion.h"
#include "host/commands/StudyPlace.h"
#include "host/commands/UpAxisAsking.h"
#include "host/commands/UpAxisText.h"
#include "host/commands/WatchedBuilding.h"
#include "host/commands/WatchedReading.h"
#include "host/document/DocumentDrawing.h"
#include "host/document/DocumentList.h"
#include "host/document/ViewFit.h"
#include "host/document/file/DocumentExtension.h"
#include "host/document/file/DocumentFile.h"
#include "host/reader/ModelReader.h"
#include "host/reader/ReaderEnds.h"
#include "sdk/qncore/QnGet.h"
#include "sdk/qncore/QnLocalize.h"

#include <algorithm>
#include <utility>

namespace quarn {

namespace {

std::string counted(std::size_t count, const std::string& noun) {
    return std::to_string(count) + " " + noun + (count == 1 ? "" : "s");
}

/// What a file holds, to be told.
struct ContentCounts {
    std::size_t meshes = 0;
    std::size_t triangles = 0;
    std::size_t curves = 0;
    std::size_t points = 0;
    std::size_t cameras = 0;
    std::size_t lights = 0;

    std::string text() const {
        std::string text = counted(meshes, "object") + " with " + counted(triangles, "triangle");
        for (const auto& [count, noun] : {std::pair(curves, "curve"), std::pair(points, "point"),
                                          std::pair(cameras, "camera"), std::pair(lights, "light")})
            if (count > 0)
                text += ", " + counted(count, noun);
        return text;
    }
};

ContentCounts countsOf(const ImportedModel& model) {
    return {.meshes = model.meshes.size(),
            .triangles = model.triangleCount(),
            .curves = model.curves.size(),
            .points = static_cast<std::size_t>(model.points.Count()),
            .cameras = model.cameras.size(),
            .lights = model.lights.size()};
}

ContentCounts countsOf(const DocumentContent& content) {
    ContentCounts counts;
    for (const ObjectContent& object : content.objects) {
        counts.meshes += object.placed.mesh ? 1 : 0;
        counts.triangles +=
            object.placed.mesh ? static_cast<std::size_t>(object.placed.mesh->TriangleCount()) : 0;
        counts.curves += object.curve ? 1 : 0;
        counts.points += object.point ? 1 : 0;
    }
    counts.cameras = content.cameras.size();
    counts.lights = content.lights.size();
    return counts;
}

void addSentence(std::string& line, const std::string& sentence) {
    if (!sentence.empty())
        line += (line.ends_with('.') ? " " : ". ") + sentence;
}

/// Tells what may be wrong with what was read, then what it is.
void tellContent(Document& document, const AskedFile& asked,
                 const std::vector<std::string>& warnings) {
    Application& application = *Application::current();
    for (const std::string& warning : warnings)
        application.tell(warning);
    const ContentCounts counts =
        std::visit([](const auto& content) { return countsOf(content); }, asked.content);
    std::string result = textFromPath(asked.file.filename()).ToUtf8() + ": " + counts.text();
    if (const auto* model = std::get_if<ImportedModel>(&asked.content)) {
        addSentence(result, upAxisText(model->up));
        if (model->place && asked.is_interactive)
            addSentence(result, offerStudyPlace(document, *model->place));
    }
    application.tell(result);
}

void fitViews(Document& document) {
    for (const auto& view : document.views()) {
        const auto fitted = fitViewport(view->viewport(), document.objects(), {});
        if (fitted)
            view->setViewport(fitted.value(), true, true);
    }
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
        return CQuarnCommand::failure;
    if (answer != CQuarnGet::option)
        return get.CommandResult();
    const int picked = get.Option()->m_option_index;
    up = picked == by_format ? UpAxis::by_format : picked == y ? UpAxis::y : UpAxis::z;
    return CQuarnCommand::success;
}

/// @param tolerance  receives the answer
CQuarnCommand::result askTolerance(double& tolerance) {
    CQuarnGetNumber get;
    get.SetCommandPrompt(
        QnLocalizeString(L"How far meshes may lie beside curved surfaces, 0 for by size", 42660));
    get.SetLowerLimit(0.0);
    if (get.GetNumber() != CQuarnGet::number)
        return get.CommandResult() == CQuarnCommand::success ? CQuarnCommand::failure
                                                             : get.CommandResult();
    tolerance = get.Number();
    return CQuarnCommand::success;
}

/// How a person wants a model file to be read.
struct ReadingWish {
    UpAxis up = UpAxis::by_format;
    double tolerance = 0.0; ///< as ReadingOptions has it

    bool isUsual() const { return up == UpAxis::by_format && tolerance == 0.0; }
};

/// Asks for the file and, where their options are picked, how it is to be read.
CQuarnCommand::result askFile(std::filesystem::path& file, ReadingWish& wish) {
    FileNameQuestion get;
    get.SetCommandPrompt(QnLocalizeString(L"Model or document file", 42050));
    const int up = get.AddCommandOption(QnLocalizeCommandOptionName(L"Up", 42051));
    get.AddCommandOption(QnLocalizeCommandOptionName(L"Tolerance", 42660));
    CQuarnGet::result answer = get.GetString();
    while (answer == CQuarnGet::option) {
        const CQuarnCommand::result asked =
            get.Option()->m_option_index == up ? askUpAxis(wish.up) : askTolerance(wish.tolerance);
        if (asked != CQuarnCommand::success)
            return asked;
        answer = get.GetString();
    }
    if (answer == CQuarnGet::string)
        file = pathFromText(get.String());
    return get.CommandResult();
}

Result<void> readDocument(AskedFile& asked, const ReadingWish& wish) {
    if (!wish.isUsual())
        return Error{"A document has its axes and its meshes; leave Up and Tolerance out."};
    auto content = readDocumentFile(asked.file);
    if (!content)
        return content.error();
    asked.content = std::move(content.value());
    return {};
}

Result<void> readModelOf(AskedFile& asked, const ReadingWish& wish, WatchedReading& watch) {
    auto model =
        readModel(asked.file, {.up = wish.up,
                               .tolerance = wish.tolerance,
                               .most_memory = Application::current()->options().most_memory,
                               .most_threads = Application::current()->options().most_threads,
                               .watch = &watch});
    if (!model)
        return model.error();
    asked.content = std::move(model.value());
    return {};
}

std::vector<SceneMesh> meshesOf(const ImportedModel& model) {
    std::vector<SceneMesh> meshes;
    for (const ImportedMesh& mesh : model.meshes)
        meshes.push_back({mesh.placed, KM_nil_uuid});
    return meshes;
}

std::vector<SceneMesh> meshesOf(const DocumentContent& content) {
    std::vector<SceneMesh> meshes;
    for (const ObjectContent& object : content.objects)
        if (object.placed.mesh)
            meshes.push_back({object.placed, object.id, object.visible});
    return meshes;
}

/// Reads the file and, where it will be drawn, builds its scene.
Result<void> load(AskedFile& asked, const ReadingWish& wish, const Document* document) {
    const Application& application = *Application::current();
    WatchedReading watch(application.frontEnd(), asked.file);
    Result<void> loaded =
        isDocumentFile(asked.file) ? readDocument(asked, wish) : readModelOf(asked, wish, watch);
    if (loaded && application.options().builds_scenes) {
        const auto meshes =
            std::visit([](const auto& content) { return meshesOf(content); }, asked.content);
        asked.scene = buildWatched(document, meshes, watch);
    }
    asked.is_given_up = watch.isGivenUp();
    return loaded && asked.is_given_up ? readingGivenUp(asked.file) : loaded;
}

} // namespace

AskedFile askFileToRead(const CQuarnCommandContext& context, FileUse use) {
    AskedFile asked;
    ReadingWish wish;
    const FileChoice choice = chooseFile(context, use);
    if (choice.kind == FileChoice::Kind::nobody)
        asked.result = askFile(asked.file, wish);
    else if (choice.kind == FileChoice::Kind::given_up)
        asked.result = CQuarnCommand::cancel;
    asked.file = choice.kind == FileChoice::Kind::chosen ? choice.file : asked.file;
    if (asked.result != CQuarnCommand::success)
        return asked;
    const Document* const document =
        use == FileUse::import ? &Document::of(context.Document()) : nullptr;
    const auto read = load(asked, wish, document);
    if (!read)
        asked.result = fail(read.message());
    if (!read && asked.is_given_up)
        asked.result = CQuarnCommand::cancel;
    asked.is_interactive = context.IsInteractive();
    auto* const model = std::get_if<ImportedModel>(&asked.content);
    if (read && model && asked.is_interactive)
        askUpAxis(asked.file, *model, asked.scene.get());
    return asked;
}

void addToDocument(Document& document, AskedFile& asked) {
    const bool was_empty = document.objects().empty();
    if (const auto* model = std::get_if<ImportedModel>(&asked.content)) {
        document.addModel(*model);
        tellContent(document, asked, model->warnings);
    } else {
        tellContent(document, asked,
                    importContent(document, std::get<DocumentContent>(asked.content)));
    }
    if (asked.scene)
        document.drawing().takeScene(std::move(asked.scene));
    if (was_empty)
        fitViews(document);
}

void openAsDocument(DocumentList& list, AskedFile& asked) {
    Document& document = list.openNew();
    const auto* content = std::get_if<DocumentContent>(&asked.content);
    if (!content) {
        addToDocument(document, asked);
        document.markSaved(); // nobody wants to be asked about a model that was only looked at
        return;
    }
    tellContent(document, asked, openContent(document, *content));
    if (asked.scene)
        document.drawing().takeScene(std::move(asked.scene));
    std::error_code ignored;
    document.setFile(std::filesystem::absolute(asked.file, ignored));
    if (content->views.empty())
        fitViews(document);
    document.markSaved();
}

} // namespace quarn
