#include "engine/images/ImageFile.h"
#include "import/files/ModelFolder.h"
#include "tests/import/ModelFixtures.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::SizeIs;

/// Two triangles side by side with the materials "one" and "two".
constexpr const char* two_materials =
    "mtllib a.mtl\nv 0 0 0\nv 1 0 0\nv 0 1 0\nv 1 1 0\nvt 0 0\nvt 1 0\nvt 0 1\nvt 1 1\n"
    "usemtl one\nf 1/1 2/2 3/3\nusemtl two\nf 2/2 4/4 3/3\n";

void writePicture(const TemporaryFolder& folder, const char* name, int width,
                  std::vector<std::uint8_t> rgba) {
    Image picture;
    picture.resize(width, 1);
    picture.rgba = std::move(rgba);
    ASSERT_TRUE(writeImageFile(folder.path() / name, picture).ok());
}

TEST(TextureReading, MissingTextureIsToldOnceHoweverManyMaterialsUseIt) {
    const TemporaryFolder folder;
    folder.write("a.mtl", "newmtl one\nmap_Kd gone.png\nnewmtl two\nmap_Kd -clamp on gone.png\n");
    const ImportedModel model = readOrFail(folder.write("a.obj", two_materials));
    EXPECT_EQ(model.triangleCount(), 2U);
    ASSERT_THAT(model.warnings, SizeIs(1));
    EXPECT_THAT(model.warnings[0], HasSubstr("'gone.png' was left out"));
}

TEST(TextureReading, BrokenTextureIsToldAndTheModelIsReadWithoutIt) {
    const TemporaryFolder folder;
    folder.write("broken.png", "\x89PNG but not really");
    folder.write("a.mtl", "newmtl one\nmap_Kd broken.png\nnewmtl two\nKd 1 0 0\n");
    const ImportedModel model = readOrFail(folder.write("a.obj", two_materials));
    EXPECT_EQ(model.triangleCount(), 2U);
    ASSERT_THAT(model.warnings, SizeIs(1));
    EXPECT_THAT(model.warnings[0], HasSubstr("'broken.png' was left out"));
}

TEST(TextureReading, AbsolutePathOfAnotherMachineIsFoundBesideTheModelByItsName) {
    const TemporaryFolder folder;
    writePicture(folder, "wood.png", 1, {10, 20, 30, 255});
    folder.write("a.mtl", "newmtl one\nmap_Kd C:\\Users\\Jo\\Textures\\wood.png\nnewmtl two\n"
                          "map_Kd /home/jo/textures/wood.png\n");
    const ImportedModel model = readOrFail(folder.write("a.obj", two_materials));
    ASSERT_EQ(model.meshes.size(), 2U);
    for (const ImportedMesh& mesh : model.meshes) {
        ASSERT_NE(mesh.placed.material->base_color_texture, nullptr);
        EXPECT_THAT(mesh.placed.material->base_color_texture->rgba, ElementsAre(10, 20, 30, 255));
    }
}

TEST(TextureReading, NameThatDiffersInCaseAloneIsUsedAndToldOnce) {
    const TemporaryFolder folder;
    std::filesystem::create_directory(folder.path() / "Textures");
    writePicture(folder, "Textures/Wood.PNG", 1, {10, 20, 30, 255});
    folder.write("a.mtl", "newmtl one\nmap_Kd textures/wood.png\nnewmtl two\n"
                          "map_Kd -clamp on textures/wood.png\n");
    const ImportedModel model = readOrFail(folder.write("a.obj", two_materials));
    ASSERT_EQ(model.meshes.size(), 2U);
    for (const ImportedMesh& mesh : model.meshes)
        ASSERT_NE(mesh.placed.material->base_color_texture, nullptr);
    EXPECT_THAT(model.warnings,
                ElementsAre("The file 'Wood.PNG' was read for 'textures/wood.png': the names "
                            "differ in capital and small letters."));
}

TEST(TextureReading, NameThatFitsIsPreferredToOneThatDiffersInCase) {
    const TemporaryFolder folder;
    writePicture(folder, "WOOD.png", 1, {1, 1, 1, 255});
    writePicture(folder, "wood.png", 1, {10, 20, 30, 255});
    folder.write("a.mtl", "newmtl one\nmap_Kd wood.png\nnewmtl two\nKd 1 0 0\n");
    const ImportedModel model = readOrFail(folder.write("a.obj", two_materials));
    ASSERT_EQ(model.meshes.size(), 2U);
    ASSERT_NE(model.meshes[0].placed.material->base_color_texture, nullptr);
    EXPECT_THAT(model.meshes[0].placed.material->base_color_texture->rgba,
                ElementsAre(10, 20, 30, 255));
    EXPECT_THAT(model.warnings, SizeIs(0));
}

TEST(ModelFolder, IsListedOnceForNamesThatDifferInCase) {
    const TemporaryFolder folder;
    folder.write("Wood.png", "");
    const ModelFolder files(folder.write("a.obj", ""));
    EXPECT_TRUE(files.find("wood.PNG").has_value());
    folder.write("Stone.png", "");
    EXPECT_FALSE(files.find("stone.PNG").has_value());
    EXPECT_TRUE(files.find("Stone.png").has_value());
}

TEST(ModelFolder, LooksAtNoMoreEntriesThanItMay) {
    const TemporaryFolder folder;
    for (const char* const below : {"", "one/", "two/"})
        folder.write(std::string(below) + "Wood.png", "");
    const auto model = folder.write("a.obj", "");
    const auto found = [&model](std::size_t most_entries) {
        const ModelFolder files(model, most_entries);
        return std::vector<bool>{files.find("one/wood.png").has_value(),
                                 files.find("two/wood.png").has_value()};
    };
    EXPECT_THAT(found(2), ElementsAre(true, true));
    EXPECT_THAT(found(1), ElementsAre(true, false));
}

TEST(TextureReading, PictureThatIsItsOwnOpacityStaysWhole) {
    const TemporaryFolder folder;
    writePicture(folder, "paper.png", 1, {100, 110, 120, 255});
    folder.write("a.mtl", "newmtl one\nmap_Kd paper.png\nmap_d paper.png\nnewmtl two\n");
    const ImportedModel model = readOrFail(folder.write("a.obj", two_materials));
    ASSERT_EQ(model.meshes.size(), 2U);
    const Material& paper = *model.meshes[0].placed.material;
    EXPECT_FALSE(paper.see_through);
    ASSERT_NE(paper.base_color_texture, nullptr);
    EXPECT_THAT(paper.base_color_texture->rgba, ElementsAre(100, 110, 120, 255));
}

TEST(TextureReading, OpacityMapOfAnObjCutsHolesIntoTheColours) {
    const TemporaryFolder folder;
    writePicture(folder, "leaf.png", 2, {10, 20, 30, 255, 40, 50, 60, 255});
    writePicture(folder, "holes.png", 4,
                 {255, 255, 255, 255, 255, 255, 255, 255, 0, 0, 0, 255, 0, 0, 0, 255});
    folder.write("a.mtl",
                 "newmtl one\nmap_Kd leaf.png\nmap_d holes.png\nnewmtl two\nmap_d holes.png\n");
    const ImportedModel model = readOrFail(folder.write("a.obj", two_materials));
    ASSERT_EQ(model.meshes.size(), 2U);
    const Material& leaf = *model.meshes[0].placed.material;
    EXPECT_TRUE(leaf.alpha_cutout);
    ASSERT_NE(leaf.base_color_texture, nullptr);
    EXPECT_THAT(leaf.base_color_texture->rgba, ElementsAre(10, 20, 30, 255, 40, 50, 60, 0));
    const Material& plain = *model.meshes[1].placed.material;
    EXPECT_TRUE(plain.alpha_cutout);
    ASSERT_NE(plain.base_color_texture, nullptr);
    EXPECT_THAT(plain.base_color_texture->rgba, ElementsAre(255, 255, 255, 255, 255, 255, 255, 255,
                                                            255, 255, 255, 0, 255, 255, 255, 0));
}

} // namespace
} // namespace quarn::test
