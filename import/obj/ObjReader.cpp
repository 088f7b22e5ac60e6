#include "import/obj/ObjReader.h"

#include "import/WritingProgram.h"
#include "import/assembly/CornerPieces.h"
#include "import/files/ModelFileCheck.h"
#include "import/obj/ObjContent.h"
#include "import/obj/ObjMaterials.h"
#include "import/text/FileText.h"

#include <utility>

namespace quarn {

namespace {

/// The programs' exporters write so unless they are told otherwise.
TakenUpAxis upOf(const ModelReading& reading, std::string_view text) {
    constexpr std::size_t BYTES_OF_HEAD = 1024;
    return upAxisOf(reading.up, text.substr(0, BYTES_OF_HEAD),
                    {{"# Blender", "Blender", UpAxis::y},
                     {"# Exported from Wings 3D", "Wings 3D", UpAxis::y},
                     {"# This file uses centimeters as units for non-parametric coordinates",
                      "Maya", UpAxis::y}});
}

Result<SourceScene> sceneOf(const ObjContent& content, const ModelReading& reading) {
    SourceScene scene;
    ObjMaterials materials(reading, scene.warnings);
    materials.readLibraries(content.libraries);
    const CornerTables tables{content.places, content.textures, content.normals, content.colors};
    CornerPieces pieces(tables, reading, scene);
    for (const ObjPiece& piece : content.pieces) {
        const ObjMaterial& material = materials.at(piece.material);
        SourceMesh mesh;
        mesh.name = KM_wString::FromUtf8(piece.name);
        mesh.material = material.material;
        const Result<void> added =
            pieces.add(piece.elements, std::move(mesh), material.texture_place);
        if (!added)
            return added.error();
    }
    if (content.pieces.empty())
        pieces.addAllAsPoints();
    materials.tellMissing();
    pieces.tellDropped();
    scene.warnings.insert(scene.warnings.end(), content.faults.begin(), content.faults.end());
    return scene;
}

} // namespace

Result<SourceScene> readObj(const ModelReading& reading) {
    const auto failed = [&reading](const std::string& why) {
        return cannotReadModel(reading.path, why, "Use a smaller model.");
    };
    const Result<FileText> file = FileText::of(reading.bytes, reading.budget);
    if (!file)
        return failed(file.message());
    const std::string_view text = file.value().text();
    const Result<ObjContent> content = readObjContent(text, reading);
    if (!content)
        return failed(content.message());
    Result<SourceScene> scene = sceneOf(content.value(), reading);
    if (!scene)
        return failed(scene.message());
    scene.value().up = upOf(reading, text);
    return scene;
}

} // namespace quarn
