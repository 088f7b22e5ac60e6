// Reading a model file of a million triangles, beside reading its bytes alone.

#include "host/import/ModelFile.h"

#include <benchmark/benchmark.h>

#include <array>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <string>
#include <unistd.h>
#include <vector>

namespace {

namespace fs = std::filesystem;

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

/// A file that goes away at the end of its benchmark.
class BenchFile {
public:
    BenchFile(const char* extension, const std::string& bytes)
        : m_path(fs::temp_directory_path() /
                 ("bench_import_" + std::to_string(getpid()) + extension)) {
        std::ofstream(m_path, std::ios::binary)
            .write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
    }
    ~BenchFile() { fs::remove(m_path); }
    BenchFile(const BenchFile&) = delete;
    BenchFile& operator=(const BenchFile&) = delete;

    const fs::path& path() const { return m_path; }

private:
    fs::path m_path;
};

void readModel(benchmark::State& state, const char* extension, const std::string& bytes) {
    const BenchFile file(extension, bytes);
    for ([[maybe_unused]] const auto pass : state) {
        auto model = quarn::readModelFile(file.path());
        if (!model || model.value().triangleCount() != 999'698) {
            state.SkipWithError("the model was not read whole");
            break;
        }
        benchmark::DoNotOptimize(model);
    }
}

void readBytes(benchmark::State& state, const char* extension, const std::string& bytes) {
    const BenchFile file(extension, bytes);
    std::vector<char> buffer(bytes.size());
    for ([[maybe_unused]] const auto pass : state) {
        std::ifstream stream(file.path(), std::ios::binary);
        stream.read(buffer.data(), static_cast<std::streamsize>(buffer.size()));
        benchmark::DoNotOptimize(buffer.data());
        benchmark::ClobberMemory();
    }
}

void readPly(benchmark::State& state) {
    readModel(state, ".ply", plyBytes());
}
void readPlyBytes(benchmark::State& state) {
    readBytes(state, ".ply", plyBytes());
}
void readObj(benchmark::State& state) {
    readModel(state, ".obj", objBytes());
}
void readObjBytes(benchmark::State& state) {
    readBytes(state, ".obj", objBytes());
}

BENCHMARK(readPly)->Unit(benchmark::kMillisecond)->UseRealTime();
BENCHMARK(readPlyBytes)->Unit(benchmark::kMillisecond)->UseRealTime();
BENCHMARK(readObj)->Unit(benchmark::kMillisecond)->UseRealTime();
BENCHMARK(readObjBytes)->Unit(benchmark::kMillisecond)->UseRealTime();

} // namespace

BENCHMARK_MAIN();
