#include "import/library/LibraryReader.h"

#include "import/files/FileEnd.h"
#include "import/files/LargeStack.h"
#include "import/files/ModelFileCheck.h"
#include "import/ifc/IfcPlace.h"
#include "import/library/DaeText.h"
#include "import/library/LibraryLosses.h"
#include "import/library/ModelFileAccess.h"
#include "import/library/PlainWords.h"
#include "import/library/SceneReading.h"
#include "import/library/SceneRepair.h"
#include "import/library/Utf16Text.h"

#include <assimp/Importer.hpp>
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

bool isOneOf(std::string_view format, std::initializer_list<std::string_view> formats) {
    return std::find(formats.begin(), formats.end(), format) != formats.end();
}

/// The library hands out most formats Y-up, whatever their files say.
TakenUpAxis upAxisOf(const std::string& format, UpAxis asked) {
    if (asked != UpAxis::by_format) {
        return {asked, TakenUpAxis::Reason::asked, {}};
    }
    const bool is_z =
        isOneOf(format, {"3mf", "amf", "blend", "cob", "hmp", "q3o", "q3s", "scn", "smd", "vta"});
    // What the library hands out Y-up it has turned itself, mostly.
    return is_z ? TakenUpAxis{UpAxis::z, TakenUpAxis::Reason::format, {}}
                : TakenUpAxis{UpAxis::y, TakenUpAxis::Reason::file, {}};
}

ModelConventions conventionsOf(const std::string& format) {
    ModelConventions conventions;
    conventions.keep_normals = format != "blend";
    conventions.gltf_cameras = isOneOf(format, {"gltf", "glb"});
    return conventions;
}

UnitSystem unitsOf(const std::string& format) {
    // The library scales what it reads of IFC to metres, whatever the file counts in.
    return isOneOf(format, {"gltf", "glb", "ifc"}) ? UnitSystem::meters : UnitSystem::none;
}

/// The library reads what there is of a text, and says nothing of what there is not.
bool isCutOff(const std::string& format, std::span<const std::uint8_t> bytes) {
    const std::string_view mark = format == "dxf" ? "EOF" : format == "ifc" ? "END-ISO" : "";
    return endOfFile(bytes).find(mark) == std::string_view::npos;
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

/// The scene is the importer's own, which hands it out as constant only for its users' sake.
aiScene& sceneOf(const Assimp::Importer& importer) {
    return *const_cast<aiScene*>(importer.GetScene());
}

constexpr unsigned STEPS = aiProcess_ValidateDataStructure | aiProcess_Triangulate |
                           aiProcess_SortByPType | aiProcess_GenUVCoords |
                           aiProcess_TransformUVCoords;

/// Turns what was read into triangles, lines and points; false with the importer's error text where
/// it is damaged.
bool completeScene(Assimp::Importer& importer, std::vector<std::string>& warnings) {
    aiScene& scene = sceneOf(importer);
    const std::uint64_t without_corners = repairScene(scene);
    if (without_corners > 0) {
        warnings.push_back(std::to_string(without_corners) +
                           " faces were left out: they have no corners.");
    }
    return scene.mNumMeshes == 0 || importer.ApplyPostProcessing(STEPS) != nullptr;
}

/// @param text  what the importer read
Result<SourceScene> takeChecked(Assimp::Importer& importer, const ModelReading& reading,
                                const std::string& format, std::string_view text) {
    const fs::path& path = reading.path;
    std::vector<std::string> warnings;
    if (!completeScene(importer, warnings))
        return cannotReadModel(path, inPlainWords(importer.GetErrorString()), repair);
    const std::unique_ptr<aiScene> scene(importer.GetOrphanedScene());
    importer.FreeScene();
    if (std::string lost = libraryLossText(format, text, *scene); !lost.empty())
        warnings.push_back(std::move(lost));
    SourceScene taken = takeScene(*scene, reading, conventionsOf(format));
    taken.warnings.insert(taken.warnings.begin(), warnings.begin(), warnings.end());
    return taken;
}

std::string_view textOf(std::span<const std::uint8_t> bytes) {
    return {reinterpret_cast<const char*>(bytes.data()), bytes.size()};
}

/// What the library is given in place of the file; nothing where it may have the file as it is.
std::optional<std::string> replacementOf(const std::string& format, const ModelReading& reading) {
    std::optional<std::string> narrow = utf8OfWideFile(format, reading.bytes);
    if (format == "dae")
        return withoutBlanksBehindTags(narrow ? *narrow : textOf(reading.bytes));
    return narrow;
}

Result<SourceScene> readChecked(const ModelReading& reading) {
    const fs::path& path = reading.path;
    const std::string format = modelFormat(path);
    std::set<std::string> refused;
    const std::optional<std::string> replacement = replacementOf(format, reading);
    Assimp::Importer importer;
    auto* const access = new ModelFileAccess(reading.folder, refused);
    importer.SetIOHandler(access); // which owns it
    if (replacement) {
        access->replace(path, *replacement);
    }
    configure(importer);
    const std::string extension = path.extension().string();
    if (extension.empty() || !importer.IsExtensionSupported(extension)) {
        return cannotReadModel(path, "files of this kind are not known",
                               "Choose a model file (OBJ, glTF, GLB, PLY, STL, ...).");
    }
    if (importer.ReadFile(path.string(), 0) == nullptr)
        return cannotReadModel(path, inPlainWords(importer.GetErrorString()), repair);
    const std::string_view text = replacement ? *replacement : textOf(reading.bytes);
    Result<SourceScene> scene = takeChecked(importer, reading, format, text);
    if (!scene) {
        return scene;
    }
    scene.value().units = unitsOf(format);
    if (format == "ifc") {
        scene.value().place = placeOfIfc(reading.bytes);
    }
    scene.value().up = upAxisOf(format, reading.up);
    if (isCutOff(format, reading.bytes)) {
        scene.value().warnings.emplace_back(CUT_OFF_TEXT);
    }
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
