#pragma once

#include "host/import/ModelFile.h"
#include "kelmar/KM_BoundingBox.h"

#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <string>
#include <unistd.h>

namespace quarn::test {

/// A folder of its own for a test, which goes away with it.
class TemporaryFolder {
public:
    TemporaryFolder() {
        std::string pattern = (std::filesystem::temp_directory_path() / "quarn-XXXXXX").string();
        m_path = mkdtemp(pattern.data());
    }
    ~TemporaryFolder() {
        std::error_code ignored;
        std::filesystem::remove_all(m_path, ignored);
    }
    TemporaryFolder(const TemporaryFolder&) = delete;
    TemporaryFolder& operator=(const TemporaryFolder&) = delete;

    const std::filesystem::path& path() const { return m_path; }

    /// Writes a file of the folder, with the folders that lead to it.
    std::filesystem::path write(const std::string& name, std::string_view bytes) const {
        const std::filesystem::path file = m_path / name;
        std::filesystem::create_directories(file.parent_path());
        std::ofstream(file, std::ios::binary)
            .write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
        return file;
    }

private:
    std::filesystem::path m_path;
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
        bounds.Union(mesh.mesh->BoundingBox());
    }
    return bounds;
}

inline void expectNear(const KM_3dPoint& actual, const KM_3dPoint& expected, double tolerance) {
    EXPECT_NEAR(actual.x, expected.x, tolerance);
    EXPECT_NEAR(actual.y, expected.y, tolerance);
    EXPECT_NEAR(actual.z, expected.z, tolerance);
}

} // namespace quarn::test
