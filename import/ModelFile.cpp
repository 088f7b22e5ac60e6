#include "import/ModelFile.h"

#include "ground/FileBytes.h"
#include "import/ModelFormats.h"
#include "import/assembly/ModelAssembly.h"
#include "import/files/ModelFileCheck.h"

#include <exception>
#include <new>

namespace quarn {

namespace {

namespace fs = std::filesystem;

class NobodyWatches final : public ReadingWatch {
    bool goesOn(ReadingStep, double) override { return true; }
};

bool isEmpty(const ImportedModel& model) {
    return model.meshes.empty() && model.curves.empty() && model.points.Count() == 0;
}

Error nothingLeft(const fs::path& path, const ImportedModel& model) {
    std::string why = "it holds no triangles, lines or points";
    if (!model.warnings.empty())
        why = "nothing in it can be shown. " + model.warnings.back();
    if (why.ends_with('.'))
        why.pop_back(); // the sentence goes on
    return cannotReadModel(path, why, "Export the model again, with its meshes.");
}

Result<ImportedModel> readMapped(const ModelReading& reading) {
    Result<SourceScene> scene = readerOf(modelFormat(reading.path))(reading);
    if (!scene)
        return scene.error();
    Result<ImportedModel> model = assembleModel(std::move(scene.value()), reading);
    if (!model)
        return cannotReadModel(reading.path, model.message(), "Use a smaller model.");
    return isEmpty(model.value()) ? nothingLeft(reading.path, model.value()) : std::move(model);
}

Result<ImportedModel> readGuarded(const fs::path& path, const ReadingOptions& options) {
    const Result<MappedFile> file = mapFile(path);
    if (!file)
        return cannotReadModel(path, file.message(), "Check the file.");
    const ModelFolder folder(path);
    ReadingBudget budget(options.most_memory);
    NobodyWatches nobody;
    return readMapped({path, file.value().bytes(), folder, options.up, options.tolerance, budget,
                       options.watch != nullptr ? *options.watch : nobody});
}

} // namespace

std::size_t ImportedModel::triangleCount() const {
    std::size_t count = 0;
    for (const ImportedMesh& mesh : meshes)
        count += mesh.placed.mesh->m_F.size();
    return count;
}

Result<ImportedModel> readModelFile(const fs::path& path, const ReadingOptions& options) {
    const Result<void> checked = checkModelFile(path);
    if (!checked)
        return checked.error();
    try {
        return readGuarded(path, options);
    } catch (const std::bad_alloc&) {
        return cannotReadModel(path, "there is not enough memory", "Use a smaller model.");
    } catch (const std::exception& failure) {
        return cannotReadModel(path, failure.what(), "The file may be damaged.");
    }
}

} // namespace quarn
