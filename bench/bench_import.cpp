// Reading a model file of a million triangles, or of five, and opening a document with the same
// triangles, and building the scene that is drawn. Beside each stands a floor: a program that does
// for this one file what nobody can do without, which is to map it, copy its vertices and indices,
// add the normals of its faces and build a ray scene of them. Each is measured in a program of its
// own, so that the most memory it ever held is that format's; the best of several such programs
// counts. The floor of an OBJ and of a document is that of the same triangles in a PLY. A second
// table has the same files read by the program that reads models for the host.

#include "MemoryOfBoth.h"
#include "ModelBytes.h"
#include "Timing.h"
#include "engine/display/DisplayScene.h"
#include "ground/FileBytes.h"
#include "host/document/file/DocumentCoding.h"
#include "host/document/file/DocumentExtension.h"
#include "host/document/file/DocumentFile.h"
#include "host/reader/ModelReader.h"
#include "import/ModelFile.h"

#include <embree3/rtcore.h>
#include <tbb/parallel_for.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <memory>
#include <string>
#include <string_view>
#include <unistd.h>
#include <vector>

namespace {

namespace fs = std::filesystem;
using namespace bench;

/// A file that goes away at the end of its measurement.
class BenchFile {
public:
    BenchFile(const char* extension, const std::string& bytes)
        : m_path(fs::temp_directory_path() /
                 ("bench_import_" + std::to_string(getpid()) + extension)) {
        std::ofstream file(m_path, std::ios::binary);
        file.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
        if (!file.flush())
            fail("the model file cannot be written");
    }
    ~BenchFile() { fs::remove(m_path); }
    BenchFile(const BenchFile&) = delete;
    BenchFile& operator=(const BenchFile&) = delete;

    const fs::path& path() const { return m_path; }

private:
    fs::path m_path;
};

struct Cost {
    double load_ms = 1e9;
    double build_ms = 1e9;
    double sum_ms = 1e9;
    double peak_mb = 0.0;
};

/// The most memory that this program ever held.
double peakMegabytes() {
    std::ifstream status("/proc/self/status");
    std::string word;
    double kilobytes = 0.0;
    while (status >> word) {
        if (word == "VmHWM:")
            status >> kilobytes;
    }
    return kilobytes * 1024.0 / 1e6;
}

using Meshes = std::vector<std::shared_ptr<const KM_Mesh>>;

Meshes meshesOf(const quarn::Result<quarn::ImportedModel>& model) {
    if (!model)
        fail(model.message());
    Meshes meshes;
    for (const auto& mesh : model.value().meshes)
        meshes.push_back(mesh.placed.mesh);
    return meshes;
}

Meshes meshesOfDocument(const fs::path& path) {
    const auto content = quarn::readDocumentFile(path);
    if (!content)
        fail(content.message());
    Meshes meshes;
    for (const auto& object : content.value().objects)
        meshes.push_back(object.placed.mesh);
    return meshes;
}

/// The document that has in it what a model file has in it.
std::string documentBytes(const fs::path& model) {
    quarn::DocumentContent content;
    for (const auto& mesh : meshesOf(quarn::readModelFile(model))) {
        quarn::ObjectContent object;
        object.id = KM_CreateUuid();
        object.placed.mesh = mesh;
        content.objects.push_back(object);
    }
    const auto bytes = quarn::encodeDocument(content);
    if (!bytes)
        fail(bytes.message());
    return {bytes.value().begin(), bytes.value().end()};
}

/// What reading the file and building its scene cost this program.
/// @param read  to meshes
template <class Read> Cost costHere(const fs::path& path, const Read& read) {
    Cost cost;
    const auto start = Clock::now();
    const Meshes meshes = read(path);
    cost.load_ms = millisecondsSince(start);
    if (meshes.size() != 1 || meshes[0]->TriangleCount() < 2 * million_squares * million_squares)
        fail("the model was not read whole");
    const auto loaded = Clock::now();
    quarn::SceneContent content;
    content.revision = 1;
    for (const auto& mesh : meshes)
        content.meshes.push_back({{mesh, nullptr, {}}, KM_CreateUuid()});
    quarn::DisplayScene scene;
    if (!scene.update(content))
        fail("the scene was not built");
    cost.build_ms = millisecondsSince(loaded);
    cost.sum_ms = millisecondsSince(start);
    cost.peak_mb = peakMegabytes();
    return cost;
}

/// What the floor has of a file.
struct FloorMesh {
    std::vector<std::array<float, 3>> vertices;
    std::vector<std::array<std::uint32_t, 3>> triangles;
};

/// A floor knows where everything lies in the files that this program writes.
FloorMesh floorOfPly(const char* bytes) {
    const char* const vertices = std::strstr(bytes, "end_header\n") + 11;
    FloorMesh mesh;
    mesh.vertices.resize(std::strtoul(std::strstr(bytes, "vertex ") + 7, nullptr, 10));
    mesh.triangles.resize(std::strtoul(std::strstr(bytes, "face ") + 5, nullptr, 10));
    std::memcpy(mesh.vertices.data(), vertices, 12 * mesh.vertices.size());
    const char* const faces = vertices + 12 * mesh.vertices.size();
    tbb::parallel_for(std::size_t{0}, mesh.triangles.size(), [&](std::size_t i) {
        std::memcpy(mesh.triangles[i].data(), faces + 13 * i + 1, 12);
    });
    return mesh;
}

FloorMesh floorOfGlb(const char* bytes) {
    std::uint32_t text_length = 0;
    std::memcpy(&text_length, bytes + 12, sizeof text_length);
    const char* const binary = bytes + 28 + text_length;
    FloorMesh mesh;
    mesh.vertices.resize(std::strtoul(std::strstr(bytes + 20, "VEC3") + 14, nullptr, 10));
    mesh.triangles.resize(
        std::strtoul(std::strstr(std::strstr(bytes + 20, "SCALAR"), "count") + 7, nullptr, 10) / 3);
    std::memcpy(mesh.vertices.data(), binary, 12 * mesh.vertices.size());
    std::memcpy(mesh.triangles.data(), binary + 12 * mesh.vertices.size(),
                12 * mesh.triangles.size());
    return mesh;
}

FloorMesh floorOfStl(const char* bytes) {
    std::uint32_t count = 0;
    std::memcpy(&count, bytes + 80, sizeof count);
    FloorMesh mesh;
    mesh.vertices.resize(std::size_t{3} * count);
    mesh.triangles.resize(count);
    tbb::parallel_for(std::uint32_t{0}, count, [&](std::uint32_t i) {
        std::memcpy(mesh.vertices[std::size_t{3} * i].data(), bytes + 84 + std::size_t{50} * i + 12,
                    36);
        mesh.triangles[i] = {3 * i, 3 * i + 1, 3 * i + 2};
    });
    return mesh;
}

std::vector<std::array<float, 3>> faceNormals(const FloorMesh& mesh) {
    std::vector<std::array<float, 3>> normals(mesh.triangles.size());
    tbb::parallel_for(std::size_t{0}, normals.size(), [&](std::size_t i) {
        const auto& a = mesh.vertices[mesh.triangles[i][0]];
        const auto& b = mesh.vertices[mesh.triangles[i][1]];
        const auto& c = mesh.vertices[mesh.triangles[i][2]];
        const float u[3] = {b[0] - a[0], b[1] - a[1], b[2] - a[2]};
        const float v[3] = {c[0] - a[0], c[1] - a[1], c[2] - a[2]};
        const float n[3] = {u[1] * v[2] - u[2] * v[1], u[2] * v[0] - u[0] * v[2],
                            u[0] * v[1] - u[1] * v[0]};
        const float length = std::sqrt(n[0] * n[0] + n[1] * n[1] + n[2] * n[2]);
        normals[i] = {n[0] / length, n[1] / length, n[2] / length};
    });
    return normals;
}

void commitRays(FloorMesh& mesh) {
    mesh.vertices.reserve(mesh.vertices.size() + 1); // vertices are read as 16 bytes
    RTCDevice device = rtcNewDevice("threads=2");
    RTCScene scene = rtcNewScene(device);
    RTCGeometry geometry = rtcNewGeometry(device, RTC_GEOMETRY_TYPE_TRIANGLE);
    rtcSetSharedGeometryBuffer(geometry, RTC_BUFFER_TYPE_VERTEX, 0, RTC_FORMAT_FLOAT3,
                               mesh.vertices.data(), 0, 12, mesh.vertices.size());
    rtcSetSharedGeometryBuffer(geometry, RTC_BUFFER_TYPE_INDEX, 0, RTC_FORMAT_UINT3,
                               mesh.triangles.data(), 0, 12, mesh.triangles.size());
    rtcCommitGeometry(geometry);
    rtcAttachGeometry(scene, geometry);
    rtcCommitScene(scene);
    if (rtcGetDeviceError(device) != RTC_ERROR_NONE)
        fail("the floor's ray scene was not built");
    rtcReleaseGeometry(geometry);
    rtcReleaseScene(scene);
    rtcReleaseDevice(device);
}

Cost floorHere(const fs::path& path) {
    Cost cost;
    const auto start = Clock::now();
    const auto file = quarn::mapFile(path);
    if (!file)
        fail(file.message());
    const auto* const bytes = reinterpret_cast<const char*>(file.value().bytes().data());
    FloorMesh mesh = path.extension() == ".ply"   ? floorOfPly(bytes)
                     : path.extension() == ".glb" ? floorOfGlb(bytes)
                                                  : floorOfStl(bytes);
    const auto normals = faceNormals(mesh);
    cost.load_ms = millisecondsSince(start);
    const auto loaded = Clock::now();
    commitRays(mesh);
    cost.build_ms = millisecondsSince(loaded);
    cost.sum_ms = millisecondsSince(start);
    cost.peak_mb = peakMegabytes();
    return cost;
}

Cost costInside(const fs::path& path) {
    return costHere(path, [](const fs::path& file) {
        return quarn::isDocumentFile(file) ? meshesOfDocument(file)
                                           : meshesOf(quarn::readModelFile(file));
    });
}

/// The model is read by the program that reads models.
Cost costOfBoth(const fs::path& path) {
    return costHere(path, [](const fs::path& file) { return meshesOf(quarn::readModel(file)); });
}

/// The same, with the memory of both programs; to look at it takes time.
Cost memoryOfBoth(const fs::path& path) {
    MemoryWatch watch;
    Cost cost = costOfBoth(path);
    cost.peak_mb = watch.peakMegabytes();
    return cost;
}

/// Lets this program again measure one file.
/// @param what  as main has it
Cost costInProgramOfItsOwn(const char* what, const fs::path& path) {
    std::string command("'");
    command.append(fs::read_symlink("/proc/self/exe").string());
    command.append("' ").append(what).append(" '").append(path.string()).append("'");
    FILE* const output = popen(command.c_str(), "r");
    Cost cost;
    if (output == nullptr || std::fscanf(output, "%lf %lf %lf %lf", &cost.load_ms, &cost.build_ms,
                                         &cost.sum_ms, &cost.peak_mb) != 4)
        fail("a measurement failed");
    pclose(output);
    return cost;
}

void keepBest(const Cost& cost, Cost& best) {
    best.load_ms = std::min(best.load_ms, cost.load_ms);
    best.build_ms = std::min(best.build_ms, cost.build_ms);
    best.sum_ms = std::min(best.sum_ms, cost.sum_ms);
    best.peak_mb = std::max(best.peak_mb, cost.peak_mb);
}

/// All that is measured of a file.
struct Row {
    const char* name;
    double file_mb = 0.0;
    Cost inside;
    Cost floor;
    Cost both; ///< of a document, which the host reads itself, as it is at first
};

/// @param bytes        of the file
/// @param floor_bytes  of the file of the floor, where it is another one: a PLY
Row measure(const char* name, const char* extension, const std::string& bytes,
            const std::string& floor_bytes = {}) {
    constexpr int rounds = 5;
    const BenchFile file(extension, bytes);
    const BenchFile floor_file(".floor.ply", floor_bytes);
    const fs::path& floor_path = floor_bytes.empty() ? file.path() : floor_file.path();
    const bool is_document = quarn::isDocumentFile(file.path());
    Row row{name, static_cast<double>(bytes.size()) / 1e6, {}, {}, {}};
    for (int i = 0; i < rounds; ++i) { // by turns, so that what disturbs the machine meets all
        keepBest(costInProgramOfItsOwn("file", file.path()), row.inside);
        keepBest(costInProgramOfItsOwn("floor", floor_path), row.floor);
        if (!is_document)
            keepBest(costInProgramOfItsOwn("both", file.path()), row.both);
    }
    if (!is_document)
        row.both.peak_mb = costInProgramOfItsOwn("memory", file.path()).peak_mb;
    return row;
}

void printInside(const std::vector<Row>& rows) {
    std::printf("Milliseconds and megabytes; the ratio is that of load + scene to the floor's\n\n"
                "| format | file (MB) | load | MB/s | scene | load + scene | peak (MB) | floor | "
                "floor's peak (MB) | ratio |\n"
                "|---|---|---|---|---|---|---|---|---|---|\n");
    for (const Row& row : rows)
        std::printf("| %s | %.1f | %.0f | %.0f | %.0f | %.0f | %.0f | %.0f | %.0f | %.2f |\n",
                    row.name, row.file_mb, row.inside.load_ms,
                    1e3 * row.file_mb / row.inside.load_ms, row.inside.build_ms, row.inside.sum_ms,
                    row.inside.peak_mb, row.floor.sum_ms, row.floor.peak_mb,
                    row.inside.sum_ms / row.floor.sum_ms);
}

void printBoth(const std::vector<Row>& rows) {
    std::printf("\nThe same, read in a process of its own; the peak is that of both\n\n"
                "| read in its own process | load | load + scene | peak of both (MB) | ratio |\n"
                "|---|---|---|---|---|\n");
    for (const Row& row : rows)
        if (row.both.peak_mb > 0.0)
            std::printf("| %s | %.0f | %.0f | %.0f | %.2f |\n", row.name, row.both.load_ms,
                        row.both.sum_ms, row.both.peak_mb, row.both.sum_ms / row.floor.sum_ms);
}

/// @param what  "file", "floor", "both" or "memory"
Cost costOf(std::string_view what, const fs::path& path) {
    if (what == "floor")
        return floorHere(path);
    if (what == "both")
        return costOfBoth(path);
    return what == "memory" ? memoryOfBoth(path) : costInside(path);
}

} // namespace

int main(int count, char** arguments) {
    if (count == 3) {
        const Cost cost = costOf(arguments[1], arguments[2]);
        std::printf("%f %f %f %f\n", cost.load_ms, cost.build_ms, cost.sum_ms, cost.peak_mb);
        return 0;
    }
    const std::string million = plyBytes(million_squares);
    std::vector<Row> rows;
    rows.push_back(measure("PLY, 1 M triangles", ".ply", million));
    rows.push_back(measure("PLY, 5 M", ".ply", plyBytes(five_million_squares)));
    rows.push_back(measure("GLB, 1 M", ".glb", glbBytes(million_squares)));
    rows.push_back(measure("STL, 1 M", ".stl", stlBytes(million_squares)));
    rows.push_back(measure("STL, 5 M", ".stl", stlBytes(five_million_squares)));
    rows.push_back(measure("OBJ, 1 M", ".obj", objBytes(million_squares), million));
    rows.push_back(measure("saved document, 1 M", ".quarn",
                           documentBytes(BenchFile(".ply", million).path()), million));
    printInside(rows);
    printBoth(rows);
    return 0;
}
