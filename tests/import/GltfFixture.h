#pragma once

#include "tests/import/ModelFixtures.h"

#include <array>
#include <cstdint>
#include <cstring>
#include <string>
#include <vector>

namespace quarn::test {

/// A glTF file of one square, with a corner for each of four texture coordinates.
struct GltfSquare {
    std::vector<std::array<float, 2>> texture_coordinates{{0, 0}, {1, 0}, {1, 1}, {0, 1}};
    std::vector<std::array<float, 4>> colors; ///< one a corner, or none
    std::array<std::uint32_t, 6> indices{0, 1, 2, 0, 2, 3};
    std::string material = "{}"; ///< JSON
    std::string more;            ///< further top-level JSON, which begins with a comma

    /// Writes it with its bytes beside it.
    std::filesystem::path write(const TemporaryFolder& folder) const {
        std::string bytes;
        std::string views;
        std::string accessors;
        const std::vector<std::array<float, 3>> places{{0, 0, 0}, {1, 0, 0}, {1, 1, 0}, {0, 1, 0}};
        const auto add = [&](const auto& list, const std::string& kind) {
            const std::string index = std::to_string(count(accessors));
            const std::size_t size = list.size() * sizeof(list[0]);
            views += std::string(views.empty() ? "" : ",") + R"({"buffer":0,"byteOffset":)" +
                     std::to_string(bytes.size()) + R"(,"byteLength":)" + std::to_string(size) +
                     "}";
            accessors += std::string(accessors.empty() ? "" : ",") + R"({"bufferView":)" + index +
                         R"(,"count":)" + std::to_string(list.size()) + "," + kind + "}";
            bytes.append(reinterpret_cast<const char*>(list.data()), size);
            return index;
        };
        const std::string indices_at = add(indices, R"("componentType":5125,"type":"SCALAR")");
        std::string attributes =
            R"("POSITION":)" + add(places, R"("componentType":5126,"type":"VEC3",)"
                                           R"("min":[0,0,0],"max":[1,1,0])");
        attributes +=
            R"(,"TEXCOORD_0":)" + add(texture_coordinates, R"("componentType":5126,"type":"VEC2")");
        if (!colors.empty())
            attributes += R"(,"COLOR_0":)" + add(colors, R"("componentType":5126,"type":"VEC4")");
        folder.write("square.bin", bytes);
        return folder.write(
            "square.gltf",
            R"({"asset":{"version":"2.0"},"scene":0,"scenes":[{"nodes":[0]}],"nodes":[{"mesh":0}],)"
            R"("meshes":[{"primitives":[{"material":0,"indices":)" +
                indices_at + R"(,"attributes":{)" + attributes + R"(}}]}],"materials":[)" +
                material + R"(],"accessors":[)" + accessors + R"(],"bufferViews":[)" + views +
                R"(],"buffers":[{"byteLength":)" + std::to_string(bytes.size()) +
                R"(,"uri":"square.bin"}])" + more + "}");
    }

private:
    static std::size_t count(const std::string& accessors) {
        std::size_t found = 0;
        for (std::size_t at = accessors.find("bufferView"); at != std::string::npos;
             at = accessors.find("bufferView", at + 1))
            ++found;
        return found;
    }
};

} // namespace quarn::test
