// Reading a model file of a million triangles, and opening a document with the same triangles, and
// building the scene that is drawn, beside reading the file's bytes alone. Each format is read in a
// program of its own, so that the most memory it ever held is that format's; the best of several
// such programs counts.

#include "engine/display/DisplayScene.h"
#include "host/document/file/DocumentCoding.h"
#include "host/document/file/DocumentExtension.h"
#include "host/document/file/DocumentFile.h"
#include "import/ModelFile.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <chrono>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
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

constexpr int squares_a_side = 707; // 2 * 707 * 707 = 999 698 triangles
constexpr int vertices_a_side = squares_a_side + 1;

/// A rolling landscape over a square grid.
std::array<float, 3> vertexAt(int i, int j) {
    return {0.1F * static_cast<float>(i), 0.1F * static_cast<float>(j),
            std::sin(0.05F * static_cast<float>(i)) * std::cos(0.04F * static_cast<float>(j))};
}

/// Calls `take` with the three vertex numbers, from 0, of each triangle.
template <class Take> void forEachTriangle(Take take) {
    for (int j = 0; j < squares_a_side; ++j) {
        for (int i = 0; i < squares_a_side; ++i) {
            const std::int32_t a = j * vertices_a_side + i;
            take(a, a + 1, a + vertices_a_side + 1);
            take(a, a + vertices_a_side + 1, a + vertices_a_side);
        }
    }
}

std::string plyBytes() {
    std::string bytes = "ply\nformat binary_little_endian 1.0\nelement vertex " +
                        std::to_string(vertices_a_side * vertices_a_side) +
                        "\nproperty float x\nproperty float y\nproperty float z\nelement face " +
                        std::to_string(2 * squares_a_side * squares_a_side) +
                        "\nproperty list uchar int vertex_indices\nend_header\n";
    for (int j = 0; j < vertices_a_side; ++j) {
        for (int i = 0; i < vertices_a_side; ++i) {
            const auto vertex = vertexAt(i, j);
            bytes.append(reinterpret_cast<const char*>(vertex.data()), sizeof vertex);
        }
    }
    forEachTriangle([&bytes](std::int32_t a, std::int32_t b, std::int32_t c) {
        const std::array<std::int32_t, 3> corners{a, b, c};
        bytes += '\3';
        bytes.append(reinterpret_cast<const char*>(corners.data()), sizeof corners);
    });
    return bytes;
}

void appendNumber(std::string& text, float value) {
    std::array<char, 32> digits{};
    const auto end = std::to_chars(digits.data(), digits.data() + digits.size(), value,
                                   std::chars_format::fixed, 6);
    text.append(1, ' ').append(digits.data(), end.ptr);
}

std::string objBytes() {
    std::string text;
    for (int j = 0; j < vertices_a_side; ++j) {
        for (int i = 0; i < vertices_a_side; ++i) {
            text += 'v';
            for (const float number : vertexAt(i, j)) {
                appendNumber(text, number);
            }
            text += '\n';
        }
    }
    forEachTriangle([&text](std::int32_t a, std::int32_t b, std::int32_t c) {
        text += "f " + std::to_string(a + 1) + ' ' + std::to_string(b + 1) + ' ' +
                std::to_string(c + 1) + '\n';
    });
    return text;
}

std::string stlBytes() {
    std::string bytes(80, ' ');
    const std::uint32_t count = 2 * squares_a_side * squares_a_side;
    bytes.append(reinterpret_cast<const char*>(&count), sizeof count);
    forEachTriangle([&bytes](std::int32_t a, std::int32_t b, std::int32_t c) {
        std::array<float, 12> facet{}; // a normal that is not given, then the corners
        int next = 3;
        for (const std::int32_t corner : {a, b, c}) {
            for (const float number : vertexAt(corner % vertices_a_side, corner / vertices_a_side))
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
    double bytes_ms = 1e9;
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

double readBytes(const fs::path& path) {
    const auto start = Clock::now();
    std::ifstream file(path, std::ios::binary);
    std::array<char, 65536> block{};
    unsigned sum = 0;
    while (file.read(block.data(), block.size()) || file.gcount() > 0)
        sum += static_cast<unsigned char>(block[0]);
    const double time = millisecondsSince(start);
    if (sum == 0)
        fail("the file holds nothing");
    return time;
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
    cost.bytes_ms = readBytes(path);
    const auto start = Clock::now();
    const Meshes meshes =
        quarn::isDocumentFile(path) ? meshesOfDocument(path) : meshesOfModel(path);
    cost.load_ms = millisecondsSince(start);
    if (meshes.size() != 1 || meshes[0]->TriangleCount() != 2 * squares_a_side * squares_a_side)
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

/// Lets this program again measure one file.
Cost costInProgramOfItsOwn(const fs::path& path) {
    std::string command("'");
    command.append(fs::read_symlink("/proc/self/exe").string());
    command.append("' '").append(path.string()).append("'");
    FILE* const output = popen(command.c_str(), "r");
    Cost cost;
    if (output == nullptr ||
        std::fscanf(output, "%lf %lf %lf %lf %lf", &cost.bytes_ms, &cost.load_ms, &cost.build_ms,
                    &cost.sum_ms, &cost.peak_mb) != 5)
        fail("a measurement failed");
    pclose(output);
    return cost;
}

void measure(const char* name, const char* extension, const std::string& bytes) {
    constexpr int rounds = 5;
    const BenchFile file(extension, bytes);
    Cost best;
    for (int i = 0; i < rounds; ++i) {
        const Cost cost = costInProgramOfItsOwn(file.path());
        best.bytes_ms = std::min(best.bytes_ms, cost.bytes_ms);
        best.load_ms = std::min(best.load_ms, cost.load_ms);
        best.build_ms = std::min(best.build_ms, cost.build_ms);
        best.sum_ms = std::min(best.sum_ms, cost.sum_ms);
        best.peak_mb = std::max(best.peak_mb, cost.peak_mb);
    }
    std::printf("| %s | %.1f | %.0f | %.0f | %.0f | %.0f | %.0f |\n", name,
                static_cast<double>(bytes.size()) / 1e6, best.bytes_ms, best.load_ms, best.build_ms,
                best.sum_ms, best.peak_mb);
}

} // namespace

int main(int count, char** arguments) {
    if (count == 2) {
        const Cost cost = costHere(arguments[1]);
        std::printf("%f %f %f %f %f\n", cost.bytes_ms, cost.load_ms, cost.build_ms, cost.sum_ms,
                    cost.peak_mb);
        return 0;
    }
    std::printf("%d triangles, milliseconds and megabytes\n\n"
                "| format | file (MB) | bytes alone | load | scene | load + scene | peak (MB) |\n"
                "|---|---|---|---|---|---|---|\n",
                2 * squares_a_side * squares_a_side);
    measure("PLY", ".ply", plyBytes());
    measure("STL", ".stl", stlBytes());
    measure("OBJ", ".obj", objBytes());
    measure("saved document", ".quarn", documentBytes(BenchFile(".ply", plyBytes()).path()));
    return 0;
}
