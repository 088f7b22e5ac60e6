// Meshes in the compressed forms of the web, made by the encoders of the libraries that decode
// them.

#include "tests/import/gltf/GltfWriter.h"

#include <draco/compression/encode.h>
#include <draco/mesh/triangle_soup_mesh_builder.h>
#include <gmock/gmock.h>
#include <meshoptimizer.h>

#include <array>

namespace quarn::test {
namespace {

using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::SizeIs;

using Json = GltfWriter::Json;

/// A square of two triangles.
const std::vector<float> PLACES{0, 0, 0, 1, 0, 0, 1, 1, 0, 0, 1, 0};
const std::vector<std::uint32_t> INDICES{0, 1, 2, 0, 2, 3};
const std::vector<KM_3dPoint> CORNERS{{0, 0, 0}, {1, 0, 0}, {1, 1, 0},
                                      {0, 0, 0}, {1, 1, 0}, {0, 1, 0}};

std::string packedVertices(const void* vertices, std::size_t count, std::size_t size) {
    std::string bytes(meshopt_encodeVertexBufferBound(count, size), '\0');
    bytes.resize(meshopt_encodeVertexBuffer(reinterpret_cast<unsigned char*>(bytes.data()),
                                            bytes.size(), vertices, count, size));
    return bytes;
}

/// A view into a buffer that has no bytes, and the compressed bytes that stand for it.
std::size_t packedView(GltfWriter& gltf, const std::string& bytes, std::size_t count,
                       std::size_t stride, const char* mode, const char* filter = "NONE") {
    const std::size_t packed = gltf.view(bytes);
    const Json place = gltf.json["bufferViews"][packed];
    gltf.json["bufferViews"][packed] = {{"buffer", 1},
                                        {"byteLength", count * stride},
                                        {"extensions",
                                         {{"EXT_meshopt_compression",
                                           {{"buffer", 0},
                                            {"byteOffset", place["byteOffset"]},
                                            {"byteLength", place["byteLength"]},
                                            {"byteStride", stride},
                                            {"count", count},
                                            {"mode", mode},
                                            {"filter", filter}}}}}};
    return packed;
}

enum class Packing { triangles, sequence };

GltfWriter packedSquare(Packing packing) {
    GltfWriter gltf;
    gltf.json["extensionsRequired"] = {"EXT_meshopt_compression"};
    std::string bytes(64 + meshopt_encodeIndexBufferBound(6, 4), '\0');
    auto* const begin = reinterpret_cast<unsigned char*>(bytes.data());
    const bool is_list = packing == Packing::triangles;
    bytes.resize(is_list ? meshopt_encodeIndexBuffer(begin, bytes.size(), INDICES.data(), 6)
                         : meshopt_encodeIndexSequence(begin, bytes.size(), INDICES.data(), 6));
    const std::size_t vertices =
        packedView(gltf, packedVertices(PLACES.data(), 4, 12), 4, 12, "ATTRIBUTES");
    const std::size_t indices = packedView(gltf, bytes, 6, 4, is_list ? "TRIANGLES" : "INDICES");
    gltf.mesh({{"attributes", {{"POSITION", gltf.accessor(vertices, 4, "VEC3", 5126)}}},
               {"indices", gltf.accessor(indices, 6, "SCALAR", 5125)}});
    return gltf;
}

Json& packed(GltfWriter& gltf, std::size_t view) {
    return gltf.json["bufferViews"][view]["extensions"]["EXT_meshopt_compression"];
}

std::string glbWithEmptyBuffer(GltfWriter& gltf) {
    gltf.json["buffers"] = {{{"byteLength", 100'000}}, {{"byteLength", 100'000}}};
    return gltf.glb();
}

ImportedModel readPacked(GltfWriter& gltf) {
    const TemporaryFolder folder;
    return readOrFail(folder.write("a.glb", glbWithEmptyBuffer(gltf)));
}

std::string refusalOf(GltfWriter& gltf) {
    const TemporaryFolder folder;
    const auto model = readModelFile(folder.write("a.glb", glbWithEmptyBuffer(gltf)));
    EXPECT_FALSE(model.ok());
    return model.ok() ? "" : model.message();
}

TEST(MeshoptGltf, IsTheSameMeshAsItsSource) {
    for (const Packing packing : {Packing::triangles, Packing::sequence}) {
        GltfWriter gltf = packedSquare(packing);
        const ImportedModel model = readPacked(gltf);
        ASSERT_THAT(model.meshes, SizeIs(1));
        // The encoder may turn the corners of a triangle round.
        EXPECT_EQ(model.triangleCount(), 2U);
        if (packing == Packing::sequence)
            expectCorners(model.meshes[0], CORNERS);
        const KM_BoundingBox box = boundsOf(model);
        expectNear(box.m_max, {1, 0, 1}, 1e-6);
    }
}

TEST(MeshoptGltf, FiltersGiveBackDirectionsAndNumbers) {
    GltfWriter gltf = packedSquare(Packing::triangles);
    std::array<std::int8_t, 16> normals{};
    const std::vector<float> given{0, 0, 1, 0, 0, 0, 1, 0, 0, 0, 1, 0, 0, 0, 1, 0};
    meshopt_encodeFilterOct(normals.data(), 4, 4, 8, given.data());
    std::array<std::uint32_t, 12> places{};
    meshopt_encodeFilterExp(places.data(), 4, 12, 20, PLACES.data());
    gltf.primitive()["attributes"]["NORMAL"] = gltf.accessor(
        packedView(gltf, packedVertices(normals.data(), 4, 4), 4, 4, "ATTRIBUTES", "OCTAHEDRAL"), 4,
        "VEC3", 5120, true);
    gltf.json["bufferViews"].back()["byteStride"] = 4;
    gltf.primitive()["attributes"]["POSITION"] = gltf.accessor(
        packedView(gltf, packedVertices(places.data(), 4, 12), 4, 12, "ATTRIBUTES", "EXPONENTIAL"),
        4, "VEC3", 5126);
    const ImportedModel model = readPacked(gltf);
    ASSERT_THAT(model.meshes, SizeIs(1));
    expectNear(boundsOf(model).m_max, {1, 0, 1}, 1e-5);
    for (const KM_3fVector& normal : model.meshes[0].placed.mesh->m_N)
        EXPECT_NEAR(normal.y, -1.0F, 1e-3F);
}

TEST(MeshoptGltf, ThatClaimsWhatItCannotHoldIsRefused) {
    GltfWriter many = packedSquare(Packing::triangles);
    packed(many, 0)["count"] = 4'000'000'000;
    EXPECT_THAT(refusalOf(many), HasSubstr("claims 4000000000 elements and has only"));
    GltfWriter more = packedSquare(Packing::triangles);
    packed(more, 0)["count"] = 1e19;
    EXPECT_THAT(refusalOf(more), HasSubstr("it claims too many elements"));
    GltfWriter uneven = packedSquare(Packing::triangles);
    packed(uneven, 1)["count"] = 5;
    EXPECT_THAT(refusalOf(uneven), HasSubstr("its count is no multiple of three"));
}

TEST(MeshoptGltf, WhoseSizesDoNotGoWithItsModeIsRefused) {
    const auto with = [](std::size_t view, const char* name, const Json& value) {
        GltfWriter gltf = packedSquare(Packing::triangles);
        packed(gltf, view)[name] = value;
        return refusalOf(gltf);
    };
    EXPECT_THAT(with(0, "byteStride", 0), HasSubstr("elements of 0 bytes do not go"));
    EXPECT_THAT(with(0, "byteStride", 260), HasSubstr("elements of 260 bytes do not go"));
    EXPECT_THAT(with(0, "byteStride", 10), HasSubstr("elements of 10 bytes do not go"));
    EXPECT_THAT(with(1, "byteStride", 12), HasSubstr("elements of 12 bytes do not go"));
    EXPECT_THAT(with(0, "mode", "OTHER"), HasSubstr("its mode 'OTHER' is not known"));
    EXPECT_THAT(with(0, "filter", "OCTAHEDRAL"), HasSubstr("its filter 'OCTAHEDRAL'"));
    EXPECT_THAT(with(1, "filter", "EXPONENTIAL"), HasSubstr("its filter 'EXPONENTIAL'"));
    EXPECT_THAT(with(0, "byteLength", 3), HasSubstr("buffer view 0 cannot be decompressed"));
    EXPECT_THAT(with(0, "byteLength", 999'999), HasSubstr("buffer view 0 is out of range"));
}

/// The square as Draco stores it.
std::string dracoBytes() {
    draco::TriangleSoupMeshBuilder builder;
    builder.Start(2);
    const int places =
        builder.AddAttribute(draco::GeometryAttribute::POSITION, 3, draco::DT_FLOAT32);
    const auto at = [](std::size_t corner) { return &PLACES[3 * INDICES[corner]]; };
    for (std::uint32_t f = 0; f < 2; ++f)
        builder.SetAttributeValuesForFace(places, draco::FaceIndex(f), at(3 * f), at(3 * f + 1),
                                          at(3 * f + 2));
    const std::unique_ptr<draco::Mesh> mesh = builder.Finalize();
    draco::Encoder encoder;
    encoder.SetAttributeQuantization(draco::GeometryAttribute::POSITION, 14);
    draco::EncoderBuffer buffer;
    EXPECT_TRUE(encoder.EncodeMeshToBuffer(*mesh, &buffer).ok());
    return {buffer.data(), buffer.size()};
}

GltfWriter dracoSquare(const std::string& bytes) {
    GltfWriter gltf;
    gltf.json["extensionsRequired"] = {"KHR_draco_mesh_compression"};
    gltf.json["accessors"] = {{{"componentType", 5126}, {"count", 4}, {"type", "VEC3"}},
                              {{"componentType", 5125}, {"count", 6}, {"type", "SCALAR"}}};
    gltf.mesh({{"attributes", {{"POSITION", 0}}},
               {"indices", 1},
               {"extensions",
                {{"KHR_draco_mesh_compression",
                  {{"bufferView", gltf.view(bytes)}, {"attributes", {{"POSITION", 0}}}}}}}});
    return gltf;
}

TEST(DracoGltf, IsTheSameMeshAsItsSource) {
    const ImportedModel model = dracoSquare(dracoBytes()).read();
    ASSERT_THAT(model.meshes, SizeIs(1));
    EXPECT_EQ(model.triangleCount(), 2U);
    EXPECT_EQ(model.meshes[0].placed.mesh->VertexCount(), 4);
    const KM_BoundingBox box = boundsOf(model);
    expectNear(box.m_min, {0, 0, 0}, 1e-3);
    expectNear(box.m_max, {1, 0, 1}, 1e-3);
    for (const KM_3fVector& normal : model.meshes[0].placed.mesh->m_N)
        EXPECT_NEAR(normal.y, -1.0F, 1e-3F);
}

TEST(DracoGltf, ThatHoldsMoreThanItsAccessorsSayIsRefused) {
    GltfWriter gltf = dracoSquare(dracoBytes());
    gltf.json["accessors"][0]["count"] = 2;
    EXPECT_THAT(gltf.refusal(), HasSubstr("they hold more than their accessors say"));
}

TEST(DracoGltf, OfACountThatTheMemoryDoesNotHoldIsRefused) {
    GltfWriter gltf = dracoSquare(dracoBytes());
    gltf.json["accessors"][1]["count"] = 1e19;
    EXPECT_THAT(gltf.refusal(), HasSubstr("its compressed meshes need"));
}

TEST(DracoGltf, CutAnywhereIsRefused) {
    const std::string whole = dracoBytes();
    for (std::size_t length = 1; length + 1 < whole.size(); ++length) {
        GltfWriter gltf = dracoSquare(whole.substr(0, length));
        EXPECT_THAT(gltf.refusal(), AllOf(HasSubstr("model.glb"),
                                          HasSubstr("compressed bytes of one of its meshes")));
    }
}

} // namespace
} // namespace quarn::test
