// Highlights, roughness, light and relief of material files.
#include "engine/images/ImageFile.h"
#include "tests/import/ModelFixtures.h"

#include <gmock/gmock.h>

#include <cmath>

namespace quarn::test {
namespace {

using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

void writePicture(const TemporaryFolder& folder, const char* name, std::vector<std::uint8_t> rgba) {
    Image picture;
    picture.resize(static_cast<int>(rgba.size() / 4), 1);
    picture.rgba = std::move(rgba);
    ASSERT_TRUE(writeImageFile(folder.path() / name, picture).ok());
}

ImportedModel readWith(const TemporaryFolder& folder, const std::string& lines) {
    folder.write("a.mtl", "newmtl m\n" + lines);
    return readOrFail(folder.write("a.obj", "mtllib a.mtl\nv 0 0 0\nv 1 0 0\nv 0 1 0\nvt 0 0\n"
                                            "vt 1 0\nvt 0 1\nusemtl m\nf 1/1 2/2 3/3\n"));
}

Material materialOf(const ImportedModel& model) {
    return model.meshes.empty() ? Material() : *model.meshes[0].placed.material;
}

Material materialWith(const std::string& lines) {
    const TemporaryFolder folder;
    return materialOf(readWith(folder, lines));
}

TEST(ObjSurface, IsRoughPlasticWhereTheFileStatesNothing) {
    const Material material = materialWith("Kd 0.5 0.5 0.5\n");
    EXPECT_EQ(material.metalness, 0.0F);
    EXPECT_EQ(material.roughness, 1.0F);
    EXPECT_EQ(material.specular, 1.0F);
    EXPECT_FALSE(material.is_one_sided);
}

TEST(ObjSurface, IsAsRoughAsTheExponentOfItsHighlightSays) {
    // The fourth root of 2 / (exponent + 2).
    EXPECT_NEAR(materialWith("Ns 0\n").roughness, 1.0F, 1e-6F);
    EXPECT_NEAR(materialWith("Ns 10\n").roughness, 0.6389F, 1e-4F);
    EXPECT_NEAR(materialWith("Ns 250\n").roughness, 0.2985F, 1e-4F);
    EXPECT_NEAR(materialWith("Ns 1000\n").roughness, 0.2114F, 1e-4F);
    EXPECT_EQ(materialWith("Ns 250\nPr 0.75\n").roughness, 0.75F);
}

TEST(ObjSurface, MirrorsAsMuchAsItsHighlightSays) {
    const Material usual = materialWith("Ks 0.5 0.5 0.5\n");
    EXPECT_EQ(usual.specular, 1.0F);
    EXPECT_THAT(usual.specular_color, ElementsAre(1.0F, 1.0F, 1.0F));
    const Material strong = materialWith("Ks 1 0.5 0.25\n");
    EXPECT_EQ(strong.specular, 1.0F);
    EXPECT_THAT(strong.specular_color, ElementsAre(2.0F, 1.0F, 0.5F));
    const Material weak = materialWith("Ks 0.125\n");
    EXPECT_EQ(weak.specular, 0.25F);
    EXPECT_THAT(weak.specular_color, ElementsAre(1.0F, 1.0F, 1.0F));
    EXPECT_EQ(materialWith("Ks 0 0 0\n").specular, 0.0F);
    EXPECT_EQ(materialWith("Ks 0 0 0\nPr 0.5\n").specular, 1.0F);
}

TEST(ObjSurface, HasTheNumbersOfMetalAndOfItsCoat) {
    const Material material = materialWith("Pm 0.75\nPr 0.25\nPc 0.5\nPcr 0.125\n");
    EXPECT_EQ(material.metalness, 0.75F);
    EXPECT_EQ(material.roughness, 0.25F);
    EXPECT_EQ(material.clearcoat, 0.5F);
    EXPECT_EQ(material.clearcoat_roughness, 0.125F);
}

TEST(ObjSurface, ShinesInTheColourThatIsStatedAndBrighterThanWhiteToo) {
    EXPECT_THAT(materialWith("Ke 0 0 1\n").emission, ElementsAre(0.0F, 0.0F, 1.0F));
    EXPECT_NEAR(materialWith("Ke 0.5 0.5 0.5\n").emission[0], 0.2140F, 1e-4F); // of sRGB
    const Material bright = materialWith("Ke 8 4 0\n");
    EXPECT_EQ(bright.emission[0], 8.0F);
    EXPECT_NEAR(bright.emission[1], 8.0F * 0.2140F, 1e-3F);
}

TEST(ObjSurface, ShinesWithItsPictureWhereNoColourIsStated) {
    const TemporaryFolder folder;
    writePicture(folder, "sign.png", {200, 100, 50, 255});
    for (const char* const lines : {"map_Ke sign.png\n", "Ke 0 0 0\nmap_Ke sign.png\n"}) {
        const Material material = materialOf(readWith(folder, lines));
        EXPECT_NE(material.emission_texture.texture, nullptr) << lines;
        EXPECT_THAT(material.emission, ElementsAre(1.0F, 1.0F, 1.0F)) << lines;
    }
    EXPECT_THAT(materialOf(readWith(folder, "Ke 0 0 1\nmap_Ke gone.png\n")).emission,
                ElementsAre(0.0F, 0.0F, 1.0F));
}

TEST(ObjSurface, HasPicturesOfRoughnessAndMetalnessInOne) {
    const TemporaryFolder folder;
    writePicture(folder, "rough.png", {40, 40, 40, 255, 80, 80, 80, 255});
    writePicture(folder, "metal.png", {250, 250, 250, 255});
    const Material both =
        materialOf(readWith(folder, "Pr 0.5\nPm 0\nmap_Pr rough.png\nmap_Pm metal.png\n"));
    ASSERT_NE(both.metal_rough.texture, nullptr);
    EXPECT_THAT(both.metal_rough.texture->rgba, ElementsAre(255, 40, 250, 255, 255, 80, 250, 255));
    EXPECT_EQ(both.roughness, 1.0F);
    EXPECT_EQ(both.metalness, 1.0F);
    const Material one = materialOf(readWith(folder, "Pr 0.5\nPm 0.25\nmap_Pm metal.png\n"));
    ASSERT_NE(one.metal_rough.texture, nullptr);
    EXPECT_THAT(one.metal_rough.texture->rgba, ElementsAre(255, 255, 250, 255));
    EXPECT_EQ(one.roughness, 0.5F);
}

TEST(ObjSurface, TakesOnePictureOfBothAsItIs) {
    const TemporaryFolder folder;
    writePicture(folder, "orm.png", {255, 40, 250, 255});
    const Material material = materialOf(readWith(folder, "map_Pr orm.png\nmap_Pm orm.png\n"));
    ASSERT_NE(material.metal_rough.texture, nullptr);
    EXPECT_THAT(material.metal_rough.texture->rgba, ElementsAre(255, 40, 250, 255));
}

TEST(ObjSurface, HasTheNormalsOfItsMapWhateverItIsCalled) {
    const TemporaryFolder folder;
    writePicture(folder, "n.png", {128, 128, 255, 255, 160, 100, 230, 255});
    for (const char* const lines :
         {"norm n.png\n", "map_Bump -bm 1 n.png\n", "bump n.png\n", "map_bump n.png\n"}) {
        const ImportedModel model = readWith(folder, lines);
        EXPECT_NE(materialOf(model).normals.texture, nullptr) << lines;
        EXPECT_THAT(model.warnings, IsEmpty()) << lines;
    }
    EXPECT_EQ(materialOf(readWith(folder, "norm -bm 0.5 n.png\n")).normal_scale, 0.5F);
}

TEST(ObjSurface, TellsOfHeightsThatTheyAreNotDrawn) {
    const TemporaryFolder folder;
    writePicture(folder, "h.png", {128, 128, 128, 255, 10, 10, 10, 255});
    const ImportedModel model = readWith(folder, "map_Bump h.png\n");
    EXPECT_EQ(materialOf(model).normals.texture, nullptr);
    EXPECT_THAT(model.warnings,
                ElementsAre("The texture 'h.png' was left out: it holds heights, which are not "
                            "drawn; a map of normals is."));
}

TEST(ObjSurface, LaysItsPicturesBesideThatOfTheColour) {
    const TemporaryFolder folder;
    writePicture(folder, "c.png", {10, 20, 30, 255});
    writePicture(folder, "k.png", {200, 100, 50, 255});
    const Material material =
        materialOf(readWith(folder, "map_Kd -s 4 2 1 -o 0.5 0 0 c.png\nmap_Ks -s 2 2 1 k.png\n"));
    ASSERT_NE(material.specular_color_texture.texture, nullptr);
    // 2 u where the mesh has 4 u + 0.5.
    EXPECT_THAT(material.specular_color_texture.u, ElementsAre(0.5F, 0.0F, -0.25F));
    EXPECT_THAT(material.specular_color_texture.v, ElementsAre(0.0F, 1.0F, 0.0F));
}

TEST(ObjSurface, WithEveryPictureMissingIsShownAndEachToldOnce) {
    const TemporaryFolder folder;
    const ImportedModel model =
        readWith(folder, "Kd 1 0 0\nmap_Kd a.png\nmap_Ks b.png\nmap_Ke c.png\nmap_Pr d.png\n"
                         "map_Pm d.png\nnorm e.png\nmap_d a.png\n");
    EXPECT_EQ(materialOf(model).base_color, (KM_Color{255, 0, 0, 255}));
    EXPECT_THAT(model.warnings,
                ElementsAre(HasSubstr("'a.png'"), HasSubstr("'d.png'"), HasSubstr("'b.png'"),
                            HasSubstr("'c.png'"), HasSubstr("'e.png'")));
}

TEST(ObjSurface, WithNumbersThatCannotBeIsMadeDrawableAndTold) {
    const TemporaryFolder folder;
    const ImportedModel model = readWith(folder, "Pm 7\nKe 1e30 0 0\nPr nan\n");
    EXPECT_EQ(materialOf(model).metalness, 1.0F);
    EXPECT_EQ(materialOf(model).roughness, 1.0F);
    EXPECT_EQ(materialOf(model).emission[0], 1e6F);
    EXPECT_THAT(model.warnings,
                ElementsAre(HasSubstr("line 4 holds 'nan' where a number belongs"),
                            "1 material has numbers or textures that cannot be; what is usual "
                            "stands for them: 'm' (metalness, emission)."));
}

} // namespace
} // namespace quarn::test
