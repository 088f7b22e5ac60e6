#include "engine/scene/MaterialCheck.h"
#include "host/document/file/ChunkIds.h"
#include "host/document/file/DocumentHeader.h"
#include "tests/host/document/CodedContent.h"
#include "tests/host/document/DocumentFixtures.h"
#include "tests/host/document/QualityChanges.h"
#include "tests/host/document/SampleContent.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <cstring>
#include <limits>

namespace quarn::test {
namespace {

void addObject(DocumentContent& content, const Material& material) {
    ObjectContent object;
    object.id = sampleId(100 + static_cast<std::uint32_t>(content.objects.size()));
    object.placed.mesh = boxMesh({0, 0, 0}, {1, 1, 1});
    object.placed.material = std::make_shared<Material>(material);
    content.objects.push_back(object);
}

DocumentContent contentWith(const Material& material) {
    DocumentContent content;
    addObject(content, material);
    return content;
}

/// The material that comes back; the default one, with a failure told, where none does.
Material roundTrip(const Material& material) {
    const DocumentContent content = decoded(encoded(contentWith(material)));
    if (content.objects.size() == 1 && content.objects[0].placed.material)
        return *content.objects[0].placed.material;
    ADD_FAILURE();
    return {};
}

struct Chunk {
    std::uint32_t id = 0;
    Bytes payload;
};

std::vector<Chunk> chunksOf(const Bytes& file) {
    constexpr std::size_t HEAD = DOCUMENT_MAGIC.size() + 4;
    KM_BinaryArchive archive = KM_BinaryArchive::ForReading(std::span(file).subspan(HEAD));
    std::vector<Chunk> chunks;
    std::uint64_t length = 0;
    for (Chunk chunk; archive.BytesLeft() > 0 && archive.BeginReadChunk(chunk.id, length);) {
        chunk.payload.resize(length);
        EXPECT_TRUE(archive.ReadBytes(chunk.payload) && archive.EndReadChunk());
        chunks.push_back(chunk);
    }
    return chunks;
}

Bytes fileOf(const std::vector<Chunk>& chunks) {
    KM_BinaryArchive archive = KM_BinaryArchive::ForWriting();
    archive.WriteBytes(DOCUMENT_MAGIC);
    archive.WriteInt(KM_CURRENT_ARCHIVE_VERSION);
    for (const auto& [id, payload] : chunks) {
        archive.BeginWriteChunk(id);
        archive.WriteBytes(payload);
        archive.EndWriteChunk();
    }
    return archive.TakeBytes();
}

std::size_t countOf(const std::vector<Chunk>& chunks, std::uint32_t id) {
    return static_cast<std::size_t>(std::ranges::count(chunks, id, &Chunk::id));
}

Bytes& surfaceOf(std::vector<Chunk>& chunks) {
    return std::ranges::find(chunks, chunk::SURFACE, &Chunk::id)->payload;
}

/// The file of a material in which a float of its surface, after the version, is another.
Bytes withNumber(const Material& material, std::size_t at, float number) {
    auto chunks = chunksOf(encoded(contentWith(material)));
    std::memcpy(surfaceOf(chunks).data() + 8 + at, &number, sizeof number);
    return fileOf(chunks);
}

TEST(SurfaceCoding, EveryQualityComesBackByItself) {
    for (const QualityChange& change : qualityChanges()) {
        SCOPED_TRACE(change.name);
        Material material;
        change.make(material);
        const Material back = roundTrip(material);
        EXPECT_TRUE(change.is_made(back));
        for (const QualityChange& other : qualityChanges())
            EXPECT_EQ(other.is_made(back), other.name == change.name) << other.name;
    }
}

TEST(SurfaceCoding, AllQualitiesComeBackTogether) {
    const Material back = roundTrip(changedMaterial());
    EXPECT_EQ(L"Lack", back.name.View());
    for (const QualityChange& change : qualityChanges())
        EXPECT_TRUE(change.is_made(back)) << change.name;
}

TEST(SurfaceCoding, AMaterialOfItsBaseColourAloneIsWrittenAsEver) {
    Material material;
    material.base_color = {9, 8, 7, 100};
    material.base_color_texture = pairOfPixels(1);
    const auto chunks = chunksOf(encoded(contentWith(material)));
    EXPECT_EQ(0U, countOf(chunks, chunk::SURFACE));
    const Material back = roundTrip(material);
    EXPECT_EQ(0.0F, back.metalness);
    EXPECT_EQ(1.0F, back.roughness);
    EXPECT_EQ(1.5F, back.index_of_refraction);
    EXPECT_TRUE(std::isinf(back.attenuation_distance));
}

TEST(SurfaceCoding, ATextureOfSeveralQualitiesAndMaterialsStandsInTheFileOnce) {
    const auto texture = pairOfPixels(1);
    Material material;
    material.base_color_texture = texture;
    material.emission_texture.texture = texture;
    material.metal_rough.texture = texture;
    DocumentContent content = contentWith(material);
    Material second;
    second.normals.texture = texture;
    addObject(content, second);
    const Bytes bytes = encoded(content);
    EXPECT_EQ(1U, countOf(chunksOf(bytes), chunk::TEXTURE));
    const DocumentContent back = decoded(bytes);
    const Material& first_back = *back.objects[0].placed.material;
    EXPECT_EQ(first_back.base_color_texture, first_back.emission_texture.texture);
    EXPECT_EQ(first_back.base_color_texture, first_back.metal_rough.texture);
    EXPECT_EQ(first_back.base_color_texture, back.objects[1].placed.material->normals.texture);
}

TEST(SurfaceCoding, OlderVersionsHoldTheBaseColourAlone) {
    Material material = changedMaterial();
    material.base_color_texture = pairOfPixels(200);
    DocumentContent content = contentWith(material);
    for (const int version : {3, 4}) {
        content.version = version;
        const Bytes bytes = encoded(content);
        EXPECT_EQ(0U, countOf(chunksOf(bytes), chunk::SURFACE));
        EXPECT_EQ(1U, countOf(chunksOf(bytes), chunk::TEXTURE));
        const Material back = *decoded(bytes).objects[0].placed.material;
        EXPECT_EQ(L"Lack", back.name.View());
        EXPECT_TRUE(back.base_color_texture);
        for (const QualityChange& change : qualityChanges())
            EXPECT_FALSE(change.is_made(back)) << change.name;
    }
}

TEST(SurfaceCoding, WhatANewerLayoutAddsIsPassedOver) {
    auto chunks = chunksOf(encoded(contentWith(changedMaterial())));
    surfaceOf(chunks).push_back(17);
    EXPECT_FALSE(decodeDocument(fileOf(chunks))) << "longer than its own layout";
    surfaceOf(chunks)[4] = 1;
    const DocumentContent content = decoded(fileOf(chunks));
    for (const QualityChange& change : qualityChanges())
        EXPECT_TRUE(change.is_made(*content.objects[0].placed.material)) << change.name;
    surfaceOf(chunks)[0] = 2;
    EXPECT_FALSE(decodeDocument(fileOf(chunks))) << "another major version";
}

TEST(SurfaceCoding, ASurfaceCutAnywhereIsRefused) {
    const auto chunks = chunksOf(encoded(contentWith(changedMaterial())));
    auto cut = chunks;
    const std::size_t whole = surfaceOf(cut).size();
    for (std::size_t size = 0; size < whole; ++size) {
        cut = chunks;
        surfaceOf(cut).resize(size);
        ASSERT_FALSE(decodeDocument(fileOf(cut))) << size;
    }
}

TEST(SurfaceCoding, ATextureThatIsNotThereIsRefused) {
    // Behind the version: metalness, roughness, then the place of their texture.
    auto chunks = chunksOf(encoded(contentWith(changedMaterial())));
    for (const std::int32_t place : {-2, 11, std::numeric_limits<std::int32_t>::max()}) {
        std::memcpy(surfaceOf(chunks).data() + 16, &place, sizeof place);
        EXPECT_FALSE(decodeDocument(fileOf(chunks))) << place;
    }
}

TEST(SurfaceCoding, NumbersBeyondTheirLimitsAreMovedToThem) {
    constexpr float INF = std::numeric_limits<float>::infinity();
    Material material;
    material.metalness = 0.5F;
    const auto read = [&](std::size_t at, float number) {
        return *decoded(withNumber(material, at, number)).objects[0].placed.material;
    };
    EXPECT_EQ(1.0F, read(0, 7.0F).metalness);
    EXPECT_EQ(0.0F, read(0, -INF).metalness);
    EXPECT_EQ(0.0F, read(0, std::nanf("")).metalness);
    EXPECT_EQ(1.0F, read(4, std::nanf("")).roughness);
    // Behind two textures that are not there, the scale of normals; behind one more, occlusion.
    EXPECT_EQ(1.0F, read(16, std::nanf("")).normal_scale);
    EXPECT_EQ(0.0F, read(24, -1.0F).occlusion_strength);
    EXPECT_EQ((LinearRgb{0.0F, MOST_EMISSION, 0.0F}), read(32, 1e30F).emission);
}

TEST(SurfaceCoding, AMaterialWithNumbersThatAreNoneIsSavedAsOneThatCanBeDrawn) {
    Material material;
    material.metalness = std::nanf("");
    material.index_of_refraction = 0.0F;
    material.emission = {1e30F, 0.0F, 0.0F};
    const Material back = roundTrip(material);
    EXPECT_EQ(0.0F, back.metalness);
    EXPECT_EQ(1.5F, back.index_of_refraction);
    EXPECT_EQ(MOST_EMISSION, back.emission[0]);
}

/// What a program that does not know surfaces makes of a file: it keeps their chunks behind all
/// others and drops the textures that only they name.
Bytes savedByAnOlderProgram(const Bytes& bytes) {
    std::vector<Chunk> kept;
    std::vector<Chunk> unknown;
    for (const Chunk& one : chunksOf(bytes))
        if (one.id == chunk::SURFACE)
            unknown.push_back(one);
        else if (one.id != chunk::TEXTURE)
            kept.push_back(one);
    kept.insert(kept.end() - 1, unknown.begin(), unknown.end());
    return fileOf(kept);
}

TEST(SurfaceCoding, WhatAnOlderProgramPutElsewhereIsTakenForNoOthers) {
    DocumentContent content = contentWith(changedMaterial());
    addObject(content, Material());
    EXPECT_FALSE(decoded(encoded(content)).lost_surfaces);
    const DocumentContent back = decoded(savedByAnOlderProgram(encoded(content)));
    EXPECT_TRUE(back.lost_surfaces);
    EXPECT_TRUE(back.unknown.empty());
    ASSERT_EQ(2U, back.objects.size());
    for (const ObjectContent& object : back.objects)
        for (const QualityChange& change : qualityChanges())
            EXPECT_FALSE(change.is_made(*object.placed.material)) << change.name;
    EXPECT_FALSE(decoded(encoded(back)).lost_surfaces) << "told once";
}

} // namespace
} // namespace quarn::test
