#include "tests/import/gltf/GltfWriter.h"

#include <gmock/gmock.h>

#include <cmath>
#include <functional>
#include <limits>

namespace quarn::test {
namespace {

using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::SizeIs;

const std::vector<KM_3dPoint> TRIANGLE{{0, 0, 0}, {1, 0, 0}, {0, 1, 0}};

TEST(GltfAccessor, QuantizedVerticesAreReadAsTheNumbersThatTheyStandFor) {
    GltfWriter gltf;
    gltf.json["extensionsRequired"] = {"KHR_mesh_quantization"};
    const std::vector<std::int16_t> places{0, 0, 0, 7, 32767, 0, 0, 7, 0, -32768, 0, 7};
    const std::vector<std::int8_t> normals{0, 0, 127, 9, 0, 0, 127, 9, 0, 0, 64, 9};
    const std::vector<std::uint16_t> texture{0, 0, 65535, 0, 0, 65535};
    const auto stored = [&](const auto& list, int stride, const char* type, int component) {
        return gltf.accessor(gltf.view(GltfWriter::bytesOf(list), stride), 3, type, component,
                             true);
    };
    gltf.mesh({{"attributes",
                {{"POSITION", stored(places, 8, "VEC3", 5122)},
                 {"NORMAL", stored(normals, 4, "VEC3", 5120)},
                 {"TEXCOORD_0", stored(texture, 0, "VEC2", 5123)}}}});
    gltf.node()["scale"] = {2, 2, 2};
    const ImportedModel model = gltf.read();
    ASSERT_THAT(model.meshes, SizeIs(1));
    expectCorners(model.meshes[0], {{0, 0, 0}, {2, 0, 0}, {0, -2, 0}});
    const KM_Mesh& mesh = *model.meshes[0].placed.mesh;
    for (const KM_3fVector& normal : mesh.m_N)
        EXPECT_EQ(normal, KM_3fVector(0.0F, -1.0F, 0.0F));
    EXPECT_EQ(mesh.m_T[mesh.m_F[0].vi[1]], KM_2fPoint(1.0F, 1.0F));
    EXPECT_EQ(mesh.m_T[mesh.m_F[0].vi[2]], KM_2fPoint(0.0F, 0.0F));
}

TEST(GltfAccessor, IntegersThatAreNotSharesAreReadAsTheyAre) {
    GltfWriter gltf;
    const std::vector<std::uint8_t> places{0, 0, 0, 0, 200, 0, 0, 0, 0, 100, 0, 0};
    gltf.mesh({{"attributes",
                {{"POSITION",
                  gltf.accessor(gltf.view(GltfWriter::bytesOf(places), 4), 3, "VEC3", 5121)}}}});
    const ImportedModel model = gltf.read();
    ASSERT_THAT(model.meshes, SizeIs(1));
    expectCorners(model.meshes[0], {{0, 0, 0}, {200, 0, 0}, {0, 100, 0}});
}

/// Moves the third vertex, and only that.
void makeSparse(GltfWriter& gltf, std::size_t accessor, std::uint16_t index) {
    gltf.json["accessors"][accessor]["sparse"] = {
        {"count", 1},
        {"indices",
         {{"bufferView", gltf.view(GltfWriter::bytesOf(std::vector<std::uint16_t>{index}))},
          {"componentType", 5123}}},
        {"values", {{"bufferView", gltf.view(GltfWriter::bytesOf(std::vector<float>{0, 5, 0}))}}}};
}

TEST(GltfAccessor, SparseElementsReplaceThoseThatTheyName) {
    GltfWriter gltf;
    gltf.triangle();
    makeSparse(gltf, 0, 2);
    const ImportedModel model = gltf.read();
    ASSERT_THAT(model.meshes, SizeIs(1));
    expectCorners(model.meshes[0], {{0, 0, 0}, {1, 0, 0}, {0, 5, 0}});
}

TEST(GltfAccessor, SparseElementsWithoutABufferViewReplaceZeros) {
    GltfWriter gltf;
    gltf.triangle();
    makeSparse(gltf, 0, 2);
    gltf.json["accessors"][0].erase("bufferView");
    const ImportedModel model = gltf.read();
    ASSERT_THAT(model.meshes, SizeIs(1));
    expectCorners(model.meshes[0], {{0, 0, 0}, {0, 0, 0}, {0, 5, 0}});
}

TEST(GltfAccessor, SparseElementBeyondTheLastIsRefused) {
    GltfWriter gltf;
    gltf.triangle();
    makeSparse(gltf, 0, 3);
    EXPECT_THAT(gltf.refusal(),
                HasSubstr("the sparse part of accessor 0 names element 3, which is out of range"));
}

TEST(GltfAccessor, MeshesThatShareOneListOfVerticesKeepOnlyTheirOwn) {
    GltfWriter gltf;
    std::vector<float> places;
    for (int i = 0; i < 3000; ++i)
        places.insert(places.end(), {static_cast<float>(i), static_cast<float>(i * i % 7), 0.0F});
    places[3 * 1500] = std::numeric_limits<float>::infinity(); // of no triangle
    const std::size_t shared = gltf.floats(places, "VEC3");
    for (const std::uint32_t first : {0U, 2997U})
        gltf.mesh({{"attributes", {{"POSITION", shared}}},
                   {"indices", gltf.indices({first, first + 2, first + 1})}});
    const ImportedModel model = gltf.read();
    ASSERT_THAT(model.meshes, SizeIs(2));
    EXPECT_EQ(model.meshes[1].placed.mesh->VertexCount(), 3);
    expectCorners(model.meshes[1], {{2997, 1, 0}, {2999, 2, 0}, {2998, 4, 0}});
    EXPECT_THAT(model.warnings, IsEmpty());
}

TEST(GltfAccessor, VertexColoursComeOutInSrgb) {
    GltfWriter gltf;
    gltf.triangle();
    gltf.primitive()["attributes"]["COLOR_0"] =
        gltf.floats({1, 0.5F, 0, 1, 0.5F, 0, 1, 0.5F, 0}, "VEC3");
    const ImportedModel model = gltf.read();
    ASSERT_THAT(model.meshes, SizeIs(1));
    for (const KM_Color& color : model.meshes[0].placed.mesh->m_C)
        EXPECT_EQ(color, (KM_Color{255, 188, 0, 255})); // 1.055 * 0.5^(1 / 2.4) - 0.055 = 0.735
}

TEST(GltfAccessor, NormalsOfAnotherCountAreLeftOutAndTold) {
    GltfWriter gltf;
    gltf.triangle();
    gltf.primitive()["attributes"]["NORMAL"] = gltf.floats({1, 0, 0, 1, 0, 0}, "VEC3");
    const ImportedModel model = gltf.read();
    ASSERT_THAT(model.meshes, SizeIs(1));
    EXPECT_EQ(model.meshes[0].placed.mesh->m_N[0], KM_3fVector(0.0F, -1.0F, 0.0F));
    EXPECT_THAT(model.warnings, ::testing::ElementsAre("The normals of a mesh were left out: "
                                                       "accessor 1 has 2 of them for 3 vertices."));
}

struct Damage {
    const char* why;
    std::function<void(GltfWriter::Json& json)> make;
};

class DamagedGltf : public testing::TestWithParam<Damage> {};

TEST_P(DamagedGltf, IsRefusedWithTheFileAndThePlaceOfTheDamage) {
    GltfWriter gltf;
    gltf.triangle();
    gltf.primitive()["indices"] = gltf.indices({0, 1, 2});
    ASSERT_EQ(gltf.read().triangleCount(), 1U);
    GetParam().make(gltf.json);
    EXPECT_THAT(gltf.refusal(), AllOf(HasSubstr("Cannot read '"), HasSubstr("model.glb': "),
                                      HasSubstr(GetParam().why)));
}

using Json = GltfWriter::Json;

INSTANTIATE_TEST_SUITE_P(
    Gltf, DamagedGltf,
    testing::Values(
        Damage{"accessor 0 is out of range: its 4 elements begin at byte 0 of 36 in buffer view 0",
               [](Json& json) { json["accessors"][0]["count"] = 4; }},
        Damage{"accessor 0 is out of range",
               [](Json& json) { json["accessors"][0]["byteOffset"] = 1; }},
        Damage{"accessor 0 is out of range",
               [](Json& json) { json["accessors"][0]["byteOffset"] = UINT64_MAX; }},
        Damage{"accessor 0 is out of range",
               [](Json& json) { json["accessors"][0]["count"] = 1e19; }},
        Damage{"accessor 0 is out of range",
               [](Json& json) { json["bufferViews"][0]["byteStride"] = UINT64_MAX / 2; }},
        Damage{"accessor 0 does not say what it holds",
               [](Json& json) { json["accessors"][0]["componentType"] = 5124; }},
        Damage{"accessor 0 does not say what it holds",
               [](Json& json) { json["accessors"][0]["type"] = "VEC5"; }},
        Damage{"accessor 0 does not say what it holds",
               [](Json& json) { json["accessors"][0]["count"] = -3; }},
        Damage{"accessor 0 has too few numbers",
               [](Json& json) { json["accessors"][0]["type"] = "VEC2"; }},
        Damage{"there is no accessor 7",
               [](Json& json) { json["meshes"][0]["primitives"][0]["indices"] = 7; }},
        Damage{"there is no buffer view 9",
               [](Json& json) { json["accessors"][0]["bufferView"] = 9; }},
        Damage{"buffer view 0 is out of range: it takes 36 bytes from byte 18446744073709551615",
               [](Json& json) { json["bufferViews"][0]["byteOffset"] = UINT64_MAX; }},
        Damage{"buffer view 0 is out of range",
               [](Json& json) { json["bufferViews"][0]["byteLength"] = 1000; }},
        Damage{"there is no buffer 1", [](Json& json) { json["bufferViews"][0]["buffer"] = 1; }},
        Damage{"buffer 0 is damaged: its character 3 is not of Base64",
               [](Json& json) {
                   json["buffers"] = {{{"uri", "data:application/octet-stream;base64,AA!A"}}};
               }},
        Damage{"buffer 0 is not given in Base64",
               [](Json& json) {
                   json["buffers"] = {{{"uri", "data:text/plain,AAAA"}}};
               }},
        Damage{"node 0 names mesh 3, which is not there",
               [](Json& json) { json["nodes"][0]["mesh"] = 3; }},
        Damage{"its scene names node 12, which is not there",
               [](Json& json) { json["nodes"][0]["children"] = {12}; }},
        Damage{"unknown mode 7",
               [](Json& json) { json["meshes"][0]["primitives"][0]["mode"] = 7; }},
        Damage{"holds no triangles, lines or points", [](Json& json) { json.erase("nodes"); }}));

TEST(HostileGltf, CutAnywhereIsRefusedOrReadWithoutAWordOfDamage) {
    GltfWriter gltf;
    gltf.triangle();
    const std::string whole = gltf.glb();
    const TemporaryFolder folder;
    for (std::size_t length = 1; length < whole.size(); ++length) {
        const auto model = readModelFile(folder.write("cut.glb", whole.substr(0, length)));
        ASSERT_FALSE(model.ok()) << length;
        EXPECT_THAT(model.message(), HasSubstr("cut.glb"));
    }
}

TEST(HostileGltf, CountsWithoutBytesAreRefusedByTheBudget) {
    GltfWriter gltf;
    gltf.triangle();
    gltf.json["accessors"][0].erase("bufferView");
    gltf.json["accessors"][0]["count"] = 3'000'000'000;
    ReadingOptions options;
    options.most_memory = 256U << 20;
    EXPECT_THAT(gltf.refusal(options),
                AllOf(HasSubstr("its triangles need"), HasSubstr("Use a smaller model.")));
}

TEST(HostileGltf, TextOfBracketsAloneIsRefusedByTheBudget) {
    const TemporaryFolder folder;
    ReadingOptions options;
    options.most_memory = 64U << 20;
    const auto model =
        readModelFile(folder.write("deep.gltf", "{" + std::string(1'000'000, '[')), options);
    ASSERT_FALSE(model.ok());
    EXPECT_THAT(model.message(), HasSubstr("its descriptions need"));
}

TEST(HostileGltf, TextThatBreaksOffNamesTheByte) {
    const TemporaryFolder folder;
    const auto model = readModelFile(folder.write("a.gltf", R"({"asset":{"version":"2.0"},"sc)"));
    ASSERT_FALSE(model.ok());
    EXPECT_THAT(model.message(), HasSubstr("its text is damaged at byte 31"));
}

TEST(GltfText, NamesInAnotherEncodingAreReadWithoutTheirStrangeLetters) {
    GltfWriter gltf;
    gltf.triangle();
    gltf.node()["name"] = "T?r";
    std::string bytes = gltf.glb();
    bytes[bytes.find("T?r") + 1] = static_cast<char>(0xFC);
    const TemporaryFolder folder;
    const ImportedModel model = readOrFail(folder.write("a.glb", bytes));
    ASSERT_THAT(model.meshes, SizeIs(1));
    EXPECT_EQ(model.meshes[0].name, L"T\uFFFDr");
}

TEST(GltfText, ReadsAFileOfEitherKindUnderTheNameOfTheOther) {
    GltfWriter gltf;
    gltf.triangle();
    const TemporaryFolder folder;
    EXPECT_EQ(readOrFail(folder.write("binary.gltf", gltf.glb())).triangleCount(), 1U);
}

} // namespace
} // namespace quarn::test
