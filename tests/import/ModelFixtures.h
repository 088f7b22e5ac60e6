#pragma once

#include "engine/scene/PlacedMesh.h"
#include "import/ModelFile.h"
#include "kelmar/KM_BoundingBox.h"
#include "tests/support/TempFolder.h"

#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <string>

namespace quarn::test {

/// A folder for model files and what they refer to.
class TemporaryFolder : public TempFolder {
public:
    /// Writes a file of the folder, with the folders that lead to it.
    std::filesystem::path write(const std::string& name, std::string_view bytes) const {
        const std::filesystem::path file = path() / name;
        std::filesystem::create_directories(file.parent_path());
        std::ofstream(file, std::ios::binary)
            .write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
        return file;
    }
};

/// The model, or a failed test and an empty one.
inline ImportedModel readOrFail(const std::filesystem::path& path) {
    Result<ImportedModel> model = readModelFile(path);
    EXPECT_TRUE(model.ok()) << (model.ok() ? "" : model.message());
    return model.ok() ? std::move(model.value()) : ImportedModel{};
}

inline KM_BoundingBox boundsOf(const ImportedModel& model) {
    KM_BoundingBox bounds = KM_BoundingBox::EmptyBoundingBox;
    for (const ImportedMesh& mesh : model.meshes) {
        bounds.Union(mesh.placed.box());
    }
    return bounds;
}

inline void expectNear(const KM_3dPoint& actual, const KM_3dPoint& expected, double tolerance) {
    EXPECT_NEAR(actual.x, expected.x, tolerance);
    EXPECT_NEAR(actual.y, expected.y, tolerance);
    EXPECT_NEAR(actual.z, expected.z, tolerance);
}

} // namespace quarn::test
