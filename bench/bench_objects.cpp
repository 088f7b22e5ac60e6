// Many objects: 20 000 boxes of an OBJ file, and 10 000 places of one mesh. Reading, building the
// scene, drawing a frame, and hiding or showing one object, beside building the whole scene again.
// Memory is what the program holds more than before; what the boxes gave back may serve the copies.

#include "bench/Timing.h"
#include "engine/display/DisplayPipeline.h"
#include "engine/display/DisplayScene.h"
#include "import/ModelFile.h"
#include "kelmar/KM_Viewport.h"

#include <cmath>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <memory>
#include <string>
#include <unistd.h>
#include <utility>

namespace {

using quarn::SceneContent;

double heldMegabytes() {
    std::ifstream status("/proc/self/status");
    for (std::string word; status >> word;) {
        double kilobytes = 0.0;
        if (word == "VmRSS:" && status >> kilobytes)
            return kilobytes / 1024.0;
    }
    return 0.0;
}

/// Boxes of various heights on a square grid, each an object of its own.
void writeBoxes(const std::filesystem::path& path, int count) {
    std::ofstream file(path);
    const int side = static_cast<int>(std::ceil(std::sqrt(count)));
    for (int i = 0; i < count; ++i) {
        file << "o box" << i << '\n';
        for (int corner = 0; corner < 8; ++corner)
            file << "v " << 2 * (i % side) + (corner & 1) << ' '
                 << 2 * (i / side) + (corner >> 1 & 1) << ' ' << (corner >> 2) * (1 + i % 5)
                 << '\n';
        file << "f -8 -6 -5 -7\nf -4 -3 -1 -2\nf -8 -7 -3 -4\nf -6 -2 -1 -5\nf -8 -4 -2 -6\n"
                "f -7 -5 -1 -3\n";
    }
}

SceneContent contentOf(const quarn::ImportedModel& model) {
    SceneContent content;
    for (const quarn::ImportedMesh& mesh : model.meshes)
        content.meshes.push_back({mesh.placed, KM_CreateUuid()});
    return content;
}

/// The first mesh of a content at many places.
SceneContent repeated(const SceneContent& content, int count) {
    SceneContent copies;
    const int side = static_cast<int>(std::ceil(std::sqrt(count)));
    for (int i = 0; i < count; ++i) {
        copies.meshes.push_back(content.meshes.front());
        copies.meshes.back().id = KM_CreateUuid();
        copies.meshes.back().placed.world_from_mesh =
            KM_Xform::Translation(KM_3dVector(3.0 * (i % side), 3.0 * (i / side), 0.0));
    }
    return copies;
}

double frameMilliseconds(const quarn::DisplayScene& scene) {
    const KM_BoundingBox& box = scene.boundingBox();
    const double size = box.Diagonal().Length();
    const KM_3dPoint eye = box.Center() + KM_3dVector(-0.5 * size, -0.5 * size, 0.4 * size);
    KM_Viewport viewport;
    viewport.SetProjection(KM_perspective_view);
    viewport.SetTargetPoint(box.Center());
    viewport.SetCameraLocation(eye);
    viewport.SetCameraDirection(box.Center() - eye);
    viewport.SetCameraUp(KM_3dVector::ZAxis);
    quarn::DisplayPipeline pipeline;
    quarn::Image image;
    const quarn::DisplayModeAttributes* const mode =
        quarn::findDisplayMode(quarn::rendered_mode_id);
    double best = 1e300;
    bench::repeatFor(1000.0, [&] {
        bench::keepBest(
            best, [&] { bench::require(pipeline.draw(scene, viewport, *mode, 1280, 720, image)); });
    });
    return best;
}

/// Hides or shows the object in the middle of the list, again and again.
double switchMilliseconds(quarn::DisplayScene& scene, SceneContent& content) {
    double best = 1e300;
    bench::repeatFor(1000.0, [&] {
        bool& visible = content.meshes[content.meshes.size() / 2].visible;
        visible = !visible;
        bench::keepBest(best, [&] { bench::require(scene.update(content)); });
    });
    return best;
}

double rebuildMilliseconds(quarn::DisplayScene& scene, SceneContent& content) {
    double best = 1e300;
    bench::repeatFor(1000.0, [&] {
        ++content.revision;
        bench::keepBest(best, [&] { bench::require(scene.update(content)); });
    });
    return best;
}

void printRow(const char* objects, const std::string& read_ms, SceneContent& content,
              double held_before) {
    quarn::DisplayScene scene;
    double build_ms = 1e300;
    ++content.revision;
    bench::keepBest(build_ms, [&] { bench::require(scene.update(content)); });
    const double held = heldMegabytes() - held_before;
    const double frame_ms = frameMilliseconds(scene);
    const double switch_ms = switchMilliseconds(scene, content);
    const double rebuild_ms = rebuildMilliseconds(scene, content);
    std::printf("| %s | %s | %.0f | %.1f | %.2f | %.1f | %.3f | %.0f |\n", objects, read_ms.c_str(),
                build_ms, frame_ms, switch_ms, rebuild_ms, switch_ms / rebuild_ms, held);
    std::fflush(stdout);
}

} // namespace

int main() {
    const std::filesystem::path path = std::filesystem::temp_directory_path() /
                                       ("bench_objects_" + std::to_string(getpid()) + ".obj");
    writeBoxes(path, 20'000);
    std::printf(
        "| objects | read ms | build ms | frame ms | hide one ms | build again ms | ratio | "
        "MB |\n|---|---|---|---|---|---|---|---|\n");
    const double held_before = heldMegabytes();
    const auto start = bench::Clock::now();
    quarn::Result<quarn::ImportedModel> model = quarn::readModelFile(path);
    const double read_ms = bench::millisecondsSince(start);
    std::filesystem::remove(path);
    if (!model)
        bench::fail(model.message());
    SceneContent boxes = contentOf(model.value());
    if (boxes.meshes.size() != 20'000)
        bench::fail("not all boxes were read");
    printRow("20 000 boxes", std::to_string(std::lround(read_ms)), boxes, held_before);
    const double held_by_boxes = heldMegabytes();
    SceneContent copies = repeated(boxes, 10'000);
    printRow("10 000 places of one box", "-", copies, held_by_boxes);
    return 0;
}
