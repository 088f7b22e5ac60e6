#include "import/ModelFile.h"

#include "import/CoordinateShift.h"
#include "import/FaceIndexCheck.h"
#include "import/GltfExtensions.h"
#include "import/GltfLosses.h"
#include "import/LargeStack.h"
#include "import/ModelFileAccess.h"
#include "import/ModelFileCheck.h"
#include "import/PlainWords.h"
#include "import/SceneReading.h"
#include "import/SceneRepair.h"
#include "import/Utf16Text.h"

#include <assimp/Importer.hpp>
#include <assimp/commonMetaData.h>
#include <assimp/config.h>
#include <assimp/postprocess.h>
#include <assimp/scene.h>

#include <algorithm>
#include <array>
#include <exception>
#include <future>
#include <optional>
#include <set>
#include <string_view>

namespace quarn {
namespace {

namespace fs = std::filesystem;

constexpr std::string_view repair = "The file may be damaged; export the model again.";

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
    return !isOneOf(format, {"obj", "ply", "stl", "off", "3mf", "amf", "blend", "cob", "hmp", "q3o",
                             "q3s", "scn", "smd", "vta"});
}

ModelConventions conventionsOf(const aiScene& scene, const fs::path& path, UpAxis up) {
    const std::string format = modelFormat(path);
    ModelConventions conventions;
    conventions.turn_y_up = isYUp(format, up);
    conventions.keep_normals = !isOneOf(format, {"stl", "blend"});
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
    const std::string why = model.warnings.empty() ? "it holds no triangles, lines or points"
                                                   : "nothing in it can be shown. " +
                                                         inPlainWords(model.warnings.back());
    return cannotReadModel(path, why, "Export the model again, with its meshes.");
}

/// What is found out about a file beside the library's reading, which keeps it to itself.
struct BesideReading {
    std::string why_bad; ///< empty: nothing speaks against the file
    std::string_view advice = repair;
    std::optional<GltfDescription> gltf;
};

BesideReading readBeside(const fs::path& path) {
    BesideReading beside;
    beside.why_bad = whyBadIndices(path);
    if (isOneOf(modelFormat(path), {"gltf", "glb"})) {
        beside.gltf = readGltfDescription(path);
    }
    const std::string extension = beside.gltf ? unreadableExtension(*beside.gltf) : std::string();
    if (!extension.empty()) {
        beside.why_bad = "it needs the glTF extension '" + extension + "', which is not known here";
        beside.advice = "Export the model without it, or without compression.";
    }
    return beside;
}

/// The scene is the importer's own, which hands it out as constant only for its users' sake.
aiScene& sceneOf(const Assimp::Importer& importer) {
    return *const_cast<aiScene*>(importer.GetScene());
}

unsigned stepsFor(const std::string& format) {
    constexpr unsigned steps = aiProcess_ValidateDataStructure | aiProcess_Triangulate |
                               aiProcess_SortByPType | aiProcess_GenUVCoords;
    const bool is_gltf = isOneOf(format, {"gltf", "glb"});
    return is_gltf ? steps
                   : steps | aiProcess_TransformUVCoords; // turned ones of glTF come out wrong
}

/// Turns what was read into triangles, lines and points; false with the importer's error text where
/// it is damaged.
bool completeScene(Assimp::Importer& importer, const std::string& format,
                   std::vector<std::string>& warnings) {
    aiScene& scene = sceneOf(importer);
    const std::uint64_t without_corners = repairScene(scene);
    if (without_corners > 0) {
        warnings.push_back(std::to_string(without_corners) +
                           " faces were left out: they have no corners.");
    }
    return scene.mNumMeshes == 0 || importer.ApplyPostProcessing(stepsFor(format)) != nullptr;
}

/// Other bytes than those on the disk, for what the library would not understand or not exactly.
struct Replacement {
    std::optional<std::string> bytes;
    KM_3dPoint origin; ///< where their coordinates begin
};

Replacement replacementFor(const fs::path& path) {
    if (std::optional<ShiftedFile> shifted = shiftFarCoordinates(path)) {
        return {std::move(shifted->bytes), shifted->origin};
    }
    return {utf8OfWideFile(path), KM_3dPoint::Origin};
}

Result<ImportedModel> takeChecked(Assimp::Importer& importer, const fs::path& path,
                                  const ModelFolder& folder, const ModelConventions& conventions,
                                  BesideReading beside) {
    const auto refused = [&path, &beside](const std::string& why) {
        return cannotReadModel(path, beside.why_bad.empty() ? why : beside.why_bad, beside.advice);
    };
    std::vector<std::string> warnings;
    if (beside.gltf) {
        warnings = tellLostFaces(sceneOf(importer), *beside.gltf);
        for (std::string& sentence : tellUnknownExtensions(*beside.gltf)) {
            warnings.push_back(std::move(sentence));
        }
    }
    const bool is_complete = completeScene(importer, modelFormat(path), warnings);
    if (!is_complete || !beside.why_bad.empty()) {
        return refused(inPlainWords(importer.GetErrorString()));
    }
    const std::unique_ptr<aiScene> scene(importer.GetOrphanedScene());
    importer.FreeScene();
    Result<ImportedModel> model = takeScene(*scene, folder, conventions);
    if (!model) {
        return refused(model.message());
    }
    model.value().warnings.insert(model.value().warnings.begin(), warnings.begin(), warnings.end());
    return model;
}

Result<ImportedModel> readChecked(const fs::path& path, UpAxis up) {
    const ModelFolder folder(path);
    std::set<std::string> refused;
    const Replacement replacement = replacementFor(path);
    Assimp::Importer importer;
    auto* const access = new ModelFileAccess(folder, refused);
    importer.SetIOHandler(access); // which owns it
    if (replacement.bytes) {
        access->replace(path, *replacement.bytes);
    }
    configure(importer);
    const std::string extension = path.extension().string();
    if (extension.empty() || !importer.IsExtensionSupported(extension)) {
        return cannotReadModel(path, "files of this kind are not known",
                               "Choose a model file (OBJ, glTF, GLB, PLY, STL, ...).");
    }
    auto beside = std::async(std::launch::async | std::launch::deferred, readBeside, path);
    if (importer.ReadFile(path.string(), 0) == nullptr) {
        const BesideReading found = beside.get();
        const std::string& why = found.why_bad;
        return cannotReadModel(path, why.empty() ? inPlainWords(importer.GetErrorString()) : why,
                               found.advice);
    }
    ModelConventions conventions = conventionsOf(sceneOf(importer), path, up);
    conventions.origin = replacement.origin;
    Result<ImportedModel> model = takeChecked(importer, path, folder, conventions, beside.get());
    if (!model) {
        return model;
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
        return cannotReadModel(path, inPlainWords(failure.what()), repair);
    }
}

} // namespace

std::size_t ImportedModel::triangleCount() const {
    std::size_t count = 0;
    for (const ImportedMesh& mesh : meshes) {
        count += mesh.placed.mesh->m_F.size();
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
