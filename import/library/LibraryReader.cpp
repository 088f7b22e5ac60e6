#include "import/library/LibraryReader.h"

#include "import/files/LargeStack.h"
#include "import/files/ModelFileCheck.h"
#include "import/ifc/IfcPlace.h"
#include "import/library/CoordinateShift.h"
#include "import/library/FaceIndexCheck.h"
#include "import/library/GltfExtensions.h"
#include "import/library/GltfLosses.h"
#include "import/library/ModelFileAccess.h"
#include "import/library/PlainWords.h"
#include "import/library/SceneReading.h"
#include "import/library/SceneRepair.h"
#include "import/library/Utf16Text.h"

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

/// The library hands out most formats Y-up, whatever their files say.
TakenUpAxis upAxisOf(const std::string& format, UpAxis asked) {
    if (asked != UpAxis::by_format) {
        return {asked, TakenUpAxis::Reason::asked, {}};
    }
    const bool is_open = isOneOf(format, {"obj", "ply", "stl", "off"});
    const bool is_z = is_open || isOneOf(format, {"3mf", "amf", "blend", "cob", "hmp", "q3o", "q3s",
                                                  "scn", "smd", "vta"});
    return {is_z ? UpAxis::z : UpAxis::y,
            is_open ? TakenUpAxis::Reason::habit : TakenUpAxis::Reason::format,
            {}};
}

ModelConventions conventionsOf(const aiScene& scene, const std::string& format) {
    ModelConventions conventions;
    conventions.keep_normals = !isOneOf(format, {"stl", "blend"});
    conventions.gltf_cameras = isOneOf(format, {"gltf", "glb"});
    conventions.linear_colors = hasLinearColors(scene, format);
    return conventions;
}

UnitSystem unitsOf(const std::string& format) {
    // The library scales what it reads of IFC to metres, whatever the file counts in.
    return isOneOf(format, {"gltf", "glb", "ifc"}) ? UnitSystem::meters : UnitSystem::none;
}

void configure(Assimp::Importer& importer) {
    importer.SetPropertyBool(AI_CONFIG_IMPORT_FBX_PRESERVE_PIVOTS, false);
    importer.SetPropertyBool(AI_CONFIG_IMPORT_FBX_READ_ANIMATIONS, false);
    importer.SetPropertyBool(AI_CONFIG_IMPORT_NO_SKELETON_MESHES, true);
}

/// The reading library tries many spellings of a name; only files that are there deserve a word.
void warnOfRefused(const std::set<std::string>& refused, SourceScene& scene) {
    std::set<fs::path> told;
    for (const std::string& name : refused) {
        const fs::path path = fs::path(name).lexically_normal();
        std::error_code ignored;
        if (fs::is_regular_file(path, ignored) && told.insert(path).second) {
            scene.warnings.push_back("The file '" + path.string() +
                                     "' was not read: it lies outside the model's folder.");
        }
    }
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

Result<SourceScene> takeChecked(Assimp::Importer& importer, const ModelReading& reading,
                                const ModelConventions& conventions, const BesideReading& beside) {
    const fs::path& path = reading.path;
    std::vector<std::string> warnings;
    if (beside.gltf) {
        warnings = tellLostFaces(sceneOf(importer), *beside.gltf);
        for (std::string& sentence : tellUnknownExtensions(*beside.gltf)) {
            warnings.push_back(std::move(sentence));
        }
    }
    const bool is_complete = completeScene(importer, modelFormat(path), warnings);
    if (!is_complete || !beside.why_bad.empty()) {
        const std::string& why = beside.why_bad;
        return cannotReadModel(path, why.empty() ? inPlainWords(importer.GetErrorString()) : why,
                               beside.advice);
    }
    const std::unique_ptr<aiScene> scene(importer.GetOrphanedScene());
    importer.FreeScene();
    SourceScene taken = takeScene(*scene, reading, conventions);
    taken.warnings.insert(taken.warnings.begin(), warnings.begin(), warnings.end());
    return taken;
}

Result<SourceScene> readChecked(const ModelReading& reading) {
    const fs::path& path = reading.path;
    std::set<std::string> refused;
    const Replacement replacement = replacementFor(path);
    Assimp::Importer importer;
    auto* const access = new ModelFileAccess(reading.folder, refused);
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
    const std::string format = modelFormat(path);
    ModelConventions conventions = conventionsOf(sceneOf(importer), format);
    conventions.origin = replacement.origin;
    Result<SourceScene> scene = takeChecked(importer, reading, conventions, beside.get());
    if (!scene) {
        return scene;
    }
    scene.value().units = unitsOf(format);
    if (format == "ifc") {
        scene.value().place = placeOfIfc(reading.bytes);
    }
    scene.value().up = upAxisOf(format, reading.up);
    warnOfRefused(refused, scene.value());
    return scene;
}

} // namespace

Result<SourceScene> readWithLibrary(const ModelReading& reading) {
    Result<SourceScene> scene = SourceScene{};
    runWithLargeStack([&reading, &scene] {
        try {
            scene = readChecked(reading);
        } catch (const std::bad_alloc&) {
            scene =
                cannotReadModel(reading.path, "there is not enough memory", "Use a smaller model.");
        } catch (const std::exception& failure) {
            scene = cannotReadModel(reading.path, inPlainWords(failure.what()), repair);
        }
    });
    return scene;
}

} // namespace quarn
