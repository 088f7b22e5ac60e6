#include "tests/import/ModelFixtures.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <bit>
#include <cstring>

namespace quarn::test {
namespace {

using ::testing::Contains;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::SizeIs;

const std::string PLACES = "property float x\nproperty float y\nproperty float z\n";
const std::string LIST = "property list uchar int vertex_indices\n";

std::string text(const std::string& elements, const std::string& lines,
                 const std::string& comments = "") {
    return "ply\nformat ascii 1.0\n" + comments + elements + "end_header\n" + lines;
}

ImportedModel read(const std::string& bytes) {
    const TemporaryFolder folder;
    return readOrFail(folder.write("a.ply", bytes));
}

std::string whyNot(const std::string& bytes) {
    const TemporaryFolder folder;
    const auto model = readModelFile(folder.write("a.ply", bytes));
    return model.ok() ? "it was read" : model.message();
}

const KM_Mesh& onlyMesh(const ImportedModel& model) {
    static const KM_Mesh none;
    EXPECT_THAT(model.meshes, SizeIs(1));
    return model.meshes.empty() ? none : *model.meshes[0].placed.mesh;
}

template <class Number> void append(std::string& bytes, Number number, bool big_endian) {
    char raw[sizeof number];
    std::memcpy(raw, &number, sizeof number);
    if (big_endian == (std::endian::native == std::endian::little))
        std::reverse(std::begin(raw), std::end(raw));
    bytes.append(raw, sizeof raw);
}

TEST(PlyReader, BinaryNumbersOfAnyTypeAndOrderAreRead) {
    for (const bool big_endian : {false, true}) {
        std::string bytes = std::string("ply\nformat binary_") + (big_endian ? "big" : "little") +
                            "_endian 1.0\nelement vertex 3\nproperty short flags\n"
                            "property double z\nproperty int8 x\nproperty ushort y\n"
                            "element stone 2\nproperty list uchar double size\n"
                            "element face 1\nproperty list uint ushort vertex_index\n"
                            "property uchar flags\nend_header\n";
        const int places[3][3] = {{0, 0, 5}, {-7, 300, 5}, {1, 2, 6}};
        for (const auto& [x, y, z] : places) {
            append<std::int16_t>(bytes, 77, big_endian);
            append<double>(bytes, z, big_endian);
            append(bytes, static_cast<std::int8_t>(x), big_endian);
            append(bytes, static_cast<std::uint16_t>(y), big_endian);
        }
        for (const std::uint8_t count : {2, 0}) {
            append(bytes, count, big_endian);
            for (int i = 0; i < count; ++i)
                append(bytes, 1.5, big_endian);
        }
        append<std::uint32_t>(bytes, 3, big_endian);
        for (const std::uint16_t index : {2, 0, 1})
            append(bytes, index, big_endian);
        bytes += '\7';
        const KM_Mesh mesh = onlyMesh(read(bytes));
        EXPECT_THAT(mesh.m_V,
                    ElementsAre(KM_3fPoint(0, 0, 5), KM_3fPoint(-7, 300, 5), KM_3fPoint(1, 2, 6)));
        EXPECT_THAT(mesh.m_F, ElementsAre(KM_MeshTriangle{{2, 0, 1}}));
    }
}

TEST(PlyReader, DoublesFarFromTheOriginKeepTheirDigits) {
    const ImportedModel model =
        read(text("element vertex 3\nproperty double x\nproperty double y\nproperty double z\n"
                  "element face 1\n" +
                      LIST,
                  "4500000.125 5300000 210\n4500001.25 5300000 210\n4500000 5300002 210\n"
                  "3 0 1 2\n"));
    EXPECT_THAT(model.warnings, IsEmpty());
    const KM_BoundingBox box = boundsOf(model);
    EXPECT_DOUBLE_EQ(box.m_max.x, 4500001.25);
    EXPECT_DOUBLE_EQ(box.m_max.y, 5300002.0);
    ASSERT_THAT(model.meshes, SizeIs(1));
    const PlacedMesh& placed = model.meshes[0].placed;
    EXPECT_DOUBLE_EQ((placed.world_from_mesh * placed.mesh->m_V[0].ToDouble()).x, 4500000.125);
}

TEST(PlyReader, NormalsAndTextureCoordinatesOfTheFileAreKept) {
    const std::string more = "property float nx\nproperty float ny\nproperty float nz\n"
                             "property float s\nproperty float t\n";
    const KM_Mesh mesh =
        onlyMesh(read(text("element vertex 3\n" + PLACES + more + "element face 1\n" + LIST,
                           "0 0 0 0 0 -2 0 0.5\n1 0 0 0 3 0 1 0.5\n"
                           "0 1 0 0 0 0 1 1\n3 0 1 2\n")));
    EXPECT_THAT(mesh.m_N, ElementsAre(KM_3fVector(0, 0, -1), KM_3fVector(0, 1, 0),
                                      KM_3fVector(0, 0, 1))); // the last one is made
    EXPECT_THAT(mesh.m_T, ElementsAre(KM_2fPoint(0, 0.5F), KM_2fPoint(1, 0.5F), KM_2fPoint(1, 1)));
}

TEST(PlyReader, ColoursAreSharesOfTheirTypesRangeAndWideBytesAreBytes) {
    const auto colors = [](const std::string& type, const std::string& color) {
        std::string elements = "element vertex 3\n" + PLACES;
        for (const char* const channel : {"red", "green", "blue"})
            elements += "property " + type + " diffuse_" + channel + "\n";
        return onlyMesh(read(text(elements + "element face 1\n" + LIST,
                                  "0 0 0 " + color + "\n1 0 0 " + color + "\n0 1 0 " + color +
                                      "\n3 0 1 2\n")))
            .m_C;
    };
    EXPECT_THAT(colors("ushort", "65535 32768 0"), Contains(KM_Color{255, 128, 0, 255}).Times(3));
    EXPECT_THAT(colors("int", "255 128 0"), Contains(KM_Color{255, 128, 0, 255}).Times(3));
    EXPECT_THAT(colors("double", "1 0.5 7"), Contains(KM_Color{255, 128, 255, 255}).Times(3));
}

TEST(PlyReader, TextureCoordinatesThatStandWithFacesPartTheirVertices) {
    const ImportedModel model = read(text("element vertex 4\n" + PLACES + "element face 2\n" +
                                              LIST + "property list uchar float texcoord\n",
                                          "0 0 0\n1 0 0\n1 1 0\n0 1 0\n"
                                          "3 0 1 2 6 0 0 1 0 1 1\n3 0 2 3 6 0 0 1 1 0 0.5\n",
                                          "comment TextureFile gone.png\n"));
    const KM_Mesh& mesh = onlyMesh(model);
    EXPECT_EQ(mesh.VertexCount(), 4); // those of the two faces agree at the corners that they share
    EXPECT_THAT(mesh.m_T, Contains(KM_2fPoint(0, 0.5F)));
    EXPECT_THAT(model.warnings, ElementsAre(HasSubstr("'gone.png' was left out")));
}

TEST(PlyReader, PolygonsAreCutWithinTheirOutlines) {
    const KM_Mesh mesh =
        onlyMesh(read(text("element vertex 5\n" + PLACES + "element face 1\n" + LIST,
                           "0 0 0\n4 0 0\n4 4 0\n2 1 0\n0 4 0\n5 0 1 2 3 4\n")));
    double area = 0.0;
    for (const KM_MeshTriangle& t : mesh.m_F) {
        const KM_3dPoint a = mesh.m_V[t.vi[0]].ToDouble();
        area +=
            0.5 *
            KM_CrossProduct(mesh.m_V[t.vi[1]].ToDouble() - a, mesh.m_V[t.vi[2]].ToDouble() - a).z;
    }
    EXPECT_DOUBLE_EQ(area, 10.0);
    EXPECT_EQ(mesh.TriangleCount(), 3);
}

TEST(PlyReader, StripsTurnEveryOtherTriangleAndBeginAnew) {
    const KM_Mesh mesh =
        onlyMesh(read(text("element vertex 4\n" + PLACES +
                               "element tristrips 1\nproperty list int int vertex_indices\n",
                           "0 0 0\n1 0 0\n0 1 0\n1 1 0\n8 0 1 2 3 -1 1 3 2\n")));
    EXPECT_THAT(mesh.m_F, ElementsAre(KM_MeshTriangle{{0, 1, 2}}, KM_MeshTriangle{{2, 1, 3}},
                                      KM_MeshTriangle{{1, 3, 2}}));
}

TEST(PlyReader, EdgesBecomeLinesAndFacesOfTwoAndOneCornersLinesAndPoints) {
    const ImportedModel edges =
        read(text("element vertex 3\n" + PLACES +
                      "element edge 2\nproperty int vertex1\nproperty int vertex2\n",
                  "0 0 0\n1 0 0\n0 1 0\n0 1\n1 2\n"));
    ASSERT_THAT(edges.curves, SizeIs(1));
    EXPECT_EQ(edges.curves[0].points.Count(), 3);
    EXPECT_EQ(edges.points.Count(), 0);
    const ImportedModel faces = read(text("element vertex 3\n" + PLACES + "element face 3\n" + LIST,
                                          "0 0 0\n1 0 0\n0 1 0\n3 0 1 2\n2 0 1\n1 2\n"));
    EXPECT_EQ(faces.triangleCount(), 1U);
    EXPECT_EQ(faces.curves.size(), 1U);
    EXPECT_EQ(faces.points.Count(), 1);
}

TEST(PlyReader, VerticesThatFacesDoNotShareAreJoinedAndThoseOfNoneLeftOut) {
    const KM_Mesh mesh =
        onlyMesh(read(text("element vertex 7\n" + PLACES + "element face 2\n" + LIST,
                           "0 0 0\n1 0 0\n0 1 0\n1 0 0\n1 1 0\n0 1 0\n9 9 9\n3 0 1 2\n3 3 4 5\n")));
    EXPECT_EQ(mesh.VertexCount(), 4);
    EXPECT_THAT(mesh.m_F, ElementsAre(KM_MeshTriangle{{0, 1, 2}}, KM_MeshTriangle{{1, 3, 2}}));
}

TEST(PlyReader, CoordinatesThatAreNoNumbersTakeTheirTrianglesAway) {
    for (const char* const none : {"nan", "-inf", "1e999", "-1.#IND00"}) {
        const ImportedModel model =
            read(text("element vertex 4\n" + PLACES + "element face 2\n" + LIST,
                      std::string("0 0 0\n1 0 0\n0 1 0\n") + none + " 0 0\n3 0 1 2\n3 1 2 3\n"));
        EXPECT_EQ(model.triangleCount(), 1U) << none;
        EXPECT_THAT(model.warnings, ElementsAre(HasSubstr("1 of 2 triangles were left out")));
    }
}

TEST(PlyReader, ManyPartsOfAFileAreReadIntoTheirPlaces) {
    constexpr int COUNT = 60'000; // of more bytes than one thread takes at a time
    std::string vertices;
    std::string faces;
    for (int i = 0; i < COUNT; ++i) {
        vertices += std::to_string(i) + " " + std::to_string(i % 7) + " 0\n";
        if (i >= 3)
            faces += i % 1000 == 0
                         ? "4 " + std::to_string(i - 3) + " " + std::to_string(i - 2) + " " +
                               std::to_string(i - 1) + " " + std::to_string(i) + "\n"
                         : "3 " + std::to_string(i - 2) + " " + std::to_string(i - 1) + " " +
                               std::to_string(i) + "\n";
    }
    const KM_Mesh mesh = onlyMesh(read(
        text("element vertex 60000\n" + PLACES + "element face 59997\n" + LIST, vertices + faces)));
    ASSERT_EQ(mesh.TriangleCount(), 59'997 + 59);
    EXPECT_EQ(mesh.m_V[mesh.m_F.back().vi[2]], KM_3fPoint(59'999, 59'999 % 7, 0));
    // Before line 29 974 stand 29 971 faces, of which 29 are two triangles.
    EXPECT_EQ(mesh.m_V[mesh.m_F[30'000].vi[0]].x, 29'972.0F);
}

TEST(PlyReader, WordsThatAreNoNumbersAndIndicesOfNoVertexAreToldWithTheirPlace) {
    const std::string elements = "element vertex 3\n" + PLACES + "element face 1\n" + LIST;
    EXPECT_THAT(whyNot(text(elements, "0 0 0\n0 abc 0\n0 0 0\n3 0 1 2\n")),
                HasSubstr("line 11 holds 'abc' where a number belongs"));
    EXPECT_THAT(whyNot(text(elements, "0 0 0\n1 0 0\n0 1 0\n3 0 1 ")),
                HasSubstr("line 13 ends after 2 of 3 corners"));
    EXPECT_THAT(whyNot(text(elements, "0.000 0.000 0.000\n1.000 0.000 0.000\n")),
                HasSubstr("it ends after 2 of 3 elements of kind 'vertex'"));
    std::string binary = "ply\nformat binary_little_endian 1.0\n" + elements + "end_header\n";
    const std::size_t header = binary.size();
    binary.append(36, '\0');
    binary += std::string("\3\0\0\0\0\1\0\0\0\11\0\0\0", 13);
    EXPECT_THAT(whyNot(binary), HasSubstr("face 1 at byte " + std::to_string(header + 36) +
                                          " holds the index 9, which is out of range"));
}

TEST(PlyReader, TheHeaderThatIsWrongIsToldWithItsLine) {
    EXPECT_THAT(whyNot("ply\nformat ascii 2 1.0\nelement vertex three\nend_header\n"),
                HasSubstr("header is damaged: line 3 holds 'element vertex three'"));
    EXPECT_THAT(whyNot("ply\nformat ascii 1.0\nelement vertex 1\nproperty text x\nend_header\n1\n"),
                HasSubstr("line 4 holds 'property text x'"));
    EXPECT_THAT(whyNot("ply\nformat ascii 1.0\nelement stone 1\nproperty int x\nend_header\n1\n"),
                HasSubstr("it has no vertices"));
    EXPECT_THAT(whyNot("solid\n"), HasSubstr("not a PLY file"));
}

TEST(PlyReader, BlankLinesAndLinesThatEndInReturnsAreNoHarm) {
    std::string bytes = text("element vertex 3\n" + PLACES + "element face 1\n" + LIST,
                             "\n0 0 0\n \n1 0 0\n0 1 0\n\n3 0 1 2\n\n");
    EXPECT_EQ(read(bytes).triangleCount(), 1U);
    std::ranges::replace(bytes, '\n', '\r');
    EXPECT_EQ(read(bytes).triangleCount(), 1U);
}

TEST(PlyReader, TheAxisIsTheOneOfTheWritingProgramOrOfHabitOrAskedFor) {
    const std::string elements = "element vertex 1\n" + PLACES;
    const TakenUpAxis by_habit = read(text(elements, "0 0 0\n")).up;
    EXPECT_EQ(by_habit.axis, UpAxis::z);
    EXPECT_EQ(by_habit.reason, TakenUpAxis::Reason::habit);
    const TakenUpAxis by_writer =
        read(text(elements, "0 0 0\n", "comment Created by Blender 2.79 (sub 0)\n")).up;
    EXPECT_EQ(by_writer.reason, TakenUpAxis::Reason::writer);
    EXPECT_EQ(by_writer.writer, "Blender");
    const TemporaryFolder folder;
    ReadingOptions options;
    options.up = UpAxis::y;
    const auto asked = readModelFile(folder.write("a.ply", text(elements, "0 1 0\n")), options);
    ASSERT_TRUE(asked.ok());
    EXPECT_EQ(asked.value().up.reason, TakenUpAxis::Reason::asked);
    expectNear(asked.value().points[0], {0, 0, 1}, 0);
}

TEST(PlyReader, ABudgetThatIsTooSmallIsToldAndWhoGivesUpIsHeard) {
    class GivesUp final : public ReadingWatch {
        bool goesOn(ReadingStep, double) override { return false; }
    };
    const TemporaryFolder folder;
    const auto path = folder.write("a.ply", text("element vertex 2\n" + PLACES, "0 0 0\n1 1 1\n"));
    ReadingOptions small;
    small.most_memory = 20;
    EXPECT_THAT(readModelFile(path, small).message(), HasSubstr("its vertices need"));
    GivesUp watch;
    ReadingOptions watched;
    watched.watch = &watch;
    EXPECT_THAT(readModelFile(path, watched).message(), HasSubstr("it was given up"));
}

} // namespace
} // namespace quarn::test
