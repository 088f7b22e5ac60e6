#include "engine/images/ImageFile.h"
#include "tests/import/gltf/GltfWriter.h"

#include <avif/avif.h>
#include <gmock/gmock.h>
#include <webp/encode.h>

#include <array>

namespace quarn::test {
namespace {

using ::testing::AllOf;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::SizeIs;

using Json = GltfWriter::Json;

/// A textured triangle whose picture the file holds.
/// @param kind  how the texture names its picture: an extension, or empty
GltfWriter textured(const std::string& picture, const std::string& kind = "") {
    GltfWriter gltf;
    gltf.triangle();
    gltf.primitive()["attributes"]["TEXCOORD_0"] = gltf.floats({0, 0, 1, 0, 0, 1}, "VEC2");
    gltf.primitive()["attributes"]["TEXCOORD_1"] = gltf.floats({0.5F, 0, 1, 0, 0, 0.25F}, "VEC2");
    gltf.primitive()["material"] = 0;
    gltf.json["materials"] = {{{"pbrMetallicRoughness", {{"baseColorTexture", {{"index", 0}}}}}}};
    gltf.json["images"] = {{{"bufferView", gltf.view(picture)}, {"name", "bricks"}}};
    gltf.json["textures"] = {kind.empty() ? Json{{"source", 0}}
                                          : Json{{"extensions", {{kind, {{"source", 0}}}}}}};
    return gltf;
}

const Texture* textureOf(const ImportedModel& model) {
    EXPECT_THAT(model.meshes, SizeIs(1));
    return model.meshes.empty() ? nullptr
                                : model.meshes[0].placed.material->base_color_texture.get();
}

std::string webp(int width, int height, const std::vector<std::uint8_t>& rgba) {
    std::uint8_t* bytes = nullptr;
    const std::size_t size = WebPEncodeLosslessRGBA(rgba.data(), width, height, 4 * width, &bytes);
    std::string picture(reinterpret_cast<const char*>(bytes), size);
    WebPFree(bytes);
    return picture;
}

std::string bytesOfNumber(std::uint32_t number) {
    std::string bytes;
    for (int shift = 24; shift >= 0; shift -= 8)
        bytes += static_cast<char>(number >> shift & 255);
    return bytes;
}

/// A part of a PNG; its check sum is not right.
std::string chunk(const std::string& kind, const std::string& content) {
    return bytesOfNumber(static_cast<std::uint32_t>(content.size())) + kind + content +
           bytesOfNumber(0);
}

/// A PNG of opaque colours whose rows are stored without compression.
std::string png(std::uint32_t width, std::uint32_t height, const std::string& rows) {
    std::string packed = "\x78\x01";
    for (std::size_t at = 0; at < rows.size() || at == 0; at += 65535) {
        const std::string block = rows.substr(at, 65535);
        const bool is_last = at + 65535 >= rows.size();
        const std::size_t size = block.size();
        packed += static_cast<char>(is_last ? 1 : 0);
        packed += {static_cast<char>(size & 255), static_cast<char>(size >> 8),
                   static_cast<char>(~size & 255), static_cast<char>(~size >> 8 & 255)};
        packed += block;
    }
    return "\x89PNG\r\n\x1A\n" +
           chunk("IHDR", bytesOfNumber(width) + bytesOfNumber(height) +
                             std::string("\x08\x02\x00\x00\x00", 5)) +
           chunk("IDAT", packed + bytesOfNumber(0)) + chunk("IEND", "");
}

TEST(GltfTexture, OfWebpIsReadWithItsOpacity) {
    GltfWriter gltf = textured(webp(2, 1, {10, 20, 30, 255, 40, 50, 60, 128}), "EXT_texture_webp");
    gltf.json["extensionsRequired"] = {"EXT_texture_webp"};
    const ImportedModel model = gltf.read();
    EXPECT_THAT(model.warnings, IsEmpty());
    const Texture* const texture = textureOf(model);
    ASSERT_NE(texture, nullptr);
    EXPECT_EQ(texture->width, 2);
    EXPECT_THAT(texture->rgba, ElementsAre(10, 20, 30, 255, 40, 50, 60, 128));
}

std::string avif(int width, int height, const std::vector<std::uint8_t>& rgba) {
    avifImage* const image = avifImageCreate(width, height, 8, AVIF_PIXEL_FORMAT_YUV444);
    avifRGBImage source{};
    avifRGBImageSetDefaults(&source, image);
    std::vector<std::uint8_t> pixels = rgba;
    source.pixels = pixels.data();
    source.rowBytes = 4 * static_cast<std::uint32_t>(width);
    EXPECT_EQ(avifImageRGBToYUV(image, &source), AVIF_RESULT_OK);
    avifEncoder* const encoder = avifEncoderCreate();
    encoder->speed = AVIF_SPEED_FASTEST;
    avifRWData written = AVIF_DATA_EMPTY;
    EXPECT_EQ(avifEncoderWrite(encoder, image, &written), AVIF_RESULT_OK);
    std::string picture(reinterpret_cast<const char*>(written.data), written.size);
    avifRWDataFree(&written);
    avifEncoderDestroy(encoder);
    avifImageDestroy(image);
    return picture;
}

TEST(GltfTexture, OfAvifIsReadWithItsOpacity) {
    std::vector<std::uint8_t> rgba;
    for (int i = 0; i < 64 * 32; ++i)
        rgba.insert(rgba.end(), {200, 100, 40, static_cast<std::uint8_t>(i % 64 < 32 ? 255 : 0)});
    GltfWriter gltf = textured(avif(64, 32, rgba), "EXT_texture_avif");
    gltf.json["extensionsRequired"] = {"EXT_texture_avif"};
    const ImportedModel model = gltf.read();
    EXPECT_THAT(model.warnings, IsEmpty());
    const Texture* const texture = textureOf(model);
    ASSERT_NE(texture, nullptr);
    EXPECT_EQ(texture->width, 64);
    EXPECT_EQ(texture->height, 32);
    const std::vector<std::uint8_t>& read = texture->rgba;
    EXPECT_NEAR(read[0], 200, 6);
    EXPECT_NEAR(read[1], 100, 6);
    EXPECT_NEAR(read[2], 40, 6);
    EXPECT_NEAR(read[3], 255, 6);
    EXPECT_NEAR(read[4 * 63 + 3], 0, 6);
}

TEST(GltfTexture, DamagedAnywhereIsLeftOutOrReadInItsSize) {
    const std::vector<std::uint8_t> rgba(4 * 16 * 16, 90);
    for (const std::string& whole : {avif(16, 16, rgba), webp(16, 16, rgba)}) {
        for (std::size_t at = 12; at < whole.size(); at += 7) {
            std::string damaged = whole;
            damaged[at] = static_cast<char>(~damaged[at]);
            const ImportedModel model = textured(damaged).read();
            const Texture* const texture = textureOf(model);
            EXPECT_EQ(model.warnings.size(), texture == nullptr ? 1U : 0U);
        }
    }
}

TEST(GltfTexture, OfAnotherFormatTellsWhichAndTheModelIsShownWithoutIt) {
    const ImportedModel model =
        textured(std::string("\xABKTX 20\xBB\r\n\x1A\n", 12), "KHR_texture_basisu").read();
    EXPECT_EQ(textureOf(model), nullptr);
    EXPECT_THAT(
        model.warnings,
        ElementsAre("The texture 'bricks (image 0)' was left out: it is a KTX picture; those "
                    "that are read are PNG, JPEG, WebP, AVIF, BMP, TGA and GIF."));
}

TEST(GltfTexture, IsTakenInTheFormatThatIsReadWhereTheFileOffersTwo) {
    GltfWriter gltf = textured(webp(1, 1, {10, 20, 30, 255}));
    gltf.json["textures"][0]["extensions"]["KHR_texture_basisu"]["source"] = 7;
    EXPECT_NE(textureOf(gltf.read()), nullptr);
}

TEST(GltfTexture, UsesTheCoordinatesThatItsMaterialNames) {
    GltfWriter gltf = textured(webp(1, 1, {10, 20, 30, 255}));
    Json& reference = gltf.json["materials"][0]["pbrMetallicRoughness"]["baseColorTexture"];
    reference["texCoord"] = 1;
    const auto first = [&gltf] {
        const ImportedModel model = gltf.read();
        const KM_Mesh& mesh = *model.meshes.at(0).placed.mesh;
        return mesh.m_T[mesh.m_F[0].vi[0]];
    };
    EXPECT_EQ(first(), KM_2fPoint(0.5F, 1.0F));
    reference["extensions"]["KHR_texture_transform"] = {{"texCoord", 0}, {"offset", {0.25, 0.5}}};
    EXPECT_EQ(first(), KM_2fPoint(0.25F, 0.5F));
}

TEST(GltfTexture, PngThatUnpacksToMoreThanItsSizeStatesIsReadInItsSize) {
    const std::string row = std::string(1, '\0') + std::string(12, '\x40');
    const ImportedModel fit = textured(png(4, 4, row + row + row + row)).read();
    ASSERT_NE(textureOf(fit), nullptr);
    EXPECT_EQ(textureOf(fit)->rgba[0], 0x40);
    // A hundred thousand times as much: what is too much is not unpacked.
    const std::string bomb = png(4, 4, std::string(10'000'000, '\0'));
    ReadingOptions options;
    options.most_memory = 1U << 20;
    const TemporaryFolder folder;
    const auto model = readModelFile(textured(bomb).write(folder), options);
    ASSERT_TRUE(model.ok());
    ASSERT_NE(textureOf(model.value()), nullptr);
    EXPECT_THAT(textureOf(model.value())->rgba, SizeIs(4 * 4 * 4));
}

TEST(GltfTexture, OfSizesThatNothingHoldsIsLeftOutBeforeItIsDecoded) {
    const ImportedModel model = textured(png(30'000, 30'000, "")).read();
    EXPECT_EQ(textureOf(model), nullptr);
    EXPECT_THAT(model.warnings, ElementsAre(HasSubstr("more than 64 million pixels")));
}

TEST(GltfTexture, ThatTheBudgetDoesNotHoldIsLeftOutAndTheBudgetNamed) {
    ReadingOptions options;
    options.most_memory = 100U << 20;
    const TemporaryFolder folder;
    const auto model = readModelFile(textured(png(8000, 8000, "")).write(folder), options);
    ASSERT_TRUE(model.ok());
    EXPECT_EQ(textureOf(model.value()), nullptr);
    EXPECT_THAT(model.value().warnings,
                ElementsAre(AllOf(HasSubstr("its textures need"), HasSubstr("of memory"))));
}

TEST(GltfMaterials, TheDiffuseColourOfGlossyMaterialsIsTheirBaseColour) {
    GltfWriter gltf = textured(webp(1, 1, {10, 20, 30, 255}));
    gltf.json["materials"] = {
        {{"extensions",
          {{"KHR_materials_pbrSpecularGlossiness",
            {{"diffuseFactor", {1, 0.5, 0, 1}}, {"diffuseTexture", {{"index", 0}}}}}}}}};
    const ImportedModel model = gltf.read();
    EXPECT_NE(textureOf(model), nullptr);
    EXPECT_EQ(model.meshes.at(0).placed.material->base_color, (KM_Color{255, 188, 0, 255}));
}

TEST(GltfMaterials, AreWhiteWhereThereIsNone) {
    GltfWriter gltf;
    gltf.triangle();
    EXPECT_EQ(gltf.read().meshes.at(0).placed.material->base_color, (KM_Color{255, 255, 255, 255}));
    gltf.primitive()["material"] = 5;
    const ImportedModel model = gltf.read();
    EXPECT_EQ(model.meshes.at(0).placed.material->base_color, (KM_Color{255, 255, 255, 255}));
    EXPECT_THAT(model.warnings, ElementsAre(HasSubstr("names material 5, which is not there")));
}

} // namespace
} // namespace quarn::test
