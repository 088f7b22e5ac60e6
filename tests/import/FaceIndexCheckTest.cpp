#include "tests/import/ModelFixtures.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

/// A text PLY of three vertices; the first line behind its header is line 10.
std::string ply(const std::string& lines, const std::string& index_type = "int", int faces = 1) {
    return "ply\nformat ascii 1.0\nelement vertex 3\nproperty float x\nproperty float y\n"
           "property float z\nelement face " +
           std::to_string(faces) + "\nproperty list uchar " + index_type +
           " vertex_indices\nend_header\n" + lines;
}

const std::string vertices = "0 0 0\n1 0 0\n0 1 0\n";

void expectRefused(const std::string& name, const std::string& bytes, const std::string& why) {
    const TemporaryFolder folder;
    const auto path = folder.write(name, bytes);
    const Result<ImportedModel> model = readModelFile(path);
    ASSERT_FALSE(model.ok()) << bytes;
    EXPECT_THAT(model.message(), AllOf(HasSubstr(path.string()), HasSubstr(why)));
}

TEST(TextPly, IndexThatIsNoVertexIsToldWithItsLine) {
    for (const char* const type : {"int", "uint", "ushort"}) {
        for (const char* const index :
             {"3", "-1", "-4294967294", "4294967295", "4294967298", "18446744073709551618"}) {
            const std::string line = std::string("3 0 1 ") + index + "\n";
            expectRefused("a.ply", ply(vertices + line, type),
                          "line 13 holds the index " + std::string(index) +
                              ", which is out of range: there are 3 vertices.");
        }
    }
}

TEST(TextPly, IndexThatIsNoWholeNumberIsToldWithItsLine) {
    expectRefused("a.ply", ply(vertices + "3 0 1 two\n"), "line 13 holds 'two', which is no index");
    expectRefused("a.ply", ply(vertices + "3 0 1 2.0\n"), "line 13 holds '2.0', which is no index");
    expectRefused("a.ply", ply(vertices + "3 0 1 nan\n"), "line 13 holds 'nan', which is no index");
}

TEST(TextPly, LineThatEndsTooEarlyIsTold) {
    expectRefused("a.ply", ply(vertices + "3 0 1\n"), "line 13 ends after 2 of 3 corners");
    expectRefused("a.ply", ply(vertices + "3\n0\n1\n2\n"), "line 13 ends after 0 of 3 corners");
    expectRefused("a.ply", ply(vertices + "300 0 1 2\n"), "line 13 ends after 3 of 300 corners");
    expectRefused("a.ply", ply("0 0\n0 1 0\n0 0 1\n3 0 1 2\n"), "line 10 holds 2 of the 3 numbers");
    expectRefused("a.ply", ply(vertices + "-3 0 1 2\n"), "line 13 holds '-3' where");
}

TEST(TextPly, LastLineOfManyIsCheckedAsWell) {
    std::string lines = vertices;
    for (int i = 0; i < 50'000; ++i)
        lines += "3 0 1 2\n"; // some blocks of the file
    expectRefused("a.ply", ply(lines + "3 0 1 4294967298\n", "int", 50'001),
                  "line 50013 holds the index 4294967298");
    const TemporaryFolder folder;
    const auto path = folder.write("b.ply", ply(lines + "3 0 1 2", "int", 50'001));
    EXPECT_EQ(readOrFail(path).triangleCount(), 50'001U);
}

TEST(TextPly, WindowsLineEndsAndAPlusSignAreNoHarm) {
    const TemporaryFolder folder;
    std::string text = ply(vertices + "3 0 1 +2\n");
    for (std::size_t at = text.find('\n'); at != std::string::npos; at = text.find('\n', at + 2))
        text.replace(at, 1, "\r\n");
    const ImportedModel model = readOrFail(folder.write("a.ply", text));
    EXPECT_EQ(model.triangleCount(), 1U);
    EXPECT_THAT(model.warnings, IsEmpty());
}

TEST(TextPly, ListBesideTheVerticesMayBeMissing) {
    // Written by exporters that leave out the face element of no faces, but not its list.
    const TemporaryFolder folder;
    const ImportedModel model = readOrFail(folder.write(
        "a.ply", "ply\nformat ascii 1.0\nelement vertex 3\nproperty float x\nproperty float y\n"
                 "property float z\nproperty list uchar uint vertex_indices\nend_header\n" +
                     vertices));
    EXPECT_EQ(model.points.Count(), 3);
}

TEST(TextPly, FacesWithoutCornersAreLeftOutAndCounted) {
    const TemporaryFolder folder;
    const ImportedModel model =
        readOrFail(folder.write("a.ply", ply(vertices + "0\n3 0 1 2\n0\n", "int", 3)));
    EXPECT_EQ(model.triangleCount(), 1U);
    EXPECT_THAT(model.warnings,
                testing::ElementsAre("2 faces were left out: they have no corners."));
}

} // namespace
} // namespace quarn::test
