#include "tests/quarn/Models.h"

#include <array>
#include <sstream>

namespace quarn::test {

namespace {

using Corner = std::array<double, 3>;

/// A box as twelve triangles that look outward.
void addBox(std::ostream& obj, const char* name, const Corner& low, const Corner& high,
            int vertices_before) {
    obj << "o " << name << "\n";
    for (int corner = 0; corner < 8; ++corner)
        obj << "v " << (corner & 1 ? high : low)[0] << " " << (corner & 2 ? high : low)[1] << " "
            << (corner & 4 ? high : low)[2] << "\n";
    constexpr int FACES[6][4] = {{0, 2, 3, 1}, {4, 5, 7, 6}, {0, 1, 5, 4},
                                 {2, 6, 7, 3}, {0, 4, 6, 2}, {1, 3, 7, 5}};
    for (const auto& face : FACES) {
        const auto vertex = [&](int i) { return vertices_before + face[i] + 1; };
        obj << "f " << vertex(0) << " " << vertex(1) << " " << vertex(2) << "\n";
        obj << "f " << vertex(0) << " " << vertex(2) << " " << vertex(3) << "\n";
    }
}

} // namespace

void writeHouse(const std::filesystem::path& obj_file) {
    std::ostringstream obj;
    addBox(obj, "hall", {0, 0, 0}, {4, 2, 1}, 0);
    addBox(obj, "tower", {0, 0, 1}, {1, 1, 4}, 8);
    writeFile(obj_file, obj.str());
}

} // namespace quarn::test
