// What is wrong in an OBJ file is told with its line, and the rest is read.
#include "import/ReadingWatch.h"
#include "tests/import/ModelFixtures.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

/// Four lines.
const std::string square = "v 0 0 0\nv 1 0 0\nv 1 1 0\nv 0 1 0\n";

struct Fault {
    const char* lines; ///< from line 6 on, behind a good triangle
    const char* sentence;
};

class FaultyObj : public ::testing::TestWithParam<Fault> {};

TEST_P(FaultyObj, IsToldWithItsLineBesideWhatIsRead) {
    const TemporaryFolder folder;
    const ImportedModel model =
        readOrFail(folder.write("a.obj", square + "f 1 2 3\n" + GetParam().lines));
    EXPECT_EQ(model.triangleCount(), 1U);
    ASSERT_THAT(model.warnings, Not(IsEmpty()));
    EXPECT_EQ(model.warnings.back(), GetParam().sentence);
}

INSTANTIATE_TEST_SUITE_P(
    Statements, FaultyObj,
    ::testing::Values(
        Fault{"f 1 2 9\n", "Line 6 names the vertex 9, but the file has 4 vertices."},
        Fault{"f 1 2 -9\n", "Line 6 names the vertex -9, but the file has 4 vertices."},
        Fault{"f 1 2 9\nf 9 1 9\n", "Line 6 names the vertex 9, but the file has 4 vertices; "
                                    "2 other indices name nothing either."},
        Fault{"f 1 2 4294967298\n",
              "Line 6 names the vertex 2147483647, but the file has 4 vertices."},
        Fault{"l 1 7\n", "Line 6 names the vertex 7, but the file has 4 vertices."},
        Fault{"p 8\n", "Line 6 names the vertex 8, but the file has 4 vertices."},
        Fault{"f 0 1 2\n", "Line 6 holds '0' where the vertices of a face belong."},
        Fault{"f a b c\nf 1 x 2\n", "Line 6 holds 'a' where the vertices of a face belong; "
                                    "1 other line is damaged too."},
        Fault{"f 1/x 2 3\n", "Line 6 holds '1/x' where the vertices of a face belong."},
        Fault{"f\n", "Line 6 names no vertex."},
        Fault{"l 1\n", "Line 6 holds 1 of the 2 points that a line has at least."},
        Fault{"v 1 2\n", "Line 6 holds 2 of the 3 coordinates of a vertex."},
        Fault{"v 1 two 3\n", "Line 6 holds 'two' where a number belongs."},
        Fault{"v\n", "Line 6 ends behind 'v'."},
        Fault{"vt x\n", "Line 6 holds 'x' where a number belongs."},
        Fault{"vn 0 1\n", "Line 6 holds 2 of the 3 numbers of a normal."},
        Fault{"roof 1 2 3\n", "Line 6 begins with 'roof', which is not known."},
        Fault{"cstype bezier\ncurv 0 1 1 2 3\nend\n",
              "Free-form curves and surfaces were left out: they begin in line 6. Export them as "
              "meshes."}));

INSTANTIATE_TEST_SUITE_P(
    CutShort, FaultyObj,
    ::testing::Values(
        Fault{"f 1 2", "Line 6 holds 2 of the 3 corners that a face has at least, and the file "
                       "ends there."},
        Fault{"v 1.0 2.", "Line 6 holds 2 of the 3 coordinates of a vertex, and the file ends "
                          "there."},
        Fault{"v 1.0 2.0 3.", "Line 6 ends within a number, and the file ends there."},
        Fault{"vt 0.5", "Line 6 holds too few numbers of a texture coordinate, and the file ends "
                        "there."},
        Fault{"f 1//1 2//1 3/", "Line 6 ends within a corner, and the file ends there."},
        Fault{"usem", "Line 6 ends within a statement, and the file ends there."}));

TEST(ObjFaults, OfSmallThingsLeaveTheirFaceStanding) {
    const TemporaryFolder folder;
    const ImportedModel model =
        readOrFail(folder.write("a.obj", square + "vt 0 0\nvn 0 0 1\nf 1/1/1 2/5/1 3/1/9\n"));
    EXPECT_EQ(model.triangleCount(), 1U);
    EXPECT_THAT(model.warnings,
                ElementsAre("Line 7 names the texture coordinate 5, but the file has 1 texture "
                            "coordinate; 1 other index names nothing either."));
}

TEST(ObjFaults, LeaveTrianglesOutWhichAreCounted) {
    const TemporaryFolder folder;
    const ImportedModel model = readOrFail(
        folder.write("a.obj", square + "v inf 0 0\nf 1 2 3\nf 1 2 3 9\nf 1 2 5\nl 1 5\np 5 1\n"));
    EXPECT_EQ(model.triangleCount(), 1U);
    EXPECT_EQ(model.points.Count(), 1);
    EXPECT_THAT(model.warnings,
                ElementsAre(HasSubstr("3 of 4 triangles were left out"),
                            HasSubstr("1 line segments were left out"), HasSubstr("1 of 2 points"),
                            "Line 7 names the vertex 9, but the file has 5 vertices."));
}

TEST(ObjFaults, InLateLinesAreToldWithTheirNumbers) {
    std::string text = square;
    for (int i = 0; i < 200'000; ++i)
        text += "f 1 2 3\n";
    text += "f 1 2 bad\nf 1 2 99\n";
    const TemporaryFolder folder;
    const ImportedModel model = readOrFail(folder.write("a.obj", text));
    EXPECT_EQ(model.triangleCount(), 200'000U);
    EXPECT_THAT(model.warnings, ElementsAre(HasSubstr("1 of 200001 triangles"),
                                            HasSubstr("Line 200006 names the vertex 99"),
                                            HasSubstr("Line 200005 holds 'bad'")));
}

TEST(ObjFaults, NameTheLineInWhichAFileCutAtTwoThirdsEnds) {
    std::string text = "vn 0 0 1\n";
    for (int i = 0; i < 100; ++i)
        text += "v " + std::to_string(i) + ".25 " + std::to_string(i % 2) + " 0.125\n";
    for (int i = 1; i < 99; ++i)
        text += "f " + std::to_string(i) + "//1 " + std::to_string(i + 1) + "//1 " +
                std::to_string(i + 2) + "//1\n";
    const TemporaryFolder folder;
    const std::size_t cut = text.find("//1 ", 63 * text.size() / 100) + 1;
    const ImportedModel model = readOrFail(folder.write("a.obj", text.substr(0, cut)));
    EXPECT_GT(model.triangleCount(), 0U);
    const auto lines = 1 + std::count(text.begin(), text.begin() + static_cast<long>(cut), '\n');
    ASSERT_THAT(model.warnings, Not(IsEmpty()));
    EXPECT_THAT(model.warnings.back(), HasSubstr("Line " + std::to_string(lines) + " "));
    EXPECT_THAT(model.warnings.back(), HasSubstr("the file ends there"));
}

TEST(ObjFaults, RefuseAFileThatHasNothingElse) {
    const TemporaryFolder folder;
    const auto path = folder.write("a.obj", std::string("\x7F"
                                                        "ELF\0\1\2\3 junk\n",
                                                        14));
    const Result<ImportedModel> model = readModelFile(path);
    ASSERT_FALSE(model.ok());
    EXPECT_EQ(model.message(),
              "Cannot read '" + path.string() +
                  "': nothing in it can be shown. Line 1 begins with '?ELF\?\?\?\?', "
                  "which is not known. Export the model again, with its meshes.");
}

TEST(ObjLimits, MemoryIsRefusedBeforeItIsTaken) {
    std::string text = square;
    for (int i = 0; i < 200'000; ++i)
        text += "f 1 2 3 4\n";
    const TemporaryFolder folder;
    const auto path = folder.write("a.obj", text);
    EXPECT_TRUE(readModelFile(path, {.most_memory = 100'000'000}).ok());
    const Result<ImportedModel> model = readModelFile(path, {.most_memory = 10'000'000});
    ASSERT_FALSE(model.ok());
    EXPECT_THAT(model.message(), HasSubstr("of memory"));
    EXPECT_THAT(model.message(), HasSubstr(path.string()));
}

class GivenUp final : public ReadingWatch {
    bool goesOn(ReadingStep, double) override { return false; }
};

TEST(ObjLimits, AReadingThatIsGivenUpEndsWithAnError) {
    const TemporaryFolder folder;
    GivenUp watch;
    const Result<ImportedModel> model =
        readModelFile(folder.write("a.obj", square + "f 1 2 3\n"), {.watch = &watch});
    ASSERT_FALSE(model.ok());
    EXPECT_THAT(model.message(), HasSubstr("given up"));
}

} // namespace
} // namespace quarn::test
