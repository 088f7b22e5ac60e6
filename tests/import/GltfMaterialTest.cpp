#include "tests/import/GltfFixture.h"

#include <cmath>
#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using ::testing::SizeIs;

/// A TGA file of one row of pixels with their opacity.
void writePicture(const TemporaryFolder& folder, const std::vector<std::uint8_t>& rgba) {
    std::string bytes(18, '\0');
    bytes[2] = 2; // plain colours
    bytes[12] = static_cast<char>(rgba.size() / 4);
    bytes[14] = 1;  // row
    bytes[16] = 32; // bits a pixel
    bytes[17] = 8;  // of which so many are opacity
    for (std::size_t i = 0; i + 3 < rgba.size(); i += 4)
        for (const std::size_t channel : {2U, 1U, 0U, 3U})
            bytes += static_cast<char>(rgba[i + channel]);
    folder.write("paint.tga", bytes);
}

constexpr const char* one_texture =
    R"(,"textures":[{"source":0,"sampler":0}],"images":[{"uri":"paint.tga"}],"samplers":[{)";

const ImportedMesh& onlyMesh(const ImportedModel& model) {
    static const ImportedMesh none;
    EXPECT_THAT(model.meshes, SizeIs(1));
    return model.meshes.empty() ? none : model.meshes.front();
}

Material readMaterial(const GltfSquare& square, const TemporaryFolder& folder) {
    const ImportedModel model = readOrFail(square.write(folder));
    const auto material = onlyMesh(model).placed.material;
    EXPECT_NE(material, nullptr);
    return material ? *material : Material();
}

struct Sampler {
    int wrap; ///< as the file gives it
    TextureWrap read;
};

class TextureSamplers : public testing::TestWithParam<Sampler> {};

TEST_P(TextureSamplers, WrapTheTextureInEachDirectionAsTheySay) {
    const TemporaryFolder folder;
    writePicture(folder, {10, 20, 30, 255});
    const std::string wrap = std::to_string(GetParam().wrap);
    for (const bool across : {true, false}) {
        GltfSquare square;
        square.material = R"({"pbrMetallicRoughness":{"baseColorTexture":{"index":0}}})";
        square.more = one_texture + (across ? R"("wrapS":)" + wrap + R"(,"wrapT":10497}])"
                                            : R"("wrapT":)" + wrap + R"(,"wrapS":10497}])");
        const Material material = readMaterial(square, folder);
        ASSERT_NE(material.base_color_texture, nullptr);
        const Texture& texture = *material.base_color_texture;
        EXPECT_EQ(across ? texture.wrap_u : texture.wrap_v, GetParam().read);
        EXPECT_EQ(across ? texture.wrap_v : texture.wrap_u, TextureWrap::repeat);
    }
}

INSTANTIATE_TEST_SUITE_P(Gltf, TextureSamplers,
                         testing::Values(Sampler{10497, TextureWrap::repeat},
                                         Sampler{33648, TextureWrap::mirror},
                                         Sampler{33071, TextureWrap::clamp}));

TEST(GltfMaterial, ATextureRepeatsWithoutASampler) {
    const TemporaryFolder folder;
    writePicture(folder, {10, 20, 30, 255});
    GltfSquare square;
    square.material = R"({"pbrMetallicRoughness":{"baseColorTexture":{"index":0}}})";
    square.more = R"(,"textures":[{"source":0}],"images":[{"uri":"paint.tga"}])";
    const Material material = readMaterial(square, folder);
    ASSERT_NE(material.base_color_texture, nullptr);
    EXPECT_EQ(material.base_color_texture->wrap_u, TextureWrap::repeat);
    EXPECT_EQ(material.base_color_texture->wrap_v, TextureWrap::repeat);
}

/// Where the extension KHR_texture_transform puts a texture coordinate: scaled, then turned by the
/// angle (clockwise on the picture, whose v runs downward), then moved.
std::array<double, 2> transformed(const std::array<float, 2>& uv, double offset_u, double offset_v,
                                  double angle, double scale_u, double scale_v) {
    const double u = scale_u * double{uv[0]};
    const double v = scale_v * double{uv[1]};
    return {std::cos(angle) * u + std::sin(angle) * v + offset_u,
            -std::sin(angle) * u + std::cos(angle) * v + offset_v};
}

class TextureTransforms : public testing::TestWithParam<std::array<double, 5>> {};

TEST_P(TextureTransforms, MoveTurnAndScaleTheTextureCoordinates) {
    const auto [offset_u, offset_v, angle, scale_u, scale_v] = GetParam();
    const TemporaryFolder folder;
    writePicture(folder, {10, 20, 30, 255});
    GltfSquare square;
    square.texture_coordinates = {{0.1F, 0.2F}, {0.7F, 0.2F}, {0.7F, 0.9F}, {0.1F, 0.9F}};
    std::ostringstream transform;
    transform << R"({"offset":[)" << offset_u << "," << offset_v << R"(],"rotation":)" << angle
              << R"(,"scale":[)" << scale_u << "," << scale_v << "]}";
    square.material = R"({"pbrMetallicRoughness":{"baseColorTexture":{"index":0,"extensions":)"
                      R"({"KHR_texture_transform":)" +
                      transform.str() + "}}}}";
    square.more =
        std::string(one_texture) + "}]" + R"(,"extensionsUsed":["KHR_texture_transform"])";
    const ImportedModel model = readOrFail(square.write(folder));
    const ImportedMesh& mesh = onlyMesh(model);
    ASSERT_THAT(mesh.placed.mesh->m_T, SizeIs(4));
    for (std::size_t i = 0; i < 4; ++i) {
        const auto wanted =
            transformed(square.texture_coordinates[i], offset_u, offset_v, angle, scale_u, scale_v);
        // Ours run upward from the lower left corner. Whole repetitions show the same.
        const double du = double{mesh.placed.mesh->m_T[i].x} - wanted[0];
        const double dv = double{mesh.placed.mesh->m_T[i].y} - (1.0 - wanted[1]);
        EXPECT_NEAR(du, std::round(du), 1e-5) << "corner " << i;
        EXPECT_NEAR(dv, std::round(dv), 1e-5) << "corner " << i;
    }
}

INSTANTIATE_TEST_SUITE_P(
    Gltf, TextureTransforms,
    testing::Values(std::array{0.25, 0.1, 0.0, 1.0, 1.0}, std::array{0.0, 0.0, 0.0, 3.0, 2.0},
                    std::array{0.0, 0.0, 0.5, 1.0, 1.0}, std::array{0.3, 0.6, 0.0, 2.0, 0.5},
                    std::array{0.2, 0.4, 0.7, 2.0, 2.0}, std::array{0.2, 0.4, 0.7, 2.0, 3.0}));

Material withAlpha(const std::string& mode, const std::string& alpha,
                   std::vector<std::array<float, 4>> colors = {}) {
    const TemporaryFolder folder;
    GltfSquare square;
    square.material = R"({"alphaMode":")" + mode +
                      R"(","pbrMetallicRoughness":{"baseColorFactor":[1,1,1,)" + alpha + "]}}";
    square.colors = std::move(colors);
    return readMaterial(square, folder);
}

TEST(GltfMaterial, AlphaCountsInBlendModeOnly) {
    const Material glass = withAlpha("BLEND", "0.4");
    EXPECT_TRUE(glass.see_through);
    EXPECT_FALSE(glass.alpha_cutout);
    EXPECT_EQ(glass.base_color.a, 102);
    EXPECT_FALSE(withAlpha("BLEND", "1").see_through);
    EXPECT_FALSE(withAlpha("OPAQUE", "0.4").see_through);
    EXPECT_FALSE(withAlpha("MASK", "0.4").see_through);
    EXPECT_TRUE(withAlpha("MASK", "0.4").alpha_cutout);
}

TEST(GltfMaterial, AlphaOfVerticesMakesASurfaceSeeThrough) {
    EXPECT_TRUE(withAlpha("BLEND", "1", {{1, 1, 1, 1}, {1, 1, 1, 1}, {1, 1, 1, 0.5F}, {1, 1, 1, 1}})
                    .see_through);
    EXPECT_FALSE(withAlpha("BLEND", "1", {{1, 1, 1, 1}, {1, 1, 1, 1}, {1, 1, 1, 1}, {1, 1, 1, 1}})
                     .see_through);
}

TEST(GltfMaterial, ATextureOfGlassIsSeeThroughAndOneOfLeavesHasHoles) {
    const TemporaryFolder folder;
    GltfSquare square;
    square.material = R"({"alphaMode":"BLEND","pbrMetallicRoughness":{"baseColorTexture":)"
                      R"({"index":0}}})";
    square.more = std::string(one_texture) + "}]";
    writePicture(folder, {10, 20, 30, 90, 10, 20, 30, 90});
    EXPECT_TRUE(readMaterial(square, folder).see_through);
    writePicture(folder, {10, 20, 30, 0, 10, 20, 30, 255});
    const Material leaf = readMaterial(square, folder);
    EXPECT_FALSE(leaf.see_through);
    EXPECT_TRUE(leaf.alpha_cutout);
    writePicture(folder, {10, 20, 30, 255, 10, 20, 30, 255});
    const Material opaque = readMaterial(square, folder);
    EXPECT_FALSE(opaque.see_through);
    EXPECT_FALSE(opaque.alpha_cutout);
}

Material objMaterial(const std::string& lines) {
    const TemporaryFolder folder;
    folder.write("a.mtl", "newmtl one\nKd 0.2 0.4 0.6\n" + lines + "\n");
    const ImportedModel model = readOrFail(
        folder.write("a.obj", "mtllib a.mtl\nv 0 0 0\nv 1 0 0\nv 0 1 0\nusemtl one\nf 1 2 3\n"));
    const auto material = onlyMesh(model).placed.material;
    return material ? *material : Material();
}

TEST(ObjMaterial, OpacityAndTransparencyMakeItSeeThrough) {
    const Material by_opacity = objMaterial("d 0.25");
    EXPECT_TRUE(by_opacity.see_through);
    EXPECT_EQ(by_opacity.base_color.a, 64);
    const Material by_transparency = objMaterial("Tr 0.75");
    EXPECT_TRUE(by_transparency.see_through);
    EXPECT_EQ(by_transparency.base_color.a, 64);
    EXPECT_FALSE(objMaterial("d 1").see_through);
    EXPECT_FALSE(objMaterial("").see_through);
}

TEST(ObjMaterial, AnOpacityOfNothingIsTakenForNone) {
    EXPECT_FALSE(objMaterial("d 0").see_through);
}

} // namespace
} // namespace quarn::test
