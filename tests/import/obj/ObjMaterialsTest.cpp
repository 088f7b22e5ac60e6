#include "engine/images/ImageFile.h"
#include "tests/import/ModelFixtures.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

const std::string body = "v 0 0 0\nv 1 0 0\nv 0 1 0\nvt 0 0\nvt 1 0\nvt 0 1\n";

/// A model whose only face has the material "m" of a material file with these lines.
ImportedModel readWith(const TemporaryFolder& folder, const std::string& lines) {
    folder.write("a.mtl", "newmtl m\n" + lines);
    return readOrFail(folder.write("a.obj", "mtllib a.mtl\n" + body + "usemtl m\nf 1/1 2/2 3/3\n"));
}

Material materialOf(const ImportedModel& model) {
    const bool has_one = model.meshes.size() == 1 && model.meshes[0].placed.material != nullptr;
    EXPECT_TRUE(has_one);
    return has_one ? *model.meshes[0].placed.material : Material{};
}

void writePicture(const TemporaryFolder& folder, const char* name) {
    Image picture;
    picture.resize(1, 1);
    picture.rgba = {10, 20, 30, 255};
    ASSERT_TRUE(writeImageFile(folder.path() / name, picture).ok());
}

TEST(ObjMaterial, TakesOneNumberForThreeAndIgnoresWhatItDoesNotKnow) {
    const TemporaryFolder folder;
    const ImportedModel model =
        readWith(folder, "# c\nNs 10\nKa 1 1 1\nKd 0.5\nKs 1 1 1\nillum 2\nPr 0.5\n");
    EXPECT_EQ(materialOf(model).base_color, (KM_Color{128, 128, 128, 255}));
    EXPECT_THAT(model.warnings, IsEmpty());
}

TEST(ObjMaterial, IsSeeThroughByOpacityOrByTransparency) {
    const TemporaryFolder folder;
    for (const char* const lines : {"d 0.25\n", "Tr 0.75\n", "d -halo 0.25\n", "Tr 0\nd 0.25\n"}) {
        const Material material = materialOf(readWith(folder, lines));
        EXPECT_EQ(material.base_color.a, 64) << lines;
        EXPECT_TRUE(material.see_through) << lines;
    }
    for (const char* const lines : {"d 1\n", "d 0\n", "Tr 1\n"}) // 0 means that there is none
        EXPECT_FALSE(materialOf(readWith(folder, lines)).see_through) << lines;
}

TEST(ObjMaterial, FindsThePictureBehindOptions) {
    const TemporaryFolder folder;
    writePicture(folder, "red wood.png");
    for (const char* const map :
         {"map_Kd red wood.png\n", "map_Kd \"red wood.png\"\n",
          "map_Kd -blendu on -bm 1.5 -mm 0 1 -s 1 1 1 -o 0 -t 0 0 red wood.png  \r\n"}) {
        const Material material = materialOf(readWith(folder, map));
        ASSERT_NE(material.base_color_texture, nullptr) << map;
        EXPECT_EQ(material.base_color_texture->wrap_u, TextureWrap::repeat);
        EXPECT_EQ(material.base_color, (KM_Color{255, 255, 255, 255}));
    }
    EXPECT_EQ(
        materialOf(readWith(folder, "map_Kd -clamp on red wood.png\n")).base_color_texture->wrap_v,
        TextureWrap::clamp);
}

TEST(ObjMaterial, ScalesAndMovesTextureCoordinates) {
    const TemporaryFolder folder;
    writePicture(folder, "w.png");
    const ImportedModel model = readWith(folder, "map_Kd -s 2 3 1 -o 0.5 0.25 0 w.png\n");
    ASSERT_EQ(model.meshes.size(), 1U);
    EXPECT_THAT(
        model.meshes[0].placed.mesh->m_T,
        ElementsAre(KM_2fPoint(0.5F, 0.25F), KM_2fPoint(2.5F, 0.25F), KM_2fPoint(0.5F, 3.25F)));
}

TEST(ObjMaterial, ThatIsDamagedIsToldWithItsLine) {
    const TemporaryFolder folder;
    const ImportedModel model = readWith(folder, "Kd red\nd 0.5\nd half\nd nan\n");
    EXPECT_EQ(materialOf(model).base_color.a, 128);
    EXPECT_THAT(model.warnings, ElementsAre("The material file 'a.mtl' is damaged: line 2 holds "
                                            "'red' where a number belongs."));
}

TEST(ObjMaterialFiles, AreSeveralWithBlanksInTheirNames) {
    const TemporaryFolder folder;
    folder.write("one.mtl", "newmtl m\nKd 1 0 0\n");
    folder.write("my two.mtl", "newmtl  old oak \nKd 0 1 0\nnewmtl m\nKd 0 0 1\n");
    for (const char* const names :
         {"mtllib one.mtl my two.mtl\n", "mtllib one.mtl\nmtllib  my two.mtl \nmtllib one.mtl\n"}) {
        const ImportedModel model = readOrFail(
            folder.write("a.obj", names + body + "usemtl m\nf 1 2 3\nusemtl old oak\nf 1 2 3\n"));
        ASSERT_EQ(model.meshes.size(), 2U) << names;
        EXPECT_EQ(model.meshes[0].placed.material->base_color, (KM_Color{255, 0, 0, 255}));
        EXPECT_EQ(model.meshes[1].placed.material->base_color, (KM_Color{0, 255, 0, 255}));
        EXPECT_EQ(model.meshes[1].placed.material->name, L"old oak");
        EXPECT_THAT(model.warnings, IsEmpty());
    }
}

TEST(ObjMaterialFiles, ThatAreMissingAreToldByName) {
    const TemporaryFolder folder;
    const ImportedModel model =
        readOrFail(folder.write("b.obj", "mtllib gone.mtl\n" + body + "usemtl m\nf 1 2 3\n"));
    EXPECT_EQ(materialOf(model).base_color, Material{}.base_color);
    EXPECT_THAT(model.warnings, ElementsAre("The material file 'gone.mtl' was left out: there is "
                                            "no such file beside the model."));
}

TEST(ObjMaterialFiles, OfTheModelsOwnNameStandInForMissingOnes) {
    const TemporaryFolder folder;
    folder.write("b.mtl", "newmtl m\nKd 1 0 0\n");
    const ImportedModel model =
        readOrFail(folder.write("b.obj", "mtllib gone.mtl\n" + body + "usemtl m\nf 1 2 3\n"));
    EXPECT_EQ(materialOf(model).base_color, (KM_Color{255, 0, 0, 255}));
    EXPECT_THAT(model.warnings, ElementsAre(HasSubstr("'gone.mtl' was left out"),
                                            "The material file 'b.mtl' was read in its place."));
}

TEST(ObjMaterialFiles, AreNotSoughtWithoutEnd) {
    const TemporaryFolder folder;
    std::string text = "mtllib";
    for (int i = 0; i < 500; ++i)
        text += " " + std::to_string(i) + ".mtl";
    const ImportedModel model = readOrFail(folder.write("b.obj", text + "\n" + body + "f 1 2 3\n"));
    ASSERT_EQ(model.warnings.size(), 101U);
    EXPECT_EQ(model.warnings.back(),
              "Material files from '100.mtl' on were not read: there are more than 100.");
}

TEST(ObjMaterialFiles, ThatDifferInCaseAreReadAndTold) {
    const TemporaryFolder folder;
    folder.write("Paint.mtl", "newmtl m\nKd 1 0 0\n");
    const ImportedModel model =
        readOrFail(folder.write("b.obj", "mtllib PAINT.MTL\n" + body + "usemtl m\nf 1 2 3\n"));
    EXPECT_EQ(materialOf(model).base_color, (KM_Color{255, 0, 0, 255}));
    EXPECT_THAT(model.warnings, ElementsAre(HasSubstr("'Paint.mtl' was read for 'PAINT.MTL'")));
}

TEST(ObjMaterialFiles, WithoutAMaterialAreToldOnceForAll) {
    const TemporaryFolder folder;
    folder.write("b.mtl", "newmtl m\nKd 1 0 0\n");
    std::string text = "mtllib b.mtl\n" + body + "f 1 2 3\n";
    for (const char* const name : {"v", "w", "v", "x", "y", "m"})
        text += std::string("usemtl ") + name + "\nf 1 2 3\n";
    const ImportedModel model = readOrFail(folder.write("b.obj", text));
    ASSERT_EQ(model.meshes.size(), 6U);
    EXPECT_EQ(model.meshes[0].placed.material, nullptr);
    EXPECT_EQ(model.meshes[1].placed.material->name, L"v");
    EXPECT_EQ(model.meshes[1].placed.material->base_color, Material{}.base_color);
    EXPECT_THAT(model.warnings, ElementsAre("No material file has 'v', 'w', 'x' and 1 more: these "
                                            "materials have the usual look."));
}

} // namespace
} // namespace quarn::test
