#pragma once

#include "engine/scene/MaterialCheck.h"
#include "import/ModelReading.h"
#include "import/assembly/ModelAssembly.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstdlib>
#include <filesystem>
#include <utility>

/// What the fuzz targets of model files hold every reader to.
namespace promises {

// A broken promise ends the program, which is how a fuzzer learns of it.
inline void require(bool promise) {
    if (!promise)
        std::abort();
}

class NobodyWatches final : public quarn::ReadingWatch {
    bool goesOn(quarn::ReadingStep, double) override { return true; }
};

inline void check(const KM_Mesh& mesh) {
    for (const KM_3fPoint& p : mesh.m_V)
        require(std::isfinite(p.x) && std::isfinite(p.y) && std::isfinite(p.z));
    for (const std::size_t count : {mesh.m_N.size(), mesh.m_T.size(), mesh.m_C.size()})
        require(count == 0 || count == mesh.m_V.size());
    for (const KM_MeshTriangle& triangle : mesh.m_F)
        require(
            std::ranges::all_of(triangle.vi, [&](std::uint32_t v) { return v < mesh.m_V.size(); }));
}

inline void check(const quarn::Material* material) {
    quarn::Material drawable = material != nullptr ? *material : quarn::Material();
    require(quarn::makeDrawable(drawable).empty());
}

inline void check(const quarn::SourceScene& scene) {
    for (const quarn::SourcePlace& place : scene.places)
        require(place.mesh < scene.meshes.size());
    for (const quarn::SourceMesh& mesh : scene.meshes)
        if (mesh.mesh)
            check(*mesh.mesh);
    for (const KM_Light& light : scene.lights)
        require(light.Intensity() <= 1.0);
}

/// The bytes are refused with a reason that names the file, or make a scene whose indices name
/// vertices, whose vertices are finite and of which a model can be made with materials that can be
/// drawn.
/// @param path  of a file that is not there, so that only these bytes are read
inline void keep(quarn::Result<quarn::SourceScene> (*read)(const quarn::ModelReading& reading),
                 const std::filesystem::path& path, const std::uint8_t* bytes, std::size_t size) {
    const quarn::ModelFolder folder(path);
    quarn::ReadingBudget budget(64U << 20);
    NobodyWatches watch;
    const quarn::ModelReading reading{path, {bytes, size}, folder, quarn::UpAxis::by_format,
                                      0.0,  budget,        watch};
    quarn::Result<quarn::SourceScene> scene = read(reading);
    if (!scene) {
        require(scene.message().starts_with("Cannot read '" + path.string() + "'"));
        return;
    }
    check(scene.value());
    const auto model = quarn::assembleModel(std::move(scene.value()), reading);
    require(model.ok() || !model.message().empty());
    if (model)
        for (const quarn::ImportedMesh& mesh : model.value().meshes)
            check(mesh.placed.material.get());
}

} // namespace promises
