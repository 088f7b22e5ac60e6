// What it costs that model files are read in a process of their own: a small file, where only the
// start of that process counts, and a large one, whose arrays cross to the host. The baseline is
// the same file read inside this program.
#include "Timing.h"
#include "host/reader/ModelReader.h"
#include "import/ModelFile.h"

#include <algorithm>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <functional>
#include <string>
#include <unistd.h>
#include <vector>

namespace {

namespace fs = std::filesystem;
using namespace quarn;
using namespace bench;

/// A file that goes away at the end.
class BenchFile {
public:
    BenchFile(const char* extension, const std::string& bytes)
        : m_path(fs::temp_directory_path() /
                 ("bench_reader_" + std::to_string(getpid()) + extension)) {
        std::ofstream(m_path, std::ios::binary) << bytes;
    }
    ~BenchFile() { fs::remove(m_path); }
    BenchFile(const BenchFile&) = delete;
    BenchFile& operator=(const BenchFile&) = delete;
    const fs::path& path() const { return m_path; }

private:
    fs::path m_path;
};

template <class T> void add(std::string& bytes, T value) {
    bytes.append(reinterpret_cast<const char*>(&value), sizeof value);
}

/// A binary PLY of a flat field of squares, each of two triangles.
std::string plyOf(std::int32_t squares_a_side) {
    const std::int32_t side = squares_a_side + 1;
    std::string bytes = "ply\nformat binary_little_endian 1.0\nelement vertex " +
                        std::to_string(side * side) +
                        "\nproperty float x\nproperty float y\nproperty float z\nelement face " +
                        std::to_string(2 * squares_a_side * squares_a_side) +
                        "\nproperty list uchar int vertex_indices\nend_header\n";
    for (std::int32_t i = 0; i < side * side; ++i)
        for (const std::int32_t number : {i % side, i / side, (i * 7) % 3})
            add(bytes, static_cast<float>(number));
    for (std::int32_t i = 0; i < squares_a_side * squares_a_side; ++i) {
        const std::int32_t corner = i / squares_a_side * side + i % squares_a_side;
        for (const std::int32_t apex : {corner + 1, corner + side}) {
            add(bytes, std::uint8_t{3});
            for (const std::int32_t vertex : {apex, corner + side + (apex == corner + 1 ? 0 : 1),
                                              apex == corner + 1 ? corner : corner + 1})
                add(bytes, vertex);
        }
    }
    return bytes;
}

/// The middle of so many times, in milliseconds.
double medianOf(int times, const std::function<Result<ImportedModel>()>& read) {
    std::vector<double> taken;
    for (int i = 0; i < times; ++i) {
        const auto start = Clock::now();
        const Result<ImportedModel> model = read();
        taken.push_back(millisecondsSince(start));
        if (!model)
            fail(model.message());
    }
    std::nth_element(taken.begin(), taken.begin() + times / 2, taken.end());
    return taken[static_cast<std::size_t>(times / 2)];
}

void compare(const char* what, const fs::path& path, int times) {
    const double inside = medianOf(times, [&] { return readModelFile(path); });
    const double outside = medianOf(times, [&] { return readModel(path); });
    std::printf("%-28s %10.1f %10.1f %+10.1f\n", what, inside, outside, outside - inside);
}

} // namespace

int main() {
    const BenchFile small(".obj", "o Roof\nv 0 0 0\nv 1 0 0\nv 0 1 0\nf 1 2 3\n");
    const BenchFile square("_square.ply", plyOf(1));
    const BenchFile million(".ply", plyOf(707));
    std::printf("%-28s %10s %10s %10s\n", "reading, ms (median)", "inside", "own process", "cost");
    compare("OBJ, 1 triangle", small.path(), 101);
    compare("binary PLY, 2 triangles", square.path(), 101);
    compare("binary PLY, 1 M triangles", million.path(), 9);
    return 0;
}
