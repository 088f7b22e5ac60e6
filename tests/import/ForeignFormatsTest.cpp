// What the reading library hands out in its own way, format by format.
#include "tests/import/ModelFixtures.h"

#include <cmath>
#include <gmock/gmock.h>
#include <numbers>

namespace quarn::test {
namespace {

using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

TEST(UpAxis, OfDxfIsZ) {
    const TemporaryFolder folder;
    const ImportedModel model = readOrFail(folder.write(
        "a.dxf", "0\nSECTION\n2\nENTITIES\n0\n3DFACE\n8\nwalls\n10\n0\n20\n0\n30\n0\n11\n4\n21\n0\n"
                 "31\n0\n12\n4\n22\n1\n32\n9\n13\n4\n23\n1\n33\n9\n0\nENDSEC\n0\nEOF\n"));
    const KM_BoundingBox box = boundsOf(model);
    expectNear(box.m_min, {0, 0, 0}, 1e-6);
    expectNear(box.m_max, {4, 1, 9}, 1e-6);
}

TEST(CutOff, IsToldOfADxfWithoutItsEnd) {
    const TemporaryFolder folder;
    const std::string whole =
        "0\nSECTION\n2\nENTITIES\n0\n3DFACE\n8\nwalls\n10\n0\n20\n0\n30\n0\n11\n4\n"
        "21\n0\n31\n0\n12\n4\n22\n1\n32\n9\n13\n4\n23\n1\n33\n9\n0\nENDSEC\n0\nEOF\n";
    EXPECT_THAT(readOrFail(folder.write("whole.dxf", whole)).warnings, IsEmpty());
    const ImportedModel cut =
        readOrFail(folder.write("cut.dxf", whole.substr(0, whole.size() - 13)));
    EXPECT_THAT(cut.warnings, ElementsAre(HasSubstr("was cut off")));
}

TEST(UpAxis, OfSmdIsZ) {
    const TemporaryFolder folder;
    const ImportedModel model =
        readOrFail(folder.write("a.smd", "version 1\nnodes\n0 \"root\" -1\nend\nskeleton\ntime 0\n"
                                         "0 0 0 0 0 0 0\nend\ntriangles\nstone\n0 0 0 0 0 0 1 0 0\n"
                                         "0 4 0 0 0 0 1 1 0\n0 4 1 9 0 0 1 1 1\nend\n"));
    const KM_BoundingBox box = boundsOf(model);
    expectNear(box.m_min, {0, 0, 0}, 1e-6);
    expectNear(box.m_max, {4, 1, 9}, 1e-6);
}

TEST(VertexColours, ThatAreNothingAtAllStandForMissingOnes) {
    const TemporaryFolder folder;
    const std::string mesh =
        "<mesh><vertices><vertex><coordinates><x>0</x><y>0</y><z>0</z></coordinates></vertex>"
        "<vertex><coordinates><x>1</x><y>0</y><z>0</z></coordinates></vertex>"
        "<vertex><coordinates><x>0</x><y>1</y><z>0</z></coordinates></vertex></vertices>"
        "<volume><triangle><v1>0</v1><v2>1</v2><v3>2</v3></triangle></volume></mesh>";
    const ImportedModel model =
        readOrFail(folder.write("a.amf", "<?xml version=\"1.0\" encoding=\"UTF-8\"?><amf "
                                         "unit=\"millimeter\"><object id=\"1\">" +
                                             mesh + "</object></amf>"));
    ASSERT_EQ(model.triangleCount(), 1U);
    EXPECT_THAT(model.meshes[0].placed.mesh->m_C, IsEmpty());
}

TEST(Amf, VolumesThatAreNotReadAreTold) {
    const TemporaryFolder folder;
    const std::string volume =
        "<volume><triangle><v1>0</v1><v2>1</v2><v3>2</v3></triangle></volume>";
    const auto read = [&](const std::string& volumes) {
        return readOrFail(folder.write(
            "a.amf",
            "<?xml version=\"1.0\" encoding=\"UTF-8\"?><amf><object id=\"1\"><mesh><vertices>"
            "<vertex><coordinates><x>0</x><y>0</y><z>0</z></coordinates></vertex>"
            "<vertex><coordinates><x>1</x><y>0</y><z>0</z></coordinates></vertex>"
            "<vertex><coordinates><x>0</x><y>1</y><z>0</z></coordinates></vertex></vertices>" +
                volumes + "</mesh></object></amf>"));
    };
    EXPECT_THAT(read(volume).warnings, IsEmpty());
    const ImportedModel model = read(volume + volume + volume);
    EXPECT_EQ(model.triangleCount(), 1U);
    EXPECT_THAT(model.warnings, ElementsAre(HasSubstr("2 of its 3 triangles were left out")));
}

/// A square of an X3D scene.
constexpr const char* SQUARE =
    "<Shape><Appearance><Material diffuseColor='1 0 0'/>"
    "<ImageTexture url='\"gone.png\" \"wood.png\"'/></Appearance>"
    "<IndexedFaceSet coordIndex='0 1 2 3 -1'>"
    "<Coordinate point='0 0 0 1 0 0 1 1 0 0 1 0'/></IndexedFaceSet></Shape>";

ImportedModel readX3d(const TemporaryFolder& folder, const std::string& scene) {
    return readOrFail(folder.write("a.x3d", "<?xml version='1.0' encoding='UTF-8'?><X3D "
                                            "profile='Immersive' version='3.0'><Scene>" +
                                                scene + "</Scene></X3D>"));
}

TEST(X3d, MaterialsWithoutANameKeepTheirColours) {
    const TemporaryFolder folder;
    folder.write("wood.png", "no picture");
    const ImportedModel model = readX3d(folder, SQUARE);
    ASSERT_EQ(model.meshes.size(), 1U);
    ASSERT_NE(model.meshes[0].placed.material, nullptr);
    EXPECT_EQ(model.meshes[0].placed.material->base_color, KM_Color(255, 0, 0));
}

TEST(X3d, OfSeveralAddressesOfATextureTheFirstThatIsThereCounts) {
    const TemporaryFolder folder;
    EXPECT_THAT(readX3d(folder, SQUARE).warnings,
                ElementsAre(HasSubstr("'gone.png' was left out")));
    folder.write("wood.png", "no picture");
    EXPECT_THAT(readX3d(folder, SQUARE).warnings,
                ElementsAre(HasSubstr("'wood.png' was left out")));
}

TEST(X3d, GroupsThatAreShownAgainAreTold) {
    const TemporaryFolder folder;
    folder.write("wood.png", "no picture");
    const std::string group = std::string("<Group DEF='one'>") + SQUARE + "</Group>";
    EXPECT_EQ(readX3d(folder, group).warnings.size(), 1U);
    EXPECT_THAT(readX3d(folder, group + "<Transform translation='2 0 0'><Group USE='one'/>"
                                        "</Transform>")
                    .warnings,
                testing::Contains(HasSubstr("shows groups again (USE)")));
}

/// A triangle with a material.
/// @param look  the technique of its effect, as XML
ImportedModel readDae(const std::string& look) {
    const TemporaryFolder folder;
    return readOrFail(folder.write(
        "a.dae",
        "<?xml version=\"1.0\"?><COLLADA xmlns=\"http://www.collada.org/2005/11/COLLADASchema\" "
        "version=\"1.4.1\"><library_effects><effect id=\"e\"><profile_COMMON><technique "
        "sid=\"t\">" +
            look +
            "</technique>"
            "</profile_COMMON></effect></library_effects><library_materials><material id=\"m\" "
            "name=\"red\"><instance_effect url=\"#e\"/></material></library_materials>"
            "<library_geometries><geometry id=\"g\"><mesh><source id=\"p\"><float_array id=\"a\" "
            "count=\"9\">  0 0 0 1 0 0 0 1 0</float_array><technique_common><accessor "
            "source=\"#a\" "
            "count=\"3\" stride=\"3\"><param name=\"X\" type=\"float\"/><param name=\"Y\" "
            "type=\"float\"/><param name=\"Z\" "
            "type=\"float\"/></accessor></technique_common></source>"
            "<vertices id=\"v\"><input semantic=\"POSITION\" source=\"#p\"/></vertices><triangles "
            "count=\"1\" material=\"s\"><input semantic=\"VERTEX\" source=\"#v\" offset=\"0\"/><p> "
            "0 "
            "1 2</p></triangles></mesh></geometry></library_geometries><library_visual_scenes>"
            "<visual_scene id=\"w\"><node><instance_geometry url=\"#g\"><bind_material>"
            "<technique_common><instance_material symbol=\"s\" target=\"#m\"/></technique_common>"
            "</bind_material></instance_geometry></node></visual_scene></library_visual_scenes>"
            "<scene><instance_visual_scene url=\"#w\"/></scene></COLLADA>"));
}

TEST(Dae, NumbersMayStandBehindBlanks) {
    const ImportedModel model =
        readDae("<lambert><diffuse><color>  \n 1 0 0 1 </color></diffuse></lambert>");
    ASSERT_EQ(model.meshes.size(), 1U);
    ASSERT_NE(model.meshes[0].placed.material, nullptr);
    EXPECT_EQ(model.meshes[0].placed.material->base_color, KM_Color(255, 0, 0));
}

TEST(Dae, HighlightsBecomeRoughnessAndEmissionBecomesLight) {
    const ImportedModel model =
        readDae("<phong><emission><color>0 1 0 1</color></emission><diffuse><color>1 0 0 1</color>"
                "</diffuse><specular><color>0.5 0.5 0.5 1</color></specular><shininess><float>250"
                "</float></shininess></phong>");
    ASSERT_EQ(model.meshes.size(), 1U);
    const Material& material = *model.meshes[0].placed.material;
    EXPECT_NEAR(material.roughness, 0.2985F, 1e-4F); // the fourth root of 2 / 252
    EXPECT_EQ(material.specular, 1.0F);
    EXPECT_THAT(material.specular_color, ElementsAre(1.0F, 1.0F, 1.0F));
    EXPECT_THAT(material.emission, ElementsAre(0.0F, 1.0F, 0.0F));
    const ImportedModel dull =
        readDae("<lambert><diffuse><color>1 0 0 1</color></diffuse></lambert>");
    ASSERT_EQ(dull.meshes.size(), 1U);
    EXPECT_EQ(dull.meshes[0].placed.material->roughness, 1.0F);
    EXPECT_THAT(dull.meshes[0].placed.material->emission, ElementsAre(0.0F, 0.0F, 0.0F));
}

std::string wide(const std::string& ascii, bool big_endian) {
    std::string bytes = big_endian ? "\xFE\xFF" : "\xFF\xFE";
    for (const char c : ascii)
        bytes += big_endian ? std::string{'\0', c} : std::string{c, '\0'};
    return bytes;
}

TEST(WideText, IsReadInBothByteOrders) {
    const TemporaryFolder folder;
    const std::string triangle = "o roof\r\nv 0 0 0\r\nv 1 0 0\r\nv 0 1 0\r\nf 1 2 3\r\n";
    for (const bool big_endian : {false, true}) {
        const ImportedModel model = readOrFail(folder.write("a.obj", wide(triangle, big_endian)));
        ASSERT_EQ(model.triangleCount(), 1U);
        EXPECT_EQ(model.meshes[0].name.ToUtf8(), "roof");
    }
}

TEST(WideText, OfAnXmlFileIsReadWhateverItsDeclarationSays) {
    const TemporaryFolder folder;
    const std::string mesh =
        "<mesh><vertices><vertex><coordinates><x>0</x><y>0</y><z>0</z></coordinates></vertex>"
        "<vertex><coordinates><x>1</x><y>0</y><z>0</z></coordinates></vertex>"
        "<vertex><coordinates><x>0</x><y>1</y><z>0</z></coordinates></vertex></vertices>"
        "<volume><triangle><v1>0</v1><v2>1</v2><v3>2</v3></triangle></volume></mesh>";
    const ImportedModel model = readOrFail(folder.write(
        "a.amf", wide("<?xml version=\"1.0\" encoding=\"UTF-16\"?><amf unit=\"millimeter\">"
                      "<object id=\"1\">" +
                          mesh + "</object></amf>",
                      false)));
    EXPECT_EQ(model.triangleCount(), 1U);
}

TEST(WideText, KeepsCharactersBeyondSixteenBits) {
    const TemporaryFolder folder;
    std::string bytes = wide("o ", false);
    bytes += std::string("\x3D\xD8\x00\xDE", 4); // U+1F600
    bytes += std::string("\x00\xDC", 2);         // the second half of a character alone
    bytes += wide("\nv 0 0 0\nv 1 0 0\nv 0 1 0\nf 1 2 3\n", false).substr(2);
    const ImportedModel model = readOrFail(folder.write("a.obj", bytes));
    ASSERT_EQ(model.meshes.size(), 1U);
    EXPECT_EQ(model.meshes[0].name.ToUtf8(), "\xF0\x9F\x98\x80\xEF\xBF\xBD");
}

/// A torus of quadrilaterals that share their vertices, without normals.
std::string torus() {
    constexpr int around = 48;
    constexpr int across = 24;
    std::string text;
    const auto turn = [](int i, int n) { return 2.0 * std::numbers::pi * i / n; };
    for (int i = 0; i < around; ++i)
        for (int j = 0; j < across; ++j) {
            const double radius = 1.0 + 0.4 * std::cos(turn(j, across));
            text += "v " + std::to_string(radius * std::cos(turn(i, around))) + " " +
                    std::to_string(radius * std::sin(turn(i, around))) + " " +
                    std::to_string(0.4 * std::sin(turn(j, across))) + "\n";
        }
    const auto vertex = [](int i, int j) {
        return " " + std::to_string(i % around * across + j % across + 1);
    };
    for (int i = 0; i < around; ++i)
        for (int j = 0; j < across; ++j)
            text += "f" + vertex(i, j) + vertex(i + 1, j) + vertex(i + 1, j + 1) +
                    vertex(i, j + 1) + "\n";
    return text;
}

TEST(Quadrilaterals, ShareTheirVerticesAndAreSmoothWhereTheyMeet) {
    const TemporaryFolder folder;
    const ImportedModel model = readOrFail(folder.write("a.obj", torus()));
    ASSERT_EQ(model.meshes.size(), 1U);
    const KM_Mesh& mesh = *model.meshes[0].placed.mesh;
    EXPECT_EQ(mesh.m_F.size(), 2U * 48 * 24);
    ASSERT_EQ(mesh.m_V.size(), 48U * 24);
    for (std::size_t i = 0; i < mesh.m_V.size(); ++i) {
        const KM_3fPoint& p = mesh.m_V[i];
        const double from_axis = std::hypot(p.x, p.y);
        // The outward normal of a torus leads away from the circle of radius 1.
        const KM_3dVector outward((p.x - p.x / from_axis) / 0.4, (p.y - p.y / from_axis) / 0.4,
                                  p.z / 0.4);
        const KM_3fVector& n = mesh.m_N[i];
        EXPECT_GT(outward.x * n.x + outward.y * n.y + outward.z * n.z, 0.99);
    }
}

} // namespace
} // namespace quarn::test
