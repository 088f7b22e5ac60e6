#include "host/import/ModelFile.h"

#include "host/import/CoordinateShift.h"
#include "host/import/LargeStack.h"
#include "host/import/ModelFileAccess.h"
#include "host/import/ModelFileCheck.h"
#include "host/import/SceneReading.h"
#include "host/import/SceneRepair.h"

#include <assimp/Importer.hpp>
#include <assimp/commonMetaData.h>
#include <assimp/config.h>
#include <assimp/postprocess.h>
#include <assimp/scene.h>

#include <algorithm>
#include <array>
#include <exception>
#include <optional>
#include <set>
#include <string_view>

namespace quarn {
namespace {

namespace fs = std::filesystem;

constexpr std::string_view repair = "The file may be damaged; export the model again.";

/// One sentence of the reading library as a part of one of ours.
std::string cleaned(std::string_view text) {
    constexpr std::size_t longest = 300;
    std::string clean(text.substr(0, longest));
    std::replace_if(
        clean.begin(), clean.end(), [](char c) { return static_cast<unsigned char>(c) < 32; }, ' ');
    while (!clean.empty() && (clean.back() == ' ' || clean.back() == '.')) {
        clean.pop_back();
    }
    return clean.empty() ? "its contents cannot be understood" : clean;
}

bool isOneOf(std::string_view format, std::initializer_list<std::string_view> formats) {
    return std::find(formats.begin(), formats.end(), format) != formats.end();
}

/// Version 1 of glTF left the meaning of its colours to shaders, which took them as they are.
bool hasLinearColors(const aiScene& scene, const std::string& format) {
    aiString version;
    const bool old = scene.mMetaData != nullptr &&
                     scene.mMetaData->Get(AI_METADATA_SOURCE_FORMAT_VERSION, version) &&
                     std::string_view(version.C_Str()).starts_with("1");
    return isOneOf(format, {"gltf", "glb"}) && !old;
}

bool isYUp(const std::string& format, UpAxis up) {
    if (up != UpAxis::by_format) {
        return up == UpAxis::y;
    }
    return !isOneOf(format, {"obj", "ply", "stl", "off", "3mf", "amf", "dxf", "blend"});
}

ModelConventions conventionsOf(const aiScene& scene, const fs::path& path, UpAxis up) {
    const std::string format = modelFormat(path);
    ModelConventions conventions;
    conventions.turn_y_up = isYUp(format, up);
    conventions.keep_normals = format != "stl";
    conventions.gltf_cameras = isOneOf(format, {"gltf", "glb"});
    conventions.linear_colors = hasLinearColors(scene, format);
    conventions.file_name = KM_wString::FromUtf8(path.stem().string());
    return conventions;
}

UnitSystem unitsOf(const std::string& format) {
    return isOneOf(format, {"gltf", "glb"}) ? UnitSystem::meters : UnitSystem::none;
}

void configure(Assimp::Importer& importer) {
    importer.SetPropertyBool(AI_CONFIG_IMPORT_FBX_PRESERVE_PIVOTS, false);
    importer.SetPropertyBool(AI_CONFIG_IMPORT_FBX_READ_ANIMATIONS, false);
    importer.SetPropertyBool(AI_CONFIG_IMPORT_NO_SKELETON_MESHES, true);
}

/// The reading library tries many spellings of a name; only files that are there deserve a word.
void warnOfRefused(const std::set<std::string>& refused, ImportedModel& model) {
    std::set<fs::path> told;
    for (const std::string& name : refused) {
        const fs::path path = fs::path(name).lexically_normal();
        std::error_code ignored;
        if (fs::is_regular_file(path, ignored) && told.insert(path).second) {
            model.warnings.push_back("The file '" + path.string() +
                                     "' was not read: it lies outside the model's folder.");
        }
    }
}

bool isEmpty(const ImportedModel& model) {
    return model.meshes.empty() && model.curves.empty() && model.points.Count() == 0;
}

Error nothingLeft(const fs::path& path, const ImportedModel& model) {
    const std::string why = model.warnings.empty()
                                ? "it holds no triangles, lines or points"
                                : "nothing in it can be shown. " + cleaned(model.warnings.back());
    return cannotReadModel(path, why, "Export the model again, with its meshes.");
}

/// Reads the file into the importer's scene; false with the importer's error text otherwise.
bool readScene(Assimp::Importer& importer, const fs::path& path) {
    unsigned steps =
        aiProcess_ValidateDataStructure | aiProcess_Triangulate | aiProcess_SortByPType;
    if (!isOneOf(modelFormat(path), {"gltf", "glb"})) {
        steps |= aiProcess_TransformUVCoords; // turned ones of glTF come out wrong
    }
    if (importer.ReadFile(path.string(), 0) == nullptr) {
        return false;
    }
    // The scene is the importer's own, which hands it out as constant only for its users' sake.
    auto* const scene = const_cast<aiScene*>(importer.GetScene());
    repairScene(*scene);
    return scene->mNumMeshes == 0 || importer.ApplyPostProcessing(steps) != nullptr;
}

Result<ImportedModel> readChecked(const fs::path& path, UpAxis up) {
    const ModelFolder folder(path);
    std::set<std::string> refused;
    const std::optional<ShiftedFile> shifted = shiftFarCoordinates(path);
    Assimp::Importer importer;
    auto* const access = new ModelFileAccess(folder, refused);
    importer.SetIOHandler(access); // which owns it
    if (shifted) {
        access->replace(path, shifted->bytes);
    }
    configure(importer);
    const std::string extension = path.extension().string();
    if (extension.empty() || !importer.IsExtensionSupported(extension)) {
        return cannotReadModel(path, "files of this kind are not known",
                               "Choose a model file (OBJ, glTF, GLB, PLY, STL, ...).");
    }
    if (!readScene(importer, path)) {
        return cannotReadModel(path, cleaned(importer.GetErrorString()), repair);
    }
    const std::unique_ptr<aiScene> scene(importer.GetOrphanedScene());
    importer.FreeScene();
    ModelConventions conventions = conventionsOf(*scene, path, up);
    if (shifted) {
        conventions.origin = shifted->origin;
    }
    Result<ImportedModel> model = takeScene(*scene, folder, conventions);
    if (!model) {
        return cannotReadModel(path, model.message(), repair);
    }
    model.value().units = unitsOf(modelFormat(path));
    warnOfRefused(refused, model.value());
    return isEmpty(model.value()) ? nothingLeft(path, model.value()) : std::move(model);
}

Result<ImportedModel> readGuarded(const fs::path& path, UpAxis up) {
    try {
        return readChecked(path, up);
    } catch (const std::bad_alloc&) {
        return cannotReadModel(path, "there is not enough memory", "Use a smaller model.");
    } catch (const std::exception& failure) {
        return cannotReadModel(path, cleaned(failure.what()), repair);
    }
}

} // namespace

std::size_t ImportedModel::triangleCount() const {
    std::size_t count = 0;
    for (const ImportedMesh& mesh : meshes) {
        count += mesh.mesh->m_F.size();
    }
    return count;
}

Result<ImportedModel> readModelFile(const fs::path& path, UpAxis up) {
    const Result<void> checked = checkModelFile(path);
    if (!checked) {
        return checked.error();
    }
    Result<ImportedModel> model = ImportedModel{};
    runWithLargeStack([&path, up, &model] { model = readGuarded(path, up); });
    return model;
}

} // namespace quarn
