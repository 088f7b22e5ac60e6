#pragma once

#include "bench/Hills.h"
#include "bench/Timing.h"
#include "engine/scene/SceneContent.h"
#include "examples/pavilion/Pavilion.h"
#include "import/ModelFile.h"

#include <filesystem>
#include <string>
#include <unistd.h>

namespace bench {

/// A folder for the files of this run, which goes away with them.
class WorkFolder {
public:
    WorkFolder()
        : m_path(std::filesystem::temp_directory_path() / ("bench_" + std::to_string(getpid()))) {
        std::filesystem::create_directories(m_path);
    }
    ~WorkFolder() {
        std::error_code ignored;
        std::filesystem::remove_all(m_path, ignored);
    }
    WorkFolder(const WorkFolder&) = delete;
    WorkFolder& operator=(const WorkFolder&) = delete;

    const std::filesystem::path& path() const { return m_path; }

private:
    std::filesystem::path m_path;
};

/// The example model as a document shows it, under the same sun as the hills.
inline quarn::SceneContent pavilionContent() {
    const WorkFolder folder;
    if (!pavilion::write(folder.path()))
        fail("the example model cannot be written");
    const auto model = quarn::readModelFile(folder.path() / "pavilion.obj");
    if (!model)
        fail(model.message());
    quarn::SceneContent content;
    content.revision = 1;
    content.lights.push_back(afternoonSun());
    for (const quarn::ImportedMesh& mesh : model.value().meshes)
        content.meshes.push_back({mesh.placed, KM_CreateUuid()});
    return content;
}

} // namespace bench
