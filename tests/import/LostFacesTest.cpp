#include "tests/import/GltfFixture.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::SizeIs;

std::string lost(int count, int all, const std::string& noun, const std::string& mesh) {
    return std::to_string(count) + " of " + std::to_string(all) + " " + noun + " of the mesh '" +
           mesh +
           "' were left out: their indices lie beyond its vertices. The file may be damaged; "
           "get or export it again.";
}

/// A glTF of parts that share three vertices; each has a mode and indices.
struct Parts {
    struct Part {
        int mode;
        std::vector<std::uint32_t> indices;
    };
    struct Mesh {
        std::string name; ///< empty: none
        std::vector<Part> parts;
    };
    std::vector<Mesh> meshes;
    std::size_t shown = 1000; ///< how many of them, from the first, stand in the scene
    std::string padding{};    ///< of a text that nobody needs
    std::string extension{};  ///< that the file says it needs

    std::filesystem::path write(const TemporaryFolder& folder) const {
        const float places[9] = {0, 0, 0, 1, 0, 0, 0, 1, 0};
        std::string bytes(reinterpret_cast<const char*>(places), sizeof(places));
        std::string views = R"({"buffer":0,"byteLength":36})";
        std::string accessors = R"({"bufferView":0,"componentType":5126,"count":3,"type":"VEC3"})";
        std::string all_meshes;
        std::string nodes;
        std::string shown_nodes;
        int next = 1;
        for (std::size_t m = 0; m < meshes.size(); ++m) {
            std::string parts;
            for (const Part& part : meshes[m].parts) {
                const std::size_t size = 4 * part.indices.size();
                views += R"(,{"buffer":0,"byteOffset":)" + std::to_string(bytes.size()) +
                         R"(,"byteLength":)" + std::to_string(size) + "}";
                bytes.append(reinterpret_cast<const char*>(part.indices.data()), size);
                accessors += R"(,{"bufferView":)" + std::to_string(next) +
                             R"(,"componentType":5125,"type":"SCALAR","count":)" +
                             std::to_string(part.indices.size()) + "}";
                parts += std::string(parts.empty() ? "" : ",") + R"({"mode":)" +
                         std::to_string(part.mode) + R"(,"attributes":{"POSITION":0},"indices":)" +
                         std::to_string(next++) + "}";
            }
            const std::string comma = m == 0 ? "" : ",";
            const std::string& name = meshes[m].name;
            all_meshes += comma + "{" + (name.empty() ? "" : R"("name":")" + name + R"(",)") +
                          R"("primitives":[)" + parts + "]}";
            nodes += comma + R"({"mesh":)" + std::to_string(m) + "}";
            shown_nodes += m < shown ? comma + std::to_string(m) : "";
        }
        folder.write("a.bin", bytes);
        return folder.write(
            "a.gltf",
            R"({"asset":{"version":"2.0","copyright":")" + padding +
                R"("},"extensionsRequired":[)" + (extension.empty() ? "" : '"' + extension + '"') +
                R"(],"scene":0,"scenes":[{"nodes":[)" + shown_nodes + R"(]}],"nodes":[)" + nodes +
                R"(],"meshes":[)" + all_meshes + R"(],"accessors":[)" + accessors +
                R"(],"bufferViews":[)" + views + R"(],"buffers":[{"uri":"a.bin","byteLength":)" +
                std::to_string(bytes.size()) + "}]}");
    }
};

TEST(LostFaces, AreCountedForEachMeshByItsName) {
    const TemporaryFolder folder;
    const Parts parts{{{"roof", {{4, {0, 1, 2, 0, 1, 3}}}},
                       {"wall", {{4, {0, 1, 2}}}},
                       {"", {{4, {0, 1, 2, 0, 1, 9, 9, 9, 9}}}}}};
    const ImportedModel model = readOrFail(parts.write(folder));
    EXPECT_EQ(model.triangleCount(), 3U);
    EXPECT_THAT(model.warnings,
                ElementsAre(lost(2, 3, "triangles", "meshes[2]"), lost(1, 2, "triangles", "roof")));
}

TEST(LostFaces, OfPartsAreCountedForEachPart) {
    const TemporaryFolder folder;
    const Parts parts{{{"roof", {{4, {0, 1, 2}}, {5, {0, 1, 2, 3, 0}}, {6, {0, 1, 2, 7}}}}}};
    // A strip of five has three triangles, all with the fourth vertex but the first; a fan of four
    // has two.
    EXPECT_THAT(readOrFail(parts.write(folder)).warnings,
                ElementsAre(lost(2, 3, "triangles", "roof-1"), lost(1, 2, "triangles", "roof-2")));
}

TEST(LostFaces, OfLinesAndPointsAreCounted) {
    const TemporaryFolder folder;
    const Parts parts{{{"a", {{0, {0, 1, 5}}}},
                       {"b", {{1, {0, 1, 1, 5}}}},
                       {"c", {{2, {0, 1, 2, 5}}}},
                       {"d", {{3, {0, 1, 2, 5}}}}}};
    EXPECT_THAT(readOrFail(parts.write(folder)).warnings,
                ElementsAre(lost(1, 3, "points", "a"), lost(1, 2, "lines", "b"),
                            lost(2, 4, "lines", "c"), lost(1, 3, "lines", "d")));
}

TEST(LostFaces, AreNotSuspectedInSoundFiles) {
    const TemporaryFolder folder;
    const std::vector<std::uint32_t> seven{0, 1, 2, 0, 1, 2, 0};
    Parts parts;
    for (int mode = 0; mode < 7; ++mode)
        parts.meshes.push_back({"all alike", {{mode, seven}}});
    EXPECT_THAT(readOrFail(parts.write(folder)).warnings, IsEmpty());
    parts.shown = 3; // the others are not read
    EXPECT_THAT(readOrFail(parts.write(folder)).warnings, IsEmpty());
}

TEST(LostFaces, OfMeshesOfOneNameAreSummedUp) {
    const TemporaryFolder folder;
    const Parts parts{{{"leaf", {{4, {0, 1, 2, 0, 1, 3}}}}, {"leaf", {{4, {0, 1, 2}}}}}};
    EXPECT_THAT(readOrFail(parts.write(folder)).warnings,
                ElementsAre(lost(1, 3, "triangles", "leaf")));
}

TEST(LostFaces, OfManyMeshesAreToldInFewSentences) {
    const TemporaryFolder folder;
    Parts parts;
    for (int i = 0; i < 100; ++i)
        parts.meshes.push_back({"m" + std::to_string(i), {{4, {0, 1, 2, 0, 1, 3}}}});
    const ImportedModel model = readOrFail(parts.write(folder));
    ASSERT_THAT(model.warnings, SizeIs(9));
    EXPECT_EQ(model.warnings.back(), "Other meshes lost 92 faces in the same way.");
}

TEST(LostFaces, AreFoundBehindTextsOfAnyLength) {
    const TemporaryFolder folder;
    Parts parts{{{"roof", {{4, {0, 1, 2, 0, 1, 3}}}}}};
    std::string quotes;
    for (int i = 0; i < 150'000; ++i)
        quotes += R"(\")";
    const std::string mixed = std::string(4090, 'x') + R"(\"\\\u0041)" + std::string(600'000, 'y');
    for (const std::string& padding : {quotes, mixed}) {
        parts.padding = padding;
        EXPECT_THAT(readOrFail(parts.write(folder)).warnings,
                    ElementsAre(lost(1, 2, "triangles", "roof")));
    }
}

TEST(GltfExtension, ThatIsNotKnownAndNeededIsRefusedInWordsForWhoOnlyGotTheFile) {
    const TemporaryFolder folder;
    Parts parts{{{"roof", {{4, {0, 1, 2}}}}}};
    parts.extension = "ACME_other_vertices";
    const auto path = parts.write(folder);
    const Result<ImportedModel> model = readModelFile(path);
    ASSERT_FALSE(model.ok());
    EXPECT_EQ(model.message(), "Cannot read '" + path.string() +
                                   "': it needs the glTF extension 'ACME_other_vertices', which "
                                   "is not known here. Ask whoever passed it on for the model "
                                   "without that extension, or in another format.");
}

TEST(GltfExtension, ThatMovesNoVertexNeedNotBeKnown) {
    const TemporaryFolder folder;
    Parts parts{{{"roof", {{4, {0, 1, 2}}}}}};
    for (const char* const known : {"KHR_texture_transform", "KHR_texture_basisu",
                                    "KHR_mesh_quantization", "EXT_meshopt_compression"}) {
        parts.extension = known;
        EXPECT_THAT(readOrFail(parts.write(folder)).warnings, IsEmpty()) << known;
    }
}

TEST(LostFaces, MeshThatLostAllIsToldByNameAndTheOthersAreShown) {
    const TemporaryFolder folder;
    const Parts parts{{{"roof", {{4, {0, 1, 3}}}}, {"wall", {{4, {0, 1, 2}}}}}};
    const ImportedModel model = readOrFail(parts.write(folder));
    EXPECT_EQ(model.triangleCount(), 1U);
    EXPECT_THAT(model.warnings, ElementsAre(lost(1, 1, "triangles", "roof")));
}

} // namespace
} // namespace quarn::test
