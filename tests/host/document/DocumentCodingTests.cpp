#include "host/document/LightStore.h"
#include "host/document/file/ChunkIds.h"
#include "host/document/file/DocumentHeader.h"
#include "kelmar/KM_LineCurve.h"
#include "kelmar/KM_NurbsCurve.h"
#include "kelmar/KM_PolylineCurve.h"
#include "tests/host/document/CodedContent.h"
#include "tests/host/document/SampleContent.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>
#include <functional>
#include <limits>

namespace quarn {

namespace {

using test::Bytes;
using test::decoded;
using test::encoded;
using test::sampleContent;
using test::sampleId;
using testing::HasSubstr;
using Payload = std::function<void(KM_BinaryArchive&)>;

DocumentContent roundTrip(const DocumentContent& content) {
    return decoded(encoded(content));
}

/// A file put together by hand, each chunk with a right check sequence.
class FileByHand {
public:
    FileByHand() {
        m_archive.WriteBytes(DOCUMENT_MAGIC);
        m_archive.WriteInt(KM_CURRENT_ARCHIVE_VERSION);
    }
    FileByHand& add(std::uint32_t id, const Payload& payload) {
        m_archive.BeginWriteChunk(id);
        payload(m_archive);
        m_archive.EndWriteChunk();
        return *this;
    }
    FileByHand& addSettings(double tolerance = 0.001, double sun_length = 1.0) {
        return add(chunk::SETTINGS, [=](KM_BinaryArchive& archive) {
            archive.WriteInt(0);
            archive.WriteDouble(tolerance);
            archive.WriteBool(true);
            archive.WriteVector({0.0, 0.0, sun_length});
            archive.WriteInt(0);
        });
    }
    Bytes ended() {
        add(chunk::END,
            [](KM_BinaryArchive& archive) { archive.WriteInt(KM_CURRENT_ARCHIVE_VERSION); });
        return m_archive.TakeBytes();
    }
    Bytes cutOff() { return m_archive.TakeBytes(); }

private:
    KM_BinaryArchive m_archive = KM_BinaryArchive::ForWriting();
};

void expectRefused(const Bytes& bytes, const std::string& words = "damaged") {
    const auto content = decodeDocument(bytes);
    ASSERT_FALSE(content);
    EXPECT_THAT(content.message(), HasSubstr(words));
}

/// An object's chunk up to its geometry.
void writeAttributes(KM_BinaryArchive& archive, int kind, const KM_UUID& id = sampleId(1)) {
    archive.WriteUuid(id);
    archive.WriteString(L"x");
    archive.WriteBool(true);
    archive.WriteInt(kind);
}

Bytes fileWithObject(const Payload& payload) {
    return FileByHand().addSettings().add(chunk::OBJECT, payload).ended();
}

} // namespace

TEST(DocumentCoding, AnEmptyDocumentComesBack) {
    const DocumentContent content = roundTrip(DocumentContent());
    EXPECT_TRUE(content.objects.empty());
    EXPECT_TRUE(content.views.empty());
    EXPECT_EQ(KM_CURRENT_ARCHIVE_VERSION, content.version);
}

TEST(DocumentCoding, WhatIsReadIsWrittenAgainAsTheSameBytes) {
    const Bytes bytes = encoded(sampleContent());
    EXPECT_EQ(bytes, encoded(decoded(bytes)));
}

TEST(DocumentCoding, SettingsComeBack) {
    const SettingsContent settings = roundTrip(sampleContent()).settings;
    EXPECT_EQ(UnitSystem::feet, settings.units);
    EXPECT_EQ(0.0125, settings.absolute_tolerance);
    EXPECT_FALSE(settings.sun_enabled);
    EXPECT_EQ(KM_3dVector(0.6, 0.0, 0.8), settings.direction_to_sun);
}

TEST(DocumentCoding, MeshesWithTheirMaterialsAndTexturesComeBack) {
    const DocumentContent sample = sampleContent();
    const DocumentContent content = roundTrip(sample);
    ASSERT_EQ(sample.objects.size(), content.objects.size());
    const ObjectContent& box = content.objects[0];
    EXPECT_EQ(sampleId(1), box.id);
    EXPECT_EQ(L"Kiste", box.name.View());
    EXPECT_TRUE(box.visible);
    EXPECT_EQ(sample.objects[0].placed.mesh->m_V, box.placed.mesh->m_V);
    EXPECT_EQ(sample.objects[0].placed.mesh->m_N, box.placed.mesh->m_N);
    EXPECT_EQ(sample.objects[0].placed.mesh->m_T, box.placed.mesh->m_T);
    EXPECT_EQ(sample.objects[0].placed.mesh->m_C, box.placed.mesh->m_C);
    EXPECT_EQ(sample.objects[0].placed.mesh->m_F, box.placed.mesh->m_F);
    ASSERT_TRUE(box.placed.material);
    EXPECT_EQ(L"Kachel", box.placed.material->name.View());
    EXPECT_EQ((KM_Color{1, 2, 3, 200}), box.placed.material->base_color);
    EXPECT_TRUE(box.placed.material->alpha_cutout);
    EXPECT_EQ(0.25F, box.placed.material->alpha_cutoff);
    const Texture& texture = *box.placed.material->base_color_texture;
    EXPECT_EQ(2, texture.width);
    EXPECT_EQ(1, texture.height);
    EXPECT_EQ(TextureWrap::mirror, texture.wrap_u);
    EXPECT_EQ(TextureWrap::clamp, texture.wrap_v);
    EXPECT_EQ((Bytes{255, 255, 255, 255, 10, 20, 30, 128}), texture.rgba);
    EXPECT_FALSE(content.objects[1].visible);
    EXPECT_FALSE(content.objects[1].placed.material);
}

TEST(DocumentCoding, SeeThroughMaterialsComeBackAndOthersAreWrittenAsEver) {
    DocumentContent content = sampleContent();
    const Bytes before = encoded(content);
    auto material = std::make_shared<Material>(*content.objects[0].placed.material);
    material->see_through = true;
    content.objects[0].placed.material = material;
    EXPECT_TRUE(roundTrip(content).objects[0].placed.material->see_through);
    EXPECT_EQ(before.size() + 1, encoded(content).size());
    EXPECT_FALSE(roundTrip(sampleContent()).objects[0].placed.material->see_through);
}

TEST(DocumentCoding, AMeshThatObjectsShareIsWrittenOnceAndSharedAgain) {
    const DocumentContent sample = sampleContent();
    const DocumentContent content = roundTrip(sample);
    EXPECT_EQ(content.objects[0].placed.mesh, content.objects[1].placed.mesh);

    DocumentContent without_second = sample;
    without_second.objects.erase(without_second.objects.begin() + 1);
    const std::size_t second_object = encoded(sample).size() - encoded(without_second).size();
    EXPECT_LT(second_object, 100U) << "a box alone takes more";
}

TEST(DocumentCoding, CurvesOfEveryTypeComeBackToTheLastBit) {
    const DocumentContent sample = sampleContent();
    const DocumentContent content = roundTrip(sample);
    const auto* polyline = dynamic_cast<const KM_PolylineCurve*>(content.objects[2].curve.get());
    ASSERT_TRUE(polyline);
    EXPECT_EQ((std::vector<double>{0.0, 0.25, 7.0}), polyline->Parameters());
    EXPECT_EQ(KM_3dPoint(1, 5, 0.1), polyline->Points()[2]);
    const auto* line = dynamic_cast<const KM_LineCurve*>(content.objects[3].curve.get());
    ASSERT_TRUE(line);
    EXPECT_EQ(KM_3dPoint(0, 0, 1.0 / 3.0), line->m_line.to);
    EXPECT_EQ(2.0, line->Domain().Min());
    EXPECT_EQ(4.0, line->Domain().Max());
    const auto* nurbs = dynamic_cast<const KM_NurbsCurve*>(content.objects[4].curve.get());
    ASSERT_TRUE(nurbs);
    EXPECT_TRUE(nurbs->IsRational());
    EXPECT_EQ(0.7, nurbs->Weight(1));
    for (const double t : {-1.0, 0.123, 1.7, 3.0})
        EXPECT_EQ(sample.objects[4].curve->PointAt(t), nurbs->PointAt(t));
}

TEST(DocumentCoding, PointsComeBack) {
    const ObjectContent point = roundTrip(sampleContent()).objects[5];
    EXPECT_EQ(KM_3dPoint(0.1, 0.2, 0.3), point.point);
    EXPECT_FALSE(point.placed.mesh);
    EXPECT_FALSE(point.curve);
}

TEST(DocumentCoding, ViewsAndCamerasComeBackToTheLastBit) {
    const DocumentContent sample = sampleContent();
    const DocumentContent content = roundTrip(sample);
    ASSERT_EQ(2U, content.views.size());
    for (std::size_t i = 0; i < 2; ++i) {
        EXPECT_EQ(sample.views[i].name, content.views[i].name);
        EXPECT_EQ(sample.views[i].viewport, content.views[i].viewport);
        EXPECT_EQ(sample.views[i].display_mode, content.views[i].display_mode);
        EXPECT_EQ(sample.views[i].width_px, content.views[i].width_px);
        EXPECT_EQ(sample.views[i].height_px, content.views[i].height_px);
        EXPECT_EQ(sample.views[i].active, content.views[i].active);
    }
    ASSERT_EQ(1U, content.cameras.size());
    EXPECT_EQ(L"Kamera 1", content.cameras[0].name.View());
    EXPECT_EQ(sample.cameras[0].viewport, content.cameras[0].viewport);
    ASSERT_EQ(1U, content.edges.size());
    EXPECT_EQ(wireframe_mode_id, content.edges[0].display_mode);
    EXPECT_EQ(MeshEdgeChoice::all, content.edges[0].choice);
}

TEST(DocumentCoding, RenderSettingsComeBackOrAreThoseOfANewDocument) {
    DocumentContent content = sampleContent();
    EXPECT_EQ((RenderSettings{640, 360, 128, 4}), roundTrip(content).rendering);
    content.rendering.reset();
    EXPECT_FALSE(roundTrip(content).rendering);
}

Bytes littleEndian(std::initializer_list<std::int32_t> numbers) {
    Bytes bytes;
    for (const std::int32_t number : numbers)
        for (int shift = 0; shift < 32; shift += 8)
            bytes.push_back(static_cast<std::uint8_t>(static_cast<std::uint32_t>(number) >> shift));
    return bytes;
}

TEST(DocumentCoding, RenderSettingsOutOfRangeAreRefused) {
    constexpr std::uint32_t rndr = 0x52444E52; // spells RNDR
    DocumentContent content = sampleContent();
    content.rendering.reset();
    const auto with = [&](const Bytes& payload) {
        content.unknown = {{rndr, payload}};
        return encoded(content);
    };
    EXPECT_TRUE(decodeDocument(with(littleEndian({1, 16384, 16384, 1}))).ok());
    for (const int wrong : {0, -1, 16385, std::numeric_limits<int>::max()}) {
        expectRefused(with(littleEndian({wrong, 10, 10, 10})));
        expectRefused(with(littleEndian({10, wrong, 10, 10})));
        expectRefused(with(littleEndian({10, 10, wrong, 10})));
        expectRefused(with(littleEndian({10, 10, 10, wrong})));
    }
    expectRefused(with(littleEndian({10, 10, 10})));
    expectRefused(with(littleEndian({10, 10, 10, 10, 10})));
    content.rendering = RenderSettings();
    expectRefused(with(littleEndian({10, 10, 10, 10}))); // twice
    content.unknown.clear();
    content.rendering = RenderSettings{0, 10, 10, 10};
    EXPECT_FALSE(encodeDocument(content));
}

TEST(DocumentCoding, LightsComeBackWithTheirIndices) {
    const DocumentContent sample = sampleContent();
    const DocumentContent content = roundTrip(sample);
    EXPECT_EQ(5, content.settings.light_slots);
    ASSERT_EQ(1U, content.lights.size());
    EXPECT_EQ(1, content.lights[0].index);
    EXPECT_EQ(sample.lights[0].light, content.lights[0].light);
}

TEST(DocumentCoding, LightsStandInSlotsThatAreThere) {
    DocumentContent content = sampleContent();
    content.lights[0].index = 5;
    expectRefused(encoded(content));
    content.lights[0].index = -1;
    expectRefused(encoded(content));
    content.lights[0].index = 1;
    content.lights.push_back(content.lights[0]);
    expectRefused(encoded(content));
    content = sampleContent();
    for (const int slots : {-1, LightStore::most_slots + 1, std::numeric_limits<int>::max()}) {
        content.settings.light_slots = slots;
        EXPECT_FALSE(encodeDocument(content));
    }
}

TEST(DocumentCoding, WhatOthersWroteComesBackByteForByte) {
    const DocumentContent sample = sampleContent();
    const DocumentContent content = roundTrip(sample);
    ASSERT_EQ(1U, content.plug_ins.size());
    EXPECT_EQ(sampleId(41), content.plug_ins[0].plug_in_id);
    EXPECT_EQ(sample.plug_ins[0].bytes, content.plug_ins[0].bytes);
    ASSERT_EQ(1U, content.unknown.size());
    EXPECT_EQ(0x58595A41U, content.unknown[0].id);
    EXPECT_EQ((Bytes{1, 2, 3, 4, 5}), content.unknown[0].payload);
}

TEST(DocumentCoding, AFileCutAtAnyByteIsRefused) {
    const Bytes whole = encoded(sampleContent());
    for (std::size_t size = 0; size < whole.size(); ++size) {
        const Bytes cut(whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(size));
        ASSERT_FALSE(decodeDocument(cut)) << "cut to " << size << " bytes";
    }
}

TEST(DocumentCoding, AFileWithAnyBitFlippedIsRefused) {
    const Bytes whole = encoded(sampleContent());
    for (std::size_t at = 0; at < whole.size(); ++at) {
        for (int bit = 0; bit < 8; ++bit) {
            Bytes flipped = whole;
            flipped[at] ^= static_cast<std::uint8_t>(1 << bit);
            ASSERT_FALSE(decodeDocument(flipped)) << "byte " << at << ", bit " << bit;
        }
    }
}

TEST(DocumentCoding, ARefusalTellsWhatIsWrong) {
    expectRefused({}, "no document");
    expectRefused({'o', ' ', 'B', 'o', 'x', '\n', 'v', ' ', '0'}, "no document");
    expectRefused(FileByHand().addSettings().cutOff(), "cut off");
    Bytes newer = encoded(DocumentContent());
    newer[DOCUMENT_MAGIC.size()] = 6;
    expectRefused(newer, "version 6, and this program reads documents up to version 5");
}

TEST(DocumentCoding, OldVersionsAreWrittenAndReadAndNoneOlder) {
    DocumentContent content = sampleContent();
    for (int version = OLDEST_DOCUMENT_VERSION; version <= KM_CURRENT_ARCHIVE_VERSION; ++version) {
        content.version = version;
        EXPECT_EQ(version, roundTrip(content).version);
    }
    content.version = OLDEST_DOCUMENT_VERSION - 1;
    expectRefused(encoded(content));
}

TEST(DocumentCoding, SettingsStandOnceAndMakeSense) {
    EXPECT_TRUE(decodeDocument(FileByHand().addSettings().ended()));
    expectRefused(FileByHand().ended());
    expectRefused(FileByHand().addSettings().addSettings().ended());
    expectRefused(FileByHand().addSettings(0.0).ended());
    expectRefused(FileByHand().addSettings(std::nan("")).ended());
    expectRefused(FileByHand().addSettings(0.001, 2.0).ended());
}

TEST(DocumentCoding, NothingFollowsTheEnd) {
    Bytes bytes = encoded(DocumentContent());
    bytes.push_back(0);
    expectRefused(bytes);
}

TEST(DocumentCoding, CountsThatTheFileCannotHoldAreRefusedWithoutAskingForMemory) {
    for (const std::uint64_t count :
         {std::uint64_t{1} << 31, std::uint64_t{1} << 63, std::uint64_t{0x7FFFFFFF}}) {
        const Payload vertices = [count](KM_BinaryArchive& archive) {
            archive.WriteInt64(static_cast<std::int64_t>(count));
            archive.WriteFloat(1.0F);
        };
        expectRefused(FileByHand().addSettings().add(chunk::MESH, vertices).ended());
        expectRefused(fileWithObject([count](KM_BinaryArchive& archive) {
            writeAttributes(archive, 2);
            archive.WriteInt(2);
            archive.WriteInt64(static_cast<std::int64_t>(count));
        }));
        const Payload name = [count](KM_BinaryArchive& archive) {
            archive.WriteUuid(sampleId(1));
            archive.WriteInt64(static_cast<std::int64_t>(count));
        };
        expectRefused(fileWithObject(name));
    }
}

TEST(DocumentCoding, ATextureHasAsManyPixelsAsItsSidesSay) {
    const auto texture = [](int width, int height, std::size_t bytes) {
        return FileByHand()
            .addSettings()
            .add(chunk::TEXTURE,
                 [=](KM_BinaryArchive& archive) {
                     for (const int number : {width, height, 0, 0, 0})
                         archive.WriteInt(number);
                     archive.WriteCount(bytes);
                     archive.WriteBytes(Bytes(bytes));
                 })
            .ended();
    };
    EXPECT_TRUE(decodeDocument(texture(2, 1, 8)));
    expectRefused(texture(2, 1, 4));
    expectRefused(texture(0, 1, 0));
    expectRefused(texture(-2, -1, 8));
    expectRefused(texture(0x10000, 0x10000, 0));
}

TEST(DocumentCoding, PointsThatAreNoNumbersAreRefused) {
    const double nan = std::numeric_limits<double>::quiet_NaN();
    const double infinity = std::numeric_limits<double>::infinity();
    for (const double bad : {nan, infinity, -infinity, KM_UNSET_VALUE}) {
        expectRefused(fileWithObject([bad](KM_BinaryArchive& archive) {
            writeAttributes(archive, 3);
            archive.WritePoint({0.0, bad, 0.0});
        }));
        expectRefused(fileWithObject([bad](KM_BinaryArchive& archive) {
            writeAttributes(archive, 2);
            archive.WriteInt(1);
            archive.WritePoint({0.0, 0.0, 0.0});
            archive.WritePoint({bad, 0.0, 0.0});
            archive.WriteDouble(0.0);
            archive.WriteDouble(1.0);
        }));
    }
}

TEST(DocumentCoding, KindsThatDoNotExistAreRefused) {
    for (const int kind : {-1, 0, 4, 17})
        expectRefused(fileWithObject([kind](KM_BinaryArchive& archive) {
            writeAttributes(archive, kind);
            archive.WritePoint({0.0, 0.0, 0.0});
        }));
    expectRefused(fileWithObject([](KM_BinaryArchive& archive) {
        writeAttributes(archive, 2);
        archive.WriteInt(17);
    }));
}

TEST(DocumentCoding, AnObjectNamesAMeshThatIsThere) {
    for (const int mesh : {-1, 0, 1, std::numeric_limits<int>::max()})
        expectRefused(fileWithObject([mesh](KM_BinaryArchive& archive) {
            writeAttributes(archive, 1);
            archive.WriteInt(mesh);
            archive.WriteInt(-1);
        }));
}

TEST(DocumentCoding, ATriangleNamesVerticesThatAreThere) {
    DocumentContent content;
    ObjectContent object = sampleContent().objects[0];
    auto mesh = std::make_shared<KM_Mesh>(*object.placed.mesh);
    mesh->m_F[3].vi[1] = 8;
    object.placed.mesh = mesh;
    content.objects.push_back(object);
    expectRefused(encoded(content));
}

TEST(DocumentCoding, IdsAndViewNamesMeanOneThing) {
    DocumentContent content = sampleContent();
    content.objects[1].id = content.objects[0].id;
    expectRefused(encoded(content));

    content = sampleContent();
    content.views[1].name = L"PERSPECTIVE";
    expectRefused(encoded(content));

    content = sampleContent();
    content.plug_ins.push_back(content.plug_ins[0]);
    expectRefused(encoded(content));

    expectRefused(fileWithObject([](KM_BinaryArchive& archive) {
        writeAttributes(archive, 3, KM_nil_uuid);
        archive.WritePoint({0.0, 0.0, 0.0});
    }));
}

TEST(DocumentCoding, WhatCannotBeReadAgainIsNotWritten) {
    const auto expectNotWritten = [](const DocumentContent& content, const std::string& name) {
        const auto bytes = encodeDocument(content);
        ASSERT_FALSE(bytes);
        EXPECT_THAT(bytes.message(), HasSubstr(name));
    };
    DocumentContent content = sampleContent();
    auto line = std::make_shared<KM_LineCurve>();
    line->m_line.to = KM_3dPoint(std::nan(""), 0.0, 0.0);
    content.objects[3].curve = line;
    expectNotWritten(content, "\"Achse\"");

    content = sampleContent();
    content.objects[5].point = KM_3dPoint::UnsetPoint;
    expectNotWritten(content, "\"Blick\"");

    content = sampleContent();
    content.views[0].width_px = 0;
    expectNotWritten(content, "a view");
}

} // namespace quarn
