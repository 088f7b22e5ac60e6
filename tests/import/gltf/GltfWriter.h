#pragma once

#include "tests/import/ModelFixtures.h"

#include <nlohmann/json.hpp>

#include <cstdint>
#include <string>
#include <vector>

namespace quarn::test {

/// A GLB file that is put together piece by piece.
class GltfWriter {
public:
    using Json = nlohmann::json;

    /// The description; "bufferViews" and "accessors" are filled here, the rest by the test.
    Json json = {{"asset", {{"version", "2.0"}}}};

    template <class T> static std::string bytesOf(const std::vector<T>& list) {
        return {reinterpret_cast<const char*>(list.data()), list.size() * sizeof(T)};
    }

    /// @return the number of the view
    std::size_t view(const std::string& bytes, int stride = 0) {
        m_binary.resize((m_binary.size() + 3) / 4 * 4);
        Json view = {{"buffer", 0}, {"byteOffset", m_binary.size()}, {"byteLength", bytes.size()}};
        if (stride > 0)
            view["byteStride"] = stride;
        m_binary += bytes;
        json["bufferViews"].push_back(std::move(view));
        return json["bufferViews"].size() - 1;
    }

    /// @return the number of the accessor
    std::size_t accessor(std::size_t view, std::size_t count, const char* type, int component_type,
                         bool normalized = false) {
        Json accessor = {{"bufferView", view},
                         {"count", count},
                         {"type", type},
                         {"componentType", component_type}};
        if (normalized)
            accessor["normalized"] = true;
        json["accessors"].push_back(std::move(accessor));
        return json["accessors"].size() - 1;
    }

    std::size_t floats(const std::vector<float>& numbers, const char* type) {
        return accessor(view(bytesOf(numbers)), numbers.size() / componentsOf(type), type, 5126);
    }

    std::size_t indices(const std::vector<std::uint32_t>& numbers) {
        return accessor(view(bytesOf(numbers)), numbers.size(), "SCALAR", 5125);
    }

    /// A mesh of one triangle in the plane z = 0, on a node of its own.
    void triangle() {
        mesh({{"attributes", {{"POSITION", floats({0, 0, 0, 1, 0, 0, 0, 1, 0}, "VEC3")}}}});
    }

    /// A mesh of one primitive, on a node of its own.
    void mesh(Json primitive) {
        json["meshes"].push_back({{"primitives", Json::array({std::move(primitive)})}});
        json["nodes"].push_back({{"mesh", json["meshes"].size() - 1}});
    }

    Json& primitive() { return json["meshes"][0]["primitives"][0]; }
    Json& node() { return json["nodes"][0]; }

    std::string glb() const {
        Json whole = json;
        if (!whole.contains("buffers"))
            whole["buffers"] = Json::array({{{"byteLength", m_binary.size()}}});
        std::string text = whole.dump();
        text.resize((text.size() + 3) / 4 * 4, ' ');
        std::string binary = m_binary;
        binary.resize((binary.size() + 3) / 4 * 4);
        return "glTF" + number(2) + number(28 + text.size() + binary.size()) + number(text.size()) +
               "JSON" + text + number(binary.size()) + std::string("BIN\0", 4) + binary;
    }

    std::filesystem::path write(const TemporaryFolder& folder) const {
        return folder.write("model.glb", glb());
    }

    ImportedModel read() const {
        const TemporaryFolder folder;
        return readOrFail(write(folder));
    }

    /// The message with which it is refused.
    std::string refusal(ReadingOptions options = {}) const {
        const TemporaryFolder folder;
        const Result<ImportedModel> model = readModelFile(write(folder), options);
        EXPECT_FALSE(model.ok());
        return model.ok() ? "" : model.message();
    }

private:
    static std::size_t componentsOf(std::string_view type) {
        return type == "SCALAR" ? 1
               : type == "MAT4" ? 16
                                : static_cast<std::size_t>(type.back() - '0');
    }

    static std::string number(std::size_t value) {
        std::string bytes;
        for (int i = 0; i < 4; ++i)
            bytes += static_cast<char>(value >> (8 * i) & 255);
        return bytes;
    }

    std::string m_binary;
};

/// Expects a mesh's vertices in the order of its triangles' corners, in the file's axes (y up).
inline void expectCorners(const ImportedMesh& object, const std::vector<KM_3dPoint>& corners,
                          double tolerance = 1e-6) {
    const KM_Mesh& mesh = *object.placed.mesh;
    ASSERT_EQ(3 * mesh.m_F.size(), corners.size());
    for (std::size_t i = 0; i < corners.size(); ++i) {
        const KM_3dPoint p =
            object.placed.world_from_mesh * mesh.m_V[mesh.m_F[i / 3].vi[i % 3]].ToDouble();
        expectNear({p.x, p.z, -p.y}, corners[i], tolerance);
    }
}

} // namespace quarn::test
