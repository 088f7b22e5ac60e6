#include "tests/quarn/Studio.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::MatchesRegex;
using testing::StrEq;

Ended report(const Studio& studio, const std::string& model) {
    Start start;
    start.folder = studio.path();
    start.arguments = {"info", model, "--language", "en"};
    return run(start);
}

TEST(ModelReport, TellsTheFileAndWhatIsInIt) {
    const Studio studio;
    const auto file_size = std::filesystem::file_size(studio / "house.obj");
    const Ended ended = report(studio, "house.obj");
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.err, IsEmpty());
    // A hall of 4 x 2 x 1 and a tower on it that ends at 4.
    EXPECT_THAT(linesOf(ended.out),
                ElementsAre(StrEq("name: house.obj"), StrEq("format: OBJ"),
                            StrEq("file size: " + std::to_string(file_size) + " bytes"),
                            MatchesRegex("read in: [0-9]+ ms"),
                            StrEq("up: z, as in most OBJ files; --up y turns it"),
                            StrEq("hall  mesh, 12 triangles"), StrEq("tower  mesh, 12 triangles"),
                            MatchesRegex("2 meshes with 24 triangles and [0-9]+ vertices, .*, "
                                         "0 curves, 0 points; 0 hidden, 0 selected"),
                            StrEq("from 0,0,0 to 4,2,4, size 4 x 2 x 4")));
}

TEST(ModelReport, TellsTheProgramWhoseFilesHaveTheirAxisSo) {
    const Studio studio;
    writeFile(studio / "signed.obj", "# Blender 3.6.0\nv 0 0 0\nv 1 0 0\nv 0 1 0\nf 1 2 3\n");
    const Ended ended = report(studio, "signed.obj");
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(linesOf(ended.out),
                Contains(StrEq("up: y, as Blender writes OBJ files; --up z turns it")));
}

TEST(ModelReport, ReadsModelsWithoutAFolderToWriteTo) {
    const Studio studio;
    std::filesystem::create_directory(studio / "größe 家");
    writeHouse(studio / "größe 家/mein Haus.obj");
    const Ended ended = report(studio, "größe 家/mein Haus.obj");
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_EQ(linesOf(ended.out)[0], "name: mein Haus.obj");
}

TEST(ModelReport, FileSizesHaveTheUnitThatSuitsThem) {
    const Studio studio;
    writeFile(studio / "long.obj",
              "v 0 0 0\nv 1 0 0\nv 0 1 0\nf 1 2 3\n# " + std::string(2345000, '-') + "\n");
    const Ended ended = report(studio, "long.obj");
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_EQ(linesOf(ended.out)[2], "file size: 2.3 MB");
}

} // namespace
} // namespace quarn::test
