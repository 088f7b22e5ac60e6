#include "tests/quarn/Studio.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

namespace quarn::test {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::IsSupersetOf;
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
                            StrEq("up: Z, as most such files have it; --up y turns it"),
                            StrEq("units: not stated"),
                            StrEq("size: 4 x 2 x 4, from 0,0,0 to 4,2,4"),
                            MatchesRegex("objects: 2 meshes with 24 triangles and [0-9]+ vertices, "
                                         "0 curves, 0 points"),
                            StrEq("materials: 0"), StrEq("hall  mesh, 12 triangles"),
                            StrEq("tower  mesh, 12 triangles")));
}

/// Two triangles of a material with a picture of 2 x 1 pixels, and a grid of 40 x 40 squares.
void writeRoom(const Studio& studio) {
    std::string grid;
    for (int j = 0; j <= 40; ++j)
        for (int i = 0; i <= 40; ++i)
            grid += "v " + std::to_string(i) + " " + std::to_string(j) + " 0.123456789\n";
    grid += "vt 0 0\nvt 1 0\nvt 0 1\nmtllib room.mtl\no floor\n";
    for (int j = 0; j < 40; ++j)
        for (int i = 1; i <= 40; ++i) {
            const int at = 41 * j + i;
            grid += "f " + std::to_string(at) + " " + std::to_string(at + 1) + " " +
                    std::to_string(at + 42) + " " + std::to_string(at + 41) + "\n";
        }
    writeFile(studio / "room.obj", grid + "o sign\nusemtl paper\nf 1/1 2/2 42/3\n");
    writeFile(studio / "room.mtl", "newmtl paper\nKd 1 1 1\nmap_Kd paper.bmp\n");
    writeFile(studio / "paper.bmp",
              std::string("BM\x3e\0\0\0\0\0\0\0\x36\0\0\0\x28\0\0\0\x02\0\0\0\x01\0\0\0"
                          "\x01\0\x18\0\0\0\0\0\x08\0\0\0\0\0\0\0\0\0\0\0\0\0\0\0\0\0\0\0"
                          "\x10\x20\x30\x40\x50\x60\0\0",
                          62));
}

TEST(ModelReport, TellsNumbersMaterialsAndTexturesAsPeopleReadThem) {
    const Studio studio;
    writeRoom(studio);
    const Ended ended = report(studio, "room.obj");
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(linesOf(ended.out),
                IsSupersetOf({StrEq("size: 40 x 40 x 0, from 0,0,0.123457 to 40,40,0.123457"),
                              StrEq("objects: 2 meshes with 3,201 triangles and 1,684 vertices, "
                                    "0 curves, 0 points"),
                              StrEq("materials: 1"),
                              StrEq("textures: 1, 2 x 1 pixels, in all 8 bytes of memory"),
                              StrEq("floor  mesh, 3,200 triangles"),
                              StrEq("sign  mesh, 1 triangle, paper")}));
}

TEST(ModelReport, TellsProgramsTheSameAsJson) {
    const Studio studio;
    writeRoom(studio);
    writeFile(studio / "room.obj", readFile(studio / "room.obj") + "o torn\nf 1 2 99999\n");
    Start start;
    start.folder = studio.path();
    start.arguments = {"info", "room.obj", "--json"};
    const Ended ended = run(start);
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    const auto json = nlohmann::json::parse(ended.out);
    EXPECT_EQ(json["name"], "room.obj");
    EXPECT_EQ(json["format"], "OBJ");
    EXPECT_EQ(json["file_bytes"], std::filesystem::file_size(studio / "room.obj"));
    EXPECT_EQ(json["units"], nullptr);
    EXPECT_EQ(json["up"]["axis"], "z");
    EXPECT_EQ(json["up"]["guessed"], true);
    EXPECT_EQ(json["box"]["high"][0], 40.0);
    ASSERT_EQ(json["objects"].size(), 2U);
    EXPECT_EQ(json["objects"][0]["triangles"], 3200);
    EXPECT_EQ(json["objects"][0]["material"], nullptr);
    EXPECT_EQ(json["objects"][1]["material"], 0);
    EXPECT_EQ(json["materials"][0]["name"], "paper");
    EXPECT_EQ(json["materials"][0]["texture"], 0);
    EXPECT_EQ(json["textures"][0]["width_px"], 2);
    EXPECT_THAT(json["left_out"].dump(), HasSubstr("99999"));
}

TEST(ModelReport, TellsTheProgramWhoseFilesHaveTheirAxisSo) {
    const Studio studio;
    writeFile(studio / "signed.obj", "# Blender 3.6.0\nv 0 0 0\nv 1 0 0\nv 0 1 0\nf 1 2 3\n");
    const Ended ended = report(studio, "signed.obj");
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(linesOf(ended.out),
                Contains(StrEq("up: Y, as Blender writes it; --up z turns it")));
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
