#include "host/document/ModelPicture.h"

#include "host/document/DocumentDrawing.h"
#include "host/document/DocumentScene.h"
#include "import/ImportedModel.h"
#include "tests/host/document/DocumentFixtures.h"

#include <algorithm>

namespace quarn::test {
namespace {

using ModelPictureTest = DocumentTest;

ImportedModel modelOf(std::shared_ptr<const KM_Mesh> mesh) {
    ImportedModel model;
    model.meshes.push_back({L"Tower", {std::move(mesh)}});
    return model;
}

/// Enough triangles for a search structure of its own.
std::shared_ptr<KM_Mesh> largeMesh() {
    auto mesh = boxMesh({0, 0, 0}, {1, 2, 3});
    mesh->m_F.resize(9000, mesh->m_F[0]);
    return mesh;
}

std::size_t buildCount(const DocumentScene& scene) {
    return scene.display().rays().buildCount();
}

/// How many rows of the picture show blue.
int blueRows(const Image& picture) {
    int rows = 0;
    for (int y = 0; y < picture.height; ++y) {
        bool is_blue = false;
        for (int x = 0; x < picture.width; ++x)
            is_blue |= picture.pixel(x, y)[2] > picture.pixel(x, y)[0] + 60;
        rows += is_blue ? 1 : 0;
    }
    return rows;
}

TEST_F(ModelPictureTest, TheModelFillsThePictureWhereverItLiesAndHoweverLargeItIs) {
    auto blue = std::make_shared<Material>();
    blue->base_color = {20, 40, 220, 255};
    for (const double size : {1e-3, 1.0, 1e4}) {
        ImportedModel model = modelOf(boxMesh({0, 0, 0}, {size, size, 4 * size}));
        model.meshes[0].placed.material = blue;
        model.meshes[0].placed.world_from_mesh =
            KM_Xform::Translation(KM_3dVector(50 * size, -20 * size, 10 * size));
        DocumentScene scene;
        Image picture;
        ASSERT_TRUE(drawModel(model, scene, 120, 90, picture)) << size;
        EXPECT_GT(blueRows(picture), 75) << size;
        EXPECT_LT(blueRows(picture), 90) << size;
    }
}

TEST_F(ModelPictureTest, LinesAndPointsAloneHaveAPicture) {
    ImportedModel model;
    model.points.Append(KM_3dPoint(1, 2, 3));
    DocumentScene scene;
    Image picture;
    EXPECT_TRUE(drawModel(model, scene, 24, 18, picture));
    ImportedCurve line{L"Line", {}};
    line.points.Append(KM_3dPoint(0, 0, 0));
    line.points.Append(KM_3dPoint(0, 0, 5));
    model.curves.push_back(line);
    EXPECT_TRUE(drawModel(model, scene, 24, 18, picture));
    EXPECT_EQ(picture.width, 24);
}

TEST_F(ModelPictureTest, AModelOutOfRangeHasNone) {
    DocumentScene scene;
    Image picture;
    const ImportedModel model = modelOf(boxMesh({0, 0, 0}, {3e37, 3e37, 3e37}));
    EXPECT_FALSE(drawModel(model, scene, 24, 18, picture));
    EXPECT_FALSE(drawModel(ImportedModel(), scene, 24, 18, picture));
}

TEST_F(ModelPictureTest, WhatWasBuiltOfAModelIsNotBuiltAgainForItsPicture) {
    const auto mesh = largeMesh();
    Image picture;
    DocumentScene first;
    ASSERT_TRUE(drawModel(modelOf(mesh), first, 24, 18, picture));
    ASSERT_EQ(buildCount(first), 1U);
    DocumentScene second;
    second.shareWith(first);
    ASSERT_TRUE(drawModel(modelOf(mesh), second, 24, 18, picture));
    EXPECT_EQ(buildCount(second), 0U);
}

TEST_F(ModelPictureTest, ADocumentThatTakesAPicturesSceneShowsItsOwnObjects) {
    view.setFrameSize(40, 30);
    document.objects().addMesh(L"Tower", {boxMesh({0, 0, 0}, {1, 2, 9})});
    auto scene = std::make_unique<DocumentScene>();
    Image picture;
    ASSERT_TRUE(drawModel(modelOf(boxMesh({0, 0, 0}, {9, 2, 1})), *scene, 24, 18, picture));
    view.redraw(0);
    const std::vector<std::uint8_t> alone = view.frameBuffer().rgba;
    document.drawing().takeScene(std::move(scene));
    view.redraw(0);
    EXPECT_EQ(view.frameBuffer().rgba, alone);
}

} // namespace
} // namespace quarn::test
