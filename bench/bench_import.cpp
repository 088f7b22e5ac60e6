// Reading a model file of a million triangles, or of five, and opening a document with the same
// triangles, and building the scene that is drawn. Beside each stands a floor: a program that does
// for this one file what nobody can do without, which is to map it, copy its vertices and indices,
// add the normals of its faces and build a ray scene of them. Each is measured in a program of its
// own, so that the most memory it ever held is that format's; the best of several such programs
// counts.

#include "engine/display/DisplayScene.h"
#include "ground/FileBytes.h"
#include "host/document/file/DocumentCoding.h"
#include "host/document/file/DocumentExtension.h"
#include "host/document/file/DocumentFile.h"
#include "import/ModelFile.h"

#include <embree3/rtcore.h>
#include <tbb/parallel_for.h>

#include <algorithm>
#include <array>
#include <charconv>
#include <chrono>
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
using Clock = std::chrono::steady_clock;

constexpr int million_squares = 707;       // a side: 2 * 707 * 707 = 999 698 triangles
constexpr int five_million_squares = 1581; // likewise 4 999 122

/// A rolling landscape over a square grid.
std::array<float, 3> vertexAt(int i, int j) {
    return {0.1F * static_cast<float>(i), 0.1F * static_cast<float>(j),
            std::sin(0.05F * static_cast<float>(i)) * std::cos(0.04F * static_cast<float>(j))};
}

/// Calls `take` with the three vertex numbers, from 0, of each triangle.
template <class Take> void forEachTriangle(int squares, Take take) {
    const std::int32_t side = squares + 1;
    for (int j = 0; j < squares; ++j) {
        for (int i = 0; i < squares; ++i) {
            const std::int32_t a = j * side + i;
            take(a, a + 1, a + side + 1);
            take(a, a + side + 1, a + side);
        }
    }
}

std::string plyBytes(int squares) {
    std::string bytes = "ply\nformat binary_little_endian 1.0\nelement vertex " +
                        std::to_string((squares + 1) * (squares + 1)) +
                        "\nproperty float x\nproperty float y\nproperty float z\nelement face " +
                        std::to_string(2 * squares * squares) +
                        "\nproperty list uchar int vertex_indices\nend_header\n";
    for (int j = 0; j <= squares; ++j) {
        for (int i = 0; i <= squares; ++i) {
            const auto vertex = vertexAt(i, j);
            bytes.append(reinterpret_cast<const char*>(vertex.data()), sizeof vertex);
        }
    }
    forEachTriangle(squares, [&bytes](std::int32_t a, std::int32_t b, std::int32_t c) {
        const std::array<std::int32_t, 3> corners{a, b, c};
        bytes += '\3';
        bytes.append(reinterpret_cast<const char*>(corners.data()), sizeof corners);
    });
    return bytes;
}

std::string bytesOfNumber(std::size_t number) {
    const auto value = static_cast<std::uint32_t>(number);
    return {reinterpret_cast<const char*>(&value), sizeof value};
}

std::string glbBytes(int squares) {
    std::string binary;
    for (int j = 0; j <= squares; ++j) {
        for (int i = 0; i <= squares; ++i) {
            const auto vertex = vertexAt(i, j);
            binary.append(reinterpret_cast<const char*>(vertex.data()), sizeof vertex);
        }
    }
    const std::string places = std::to_string(binary.size());
    forEachTriangle(squares, [&binary](std::int32_t a, std::int32_t b, std::int32_t c) {
        const std::array<std::int32_t, 3> corners{a, b, c};
        binary.append(reinterpret_cast<const char*>(corners.data()), sizeof corners);
    });
    const std::string all = std::to_string(binary.size());
    std::string text =
        R"({"asset":{"version":"2.0"},"nodes":[{"mesh":0}],"meshes":[{"primitives":[{"indices":1,)"
        R"("attributes":{"POSITION":0}}]}],"accessors":[{"bufferView":0,"componentType":5126,)"
        R"("type":"VEC3","count":)" +
        std::to_string((squares + 1) * (squares + 1)) +
        R"(},{"bufferView":0,"componentType":5125,"type":"SCALAR","byteOffset":)" + places +
        R"(,"count":)" + std::to_string(6 * squares * squares) +
        R"(}],"bufferViews":[{"buffer":0,"byteLength":)" + all + R"(}],"buffers":[{"byteLength":)" +
        all + "}]}";
    text.resize((text.size() + 3) / 4 * 4, ' ');
    return "glTF" + bytesOfNumber(2) + bytesOfNumber(28 + text.size() + binary.size()) +
           bytesOfNumber(text.size()) + "JSON" + text + bytesOfNumber(binary.size()) +
           std::string("BIN\0", 4) + binary;
}

void appendNumber(std::string& text, float value) {
    std::array<char, 32> digits{};
    const auto end = std::to_chars(digits.data(), digits.data() + digits.size(), value,
                                   std::chars_format::fixed, 6);
    text.append(1, ' ').append(digits.data(), end.ptr);
}

std::string objBytes(int squares) {
    std::string text;
    for (int j = 0; j <= squares; ++j) {
        for (int i = 0; i <= squares; ++i) {
            text += 'v';
            for (const float number : vertexAt(i, j)) {
                appendNumber(text, number);
            }
            text += '\n';
        }
    }
    forEachTriangle(squares, [&text](std::int32_t a, std::int32_t b, std::int32_t c) {
        text += "f " + std::to_string(a + 1) + ' ' + std::to_string(b + 1) + ' ' +
                std::to_string(c + 1) + '\n';
    });
    return text;
}

std::string stlBytes(int squares) {
    std::string bytes(80, ' ');
    const auto count = static_cast<std::uint32_t>(2 * squares * squares);
    bytes.append(reinterpret_cast<const char*>(&count), sizeof count);
    forEachTriangle(squares, [&](std::int32_t a, std::int32_t b, std::int32_t c) {
        std::array<float, 12> facet{}; // a normal that is not given, then the corners
        int next = 3;
        for (const std::int32_t corner : {a, b, c}) {
            for (const float number : vertexAt(corner % (squares + 1), corner / (squares + 1)))
                facet[static_cast<std::size_t>(next++)] = number;
        }
        bytes.append(reinterpret_cast<const char*>(facet.data()), sizeof facet);
        bytes.append(2, '\0');
    });
    return bytes;
}

double millisecondsSince(Clock::time_point start) {
    return std::chrono::duration<double, std::milli>(Clock::now() - start).count();
}

[[noreturn]] void fail(std::string_view why) {
    std::fprintf(stderr, "%.*s\n", static_cast<int>(why.size()), why.data());
    std::exit(1);
}

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

Meshes meshesOfModel(const fs::path& path) {
    const auto model = quarn::readModelFile(path);
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
    for (const auto& mesh : meshesOfModel(model)) {
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
Cost costHere(const fs::path& path) {
    Cost cost;
    const auto start = Clock::now();
    const Meshes meshes =
        quarn::isDocumentFile(path) ? meshesOfDocument(path) : meshesOfModel(path);
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

/// Lets this program again measure one file.
/// @param what  "file" or "floor"
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

void measure(const char* name, const char* extension, const std::string& bytes) {
    constexpr int rounds = 5;
    const BenchFile file(extension, bytes);
    const fs::path kind = file.path().extension();
    const bool has_floor = kind == ".ply" || kind == ".glb" || kind == ".stl";
    Cost best;
    Cost floor;
    for (int i = 0; i < rounds; ++i) { // by turns, so that what disturbs the machine meets both
        keepBest(costInProgramOfItsOwn("file", file.path()), best);
        if (has_floor)
            keepBest(costInProgramOfItsOwn("floor", file.path()), floor);
    }
    std::printf("| %s | %.1f | %.0f | %.0f | %.0f | %.0f |", name,
                static_cast<double>(bytes.size()) / 1e6, best.load_ms, best.build_ms, best.sum_ms,
                best.peak_mb);
    if (has_floor)
        std::printf(" %.0f | %.0f | %.2f |\n", floor.sum_ms, floor.peak_mb,
                    best.sum_ms / floor.sum_ms);
    else
        std::printf(" | | |\n");
    std::fflush(stdout);
}

void print(const Cost& cost) {
    std::printf("%f %f %f %f\n", cost.load_ms, cost.build_ms, cost.sum_ms, cost.peak_mb);
}

} // namespace

int main(int count, char** arguments) {
    if (count == 3) {
        print(std::string_view(arguments[1]) == "floor" ? floorHere(arguments[2])
                                                        : costHere(arguments[2]));
        return 0;
    }
    std::printf("Milliseconds and megabytes; the ratio is that of load + scene to the floor's\n\n"
                "| format | file (MB) | load | scene | load + scene | peak (MB) | floor | floor's "
                "peak (MB) | ratio |\n"
                "|---|---|---|---|---|---|---|---|---|\n");
    measure("PLY, 1 M triangles", ".ply", plyBytes(million_squares));
    measure("PLY, 5 M", ".ply", plyBytes(five_million_squares));
    measure("GLB, 1 M", ".glb", glbBytes(million_squares));
    measure("STL, 1 M", ".stl", stlBytes(million_squares));
    measure("STL, 5 M", ".stl", stlBytes(five_million_squares));
    measure("OBJ, 1 M", ".obj", objBytes(million_squares));
    measure("saved document, 1 M", ".quarn",
            documentBytes(BenchFile(".ply", plyBytes(million_squares)).path()));
    return 0;
}
