#include "tests/import/ModelFixtures.h"

#include "engine/images/ImageFile.h"

#include <cmath>
#include <cstring>
#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using ::testing::Contains;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

constexpr const char* triangle = "v 0 0 0\nv 1 0 0\nv 0 1 0\n";

/// A cube with edges of length 1 at the origin, its twelve triangles facing outward.
constexpr const char* cube = "v 0 0 0\nv 1 0 0\nv 1 1 0\nv 0 1 0\nv 0 0 1\nv 1 0 1\nv 1 1 1\n"
                             "v 0 1 1\nf 1 4 3 2\nf 5 6 7 8\nf 1 2 6 5\nf 2 3 7 6\nf 3 4 8 7\n"
                             "f 4 1 5 8\n";

/// A glTF file with one triangle (0,0,0) (1,0,0) (0,1,0), whose nodes and materials the test gives.
std::string gltfTriangle(const std::string& nodes, const std::string& more = "") {
    return R"({"asset":{"version":"2.0"},"scene":0,"scenes":[{"nodes":[0]}],"nodes":)" + nodes +
           R"(,"meshes":[{"name":"Leaf","primitives":[{"attributes":{"POSITION":0},"material":0}]}],)"
           R"("accessors":[{"bufferView":0,"componentType":5126,"count":3,"type":"VEC3"}],)"
           R"("bufferViews":[{"buffer":0,"byteLength":36}],"buffers":[{"byteLength":36,"uri":)"
           R"("data:application/octet-stream;base64,AAAAAAAAAAAAAAAAAACAPwAAAAAAAAAAAAAAAAAAgD8AAAAA"}])" +
           more + "}";
}

constexpr const char* gray_half =
    R"(,"materials":[{"name":"Half","pbrMetallicRoughness":{"baseColorFactor":[0.5,1,0,0.25]}}])";

KM_3dVector faceNormal(const KM_Mesh& mesh, const KM_MeshTriangle& face) {
    const auto at = [&](int k) {
        const KM_3fPoint& p = mesh.m_V[face.vi[k]];
        return KM_3dPoint(p.x, p.y, p.z);
    };
    return KM_CrossProduct(at(1) - at(0), at(2) - at(0));
}

TEST(ModelFile, ObjStaysAsItIsWithItsPolygonsCutIntoTriangles) {
    const TemporaryFolder folder;
    const ImportedModel model = readOrFail(folder.write("cube.obj", cube));
    ASSERT_EQ(model.meshes.size(), 1U);
    EXPECT_EQ(model.triangleCount(), 12U);
    EXPECT_EQ(model.meshes[0].name, L"cube");
    EXPECT_EQ(model.meshes[0].placed.material, nullptr);
    expectNear(boundsOf(model).m_min, {0, 0, 0}, 0);
    expectNear(boundsOf(model).m_max, {1, 1, 1}, 0);
    EXPECT_THAT(model.warnings, IsEmpty());
}

TEST(ModelFile, SharpEdgesStaySharpWhereTheFileHasNoNormals) {
    const TemporaryFolder folder;
    const ImportedModel model = readOrFail(folder.write("cube.obj", cube));
    ASSERT_EQ(model.meshes.size(), 1U);
    const KM_Mesh& mesh = *model.meshes[0].placed.mesh;
    ASSERT_EQ(mesh.m_N.size(), mesh.m_V.size());
    EXPECT_EQ(mesh.VertexCount(), 24); // eight corners, each on three sides
    for (const KM_MeshTriangle& face : mesh.m_F) {
        KM_3dVector normal = faceNormal(mesh, face);
        ASSERT_TRUE(normal.Unitize());
        for (const std::uint32_t v : face.vi) {
            const KM_3fVector& n = mesh.m_N[v];
            EXPECT_NEAR(normal * KM_3dVector(n.x, n.y, n.z), 1.0, 1e-6);
        }
    }
}

TEST(ModelFile, LineElementsBecomeOneNamedCurve) {
    const TemporaryFolder folder;
    const ImportedModel model = readOrFail(folder.write(
        "way.obj", "v 0 0 1.7\nv 1 0 1.7\nv 2 1 1.7\nv 3 3 1.7\no Walk\nl 1 2 3\nl 3 4\n"));
    ASSERT_EQ(model.curves.size(), 1U);
    EXPECT_EQ(model.curves[0].name, L"Walk");
    ASSERT_EQ(model.curves[0].points.Count(), 4);
    expectNear(model.curves[0].points[0], {0, 0, 1.7}, 1e-6);
    expectNear(model.curves[0].points[3], {3, 3, 1.7}, 1e-6);
    EXPECT_THAT(model.meshes, IsEmpty());
}

TEST(ModelFile, EveryLineObjectOfAFileIsACurveOfItsName) {
    const TemporaryFolder folder;
    const ImportedModel model = readOrFail(
        folder.write("ways.obj", "v 0 0 1\nv 1 0 1\nv 2 1 1\nv 3 3 1\nv 4 4 4\nv 5 4 4\n"
                                 "o In\nl 1 2 3\no Out\nl 4 3\no Apart\nl 5 6\nl 1 4\n"));
    ASSERT_EQ(model.curves.size(), 4U);
    const wchar_t* names[] = {L"In", L"Out", L"Apart", L"Apart"};
    const int counts[] = {3, 2, 2, 2};
    for (std::size_t i = 0; i < 4; ++i) {
        EXPECT_EQ(model.curves[i].name, names[i]) << i;
        EXPECT_EQ(model.curves[i].points.Count(), counts[i]) << i;
    }
}

TEST(ModelFile, ALineLoopIsAClosedCurve) {
    const TemporaryFolder folder;
    const ImportedModel model = readOrFail(
        folder.write("yard.obj", "v 0 0 0\nv 4 0 0\nv 4 4 0\nv 0 4 0\no Yard\nl 1 2 3 4 1\n"));
    ASSERT_EQ(model.curves.size(), 1U);
    const KM_3dPointArray& points = model.curves[0].points;
    ASSERT_EQ(points.Count(), 5);
    EXPECT_EQ(points[0], points[4]);
    EXPECT_EQ(points[2], KM_3dPoint(4, 4, 0));
}

TEST(ModelFile, VerticesWithoutFacesBecomePoints) {
    const TemporaryFolder folder;
    const ImportedModel model = readOrFail(folder.write(
        "cloud.ply", "ply\nformat ascii 1.0\nelement vertex 2\nproperty float x\nproperty float y\n"
                     "property float z\nend_header\n1 2 3\n4 5 6\n"));
    ASSERT_EQ(model.points.Count(), 2);
    expectNear(model.points[1], {4, 5, 6}, 0);
}

TEST(ModelFile, GltfIsTurnedFromYUpToZUp) {
    const TemporaryFolder folder;
    const ImportedModel model = readOrFail(
        folder.write("a.gltf", gltfTriangle(R"([{"mesh":0,"name":"Sail"}])", gray_half)));
    ASSERT_EQ(model.meshes.size(), 1U);
    EXPECT_EQ(model.meshes[0].name, L"Sail");
    // (0,1,0) in the file, up, is (0,0,1) here.
    expectNear(boundsOf(model).m_max, {1, 0, 1}, 1e-7);
}

TEST(ModelFile, LengthsOfGltfAreMetresThoseOfStlMillimetresAndThoseOfOtherFormatsAreNotStated) {
    const TemporaryFolder folder;
    const std::string gltf = folder.write("a.gltf", gltfTriangle(R"([{"mesh":0}])", gray_half));
    EXPECT_EQ(readOrFail(gltf).units, UnitSystem::meters);
    const std::string obj = folder.write("a.obj", "v 0 0 0\nv 1 0 0\nv 0 1 0\nf 1 2 3\n");
    EXPECT_EQ(readOrFail(obj).units, UnitSystem::none);
    const std::string stl = folder.write("a.stl", "solid a\nfacet normal 0 0 1\nouter loop\n"
                                                  "vertex 0 0 0\nvertex 1 0 0\nvertex 0 1 0\n"
                                                  "endloop\nendfacet\nendsolid a\n");
    EXPECT_EQ(readOrFail(stl).units, UnitSystem::millimeters);
}

TEST(ModelFile, LinearBaseColourOfGltfBecomesSrgb) {
    const TemporaryFolder folder;
    const ImportedModel model =
        readOrFail(folder.write("a.gltf", gltfTriangle(R"([{"mesh":0}])", gray_half)));
    ASSERT_EQ(model.meshes.size(), 1U);
    ASSERT_NE(model.meshes[0].placed.material, nullptr);
    // 1.055 * 0.5^(1/2.4) - 0.055 = 0.7354, times 255 = 187.5
    EXPECT_NEAR(model.meshes[0].placed.material->base_color.r, 187.5, 0.51);
    EXPECT_EQ(model.meshes[0].placed.material->base_color.g, 255);
    EXPECT_EQ(model.meshes[0].placed.material->base_color.b, 0);
    EXPECT_EQ(model.meshes[0].placed.material->base_color.a, 64);
}

TEST(ModelFile, BaseColourOfObjIsSrgbAlready) {
    const TemporaryFolder folder;
    folder.write("a.mtl", "newmtl paint\nKd 0.5 1 0\n");
    const ImportedModel model = readOrFail(folder.write(
        "a.obj", std::string("mtllib a.mtl\n") + triangle + "usemtl paint\nf 1 2 3\n"));
    ASSERT_EQ(model.meshes.size(), 1U);
    ASSERT_NE(model.meshes[0].placed.material, nullptr);
    EXPECT_EQ(model.meshes[0].placed.material->name, L"paint");
    EXPECT_EQ(model.meshes[0].placed.material->base_color, (KM_Color{128, 255, 0, 255}));
}

TEST(ModelFile, MeshThatStandsTwiceIsSharedByTwoObjectsInTheirPlaces) {
    const TemporaryFolder folder;
    const ImportedModel model = readOrFail(folder.write(
        "a.gltf", gltfTriangle(R"([{"children":[1,2]},{"mesh":0,"translation":[10,0,0]},)"
                               R"({"mesh":0,"scale":[2,2,2],"translation":[0,5,0]}])",
                               gray_half)));
    ASSERT_EQ(model.meshes.size(), 2U);
    const auto box = [&](std::size_t i) { return model.meshes[i].placed.box(); };
    EXPECT_EQ(model.meshes[0].placed.mesh, model.meshes[1].placed.mesh);
    expectNear(box(0).m_max, {11, 0, 1}, 1e-6);
    expectNear(box(1).m_max, {2, 0, 7}, 1e-6);
    EXPECT_EQ(model.meshes[0].placed.material, model.meshes[1].placed.material);
}

TEST(ModelFile, MirroringTurnsTheWindingSoThatOutsideStaysOutside) {
    const TemporaryFolder folder;
    const ImportedModel model = readOrFail(
        folder.write("a.gltf", gltfTriangle(R"([{"mesh":0,"scale":[-1,1,1]}])", gray_half)));
    ASSERT_EQ(model.meshes.size(), 1U);
    // The triangle faces +z in the file, which is -y here; a mirror across x leaves that side out.
    const KM_Mesh& mesh = *model.meshes[0].placed.mesh;
    ASSERT_EQ(mesh.TriangleCount(), 1);
    EXPECT_LT(faceNormal(mesh, mesh.m_F[0]).y, 0.0);
    EXPECT_FLOAT_EQ(mesh.m_N[0].y, -1.0F);
}

TEST(ModelFile, CameraOfGltfBecomesAViewport) {
    const TemporaryFolder folder;
    const double fov = 0.8;
    const ImportedModel model = readOrFail(folder.write(
        "a.gltf",
        gltfTriangle(R"([{"children":[1,2]},{"mesh":0},{"name":"Eye","camera":0,)"
                     R"("translation":[0,2,10]}])",
                     std::string(gray_half) + R"(,"cameras":[{"type":"perspective","perspective":)"
                                              R"({"yfov":0.8,"aspectRatio":1.5,"znear":0.1}}])")));
    ASSERT_EQ(model.cameras.size(), 1U);
    const KM_Viewport& viewport = model.cameras[0].viewport;
    EXPECT_EQ(model.cameras[0].name, L"Eye");
    expectNear(viewport.CameraLocation(), {0, -10, 2}, 1e-6);
    EXPECT_GT(viewport.CameraDirection().y, 0.0);
    EXPECT_NEAR(viewport.CameraY().z, 1.0, 1e-6);
    EXPECT_NEAR(viewport.FrustumAspect(), 1.5, 1e-5);
    double vertical = 0.0;
    ASSERT_TRUE(viewport.GetCameraHalfAngles(&vertical, nullptr));
    EXPECT_NEAR(vertical, 0.5 * fov, 1e-4);
}

TEST(ModelFile, TextureBesideTheModelIsReadWithItsRowsFromTheTop) {
    const TemporaryFolder folder;
    Image picture;
    picture.resize(1, 2);
    picture.rgba = {255, 0, 0, 255, 0, 0, 255, 255}; // red above blue
    ASSERT_TRUE(writeImageFile(folder.path() / "two tones.png", picture).ok());
    folder.write("a.mtl", "newmtl m\nKd 0 0 0\nmap_Kd two tones.png\n");
    const ImportedModel model =
        readOrFail(folder.write("a.obj", std::string("mtllib a.mtl\n") + triangle +
                                             "vt 0 0\nvt 1 0\nvt 0 1\nusemtl m\nf 1/1 2/2 3/3\n"));
    ASSERT_EQ(model.meshes.size(), 1U);
    ASSERT_NE(model.meshes[0].placed.material, nullptr);
    const auto& texture = model.meshes[0].placed.material->base_color_texture;
    ASSERT_NE(texture, nullptr);
    EXPECT_EQ(texture->width, 1);
    EXPECT_EQ(texture->height, 2);
    EXPECT_EQ(texture->rgba, picture.rgba);
    // Black under a texture is what many programs write for "the texture alone".
    EXPECT_EQ(model.meshes[0].placed.material->base_color, (KM_Color{255, 255, 255, 255}));
    ASSERT_EQ(model.meshes[0].placed.mesh->m_T.size(), 3U);
    EXPECT_EQ(model.meshes[0].placed.mesh->m_T[2],
              KM_2fPoint(0.0F, 1.0F)); // (0,0) is the lower left
}

TEST(ModelFile, MissingTextureIsAWarningAndTheBaseColourStays) {
    const TemporaryFolder folder;
    folder.write("a.mtl", "newmtl m\nKd 1 0 0\nmap_Kd gone.png\n");
    const ImportedModel model = readOrFail(
        folder.write("a.obj", std::string("mtllib a.mtl\n") + triangle + "usemtl m\nf 1 2 3\n"));
    ASSERT_EQ(model.meshes.size(), 1U);
    EXPECT_EQ(model.meshes[0].placed.material->base_color, (KM_Color{255, 0, 0, 255}));
    EXPECT_THAT(model.warnings, Contains(HasSubstr("'gone.png' was left out: there is no such")));
}

TEST(ModelFile, VertexColoursOfPlyAreKept) {
    const TemporaryFolder folder;
    const ImportedModel model = readOrFail(folder.write(
        "a.ply", "ply\nformat ascii 1.0\nelement vertex 3\nproperty float x\nproperty float y\n"
                 "property float z\nproperty uchar red\nproperty uchar green\nproperty uchar blue\n"
                 "element face 1\nproperty list uchar int vertex_indices\nend_header\n"
                 "0 0 0 255 0 0\n1 0 0 0 128 0\n0 1 0 0 0 64\n3 0 1 2\n"));
    ASSERT_EQ(model.meshes.size(), 1U);
    const auto& colors = model.meshes[0].placed.mesh->m_C;
    ASSERT_EQ(colors.size(), 3U);
    EXPECT_EQ(colors[0], (KM_Color{255, 0, 0, 255}));
    EXPECT_EQ(colors[1], (KM_Color{0, 128, 0, 255}));
    EXPECT_EQ(colors[2], (KM_Color{0, 0, 64, 255}));
}

TEST(ModelFile, StlVerticesAtOnePlaceAreSharedAndFlatPartsSmooth) {
    // A square of two triangles: six corners in the file, four places.
    std::string bytes(84, '\0');
    const std::uint32_t count = 2;
    std::memcpy(&bytes[80], &count, 4);
    const float corners[2][9] = {{0, 0, 0, 1, 0, 0, 1, 1, 0}, {0, 0, 0, 1, 1, 0, 0, 1, 0}};
    for (const auto& corner : corners) {
        bytes.append(12, '\0'); // no normal
        bytes.append(reinterpret_cast<const char*>(corner), sizeof corner);
        bytes.append(2, '\0');
    }
    const TemporaryFolder folder;
    const ImportedModel model = readOrFail(folder.write("square.STL", bytes));
    ASSERT_EQ(model.meshes.size(), 1U);
    EXPECT_EQ(model.meshes[0].placed.mesh->TriangleCount(), 2);
    EXPECT_EQ(model.meshes[0].placed.mesh->VertexCount(), 4);
    for (const KM_3fVector& n : model.meshes[0].placed.mesh->m_N) {
        EXPECT_FLOAT_EQ(n.z, 1.0F);
    }
}

TEST(ModelFile, RelativePathCountsFromTheCurrentFolder) {
    const TemporaryFolder folder;
    folder.write("a.obj", std::string(triangle) + "f 1 2 3\n");
    const auto before = std::filesystem::current_path();
    std::filesystem::current_path(folder.path());
    const auto model = readModelFile("a.obj");
    std::filesystem::current_path(before);
    EXPECT_TRUE(model.ok());
}

} // namespace
} // namespace quarn::test
