#include "import/ModelFile.h"
#include "tests/host/document/DocumentFixtures.h"

namespace quarn::test {
namespace {

KM_wString textOf(const CQuarnView* view) {
    return view->MainViewport().Name();
}

TEST_F(DocumentTest, HasFourViewsOfWhichPerspectiveIsActive) {
    KM_SimpleArray<CQuarnView*> views;
    ASSERT_EQ(document.face().GetViewList(views, true, true), 4);
    const wchar_t* const names[] = {L"Top", L"Front", L"Right", L"Perspective"};
    for (int i = 0; i < 4; ++i)
        EXPECT_STREQ(textOf(views[i]), names[i]);
    EXPECT_EQ(&document.activeView().face(), views[3]);
    EXPECT_TRUE(views[3]->MainViewport().VP().IsPerspectiveProjection());
    for (int i = 0; i < 3; ++i)
        EXPECT_TRUE(views[i]->MainViewport().VP().IsParallelProjection());
    EXPECT_EQ(document.face().GetViewList(views, false, true), 0) << "there are no sheets";
}

TEST_F(DocumentTest, StandardViewsLookAlongTheAxes) {
    const auto direction = [&](const wchar_t* name) {
        return -document.findView(name)->viewport().CameraZ();
    };
    EXPECT_EQ(direction(L"top"), KM_3dVector(0, 0, -1));
    EXPECT_EQ(direction(L"Front"), KM_3dVector(0, 1, 0));
    EXPECT_EQ(direction(L"RIGHT"), KM_3dVector(-1, 0, 0));
    EXPECT_EQ(document.findView(L"Top")->viewport().CameraY(), KM_3dVector(0, 1, 0));
    EXPECT_EQ(document.findView(L"Back"), nullptr);
}

TEST_F(DocumentTest, SerialNumbersAreNeverUsedAgain) {
    const unsigned int first = document.serialNumber();
    const unsigned int second = list.openNew().serialNumber();
    EXPECT_GT(first, 0U);
    EXPECT_NE(first, second);
    list.commandEnded();
    EXPECT_EQ(CQuarnDoc::FromRuntimeSerialNumber(first), nullptr);
    EXPECT_EQ(CQuarnDoc::FromRuntimeSerialNumber(second), &list.active()->face());
    EXPECT_GT(list.openNew().serialNumber(), second);
}

TEST_F(DocumentTest, AReplacedDocumentStaysOpenUntilItsCommandHasEnded) {
    const unsigned int number = document.serialNumber();
    list.openNew();
    EXPECT_EQ(CQuarnDoc::FromRuntimeSerialNumber(number), &document.face());
    list.commandEnded();
    EXPECT_EQ(list.documents().size(), 1U);
}

TEST_F(DocumentTest, ANewDocumentStartsWithTheRecordThatThePlugInStartedWith) {
    RecordKeeper keeper;
    keeper.record.SetHtmlFilename(L"Animation");
    list.rememberFreshRecord();
    keeper.record.SetHtmlFilename(L"Secret");
    keeper.record.SetCaptureType(KM_3dmAnimationProperties::turntable);
    keeper.record.SetFrameCount(3);
    keeper.record.CameraPoints().Append({1, 2, 3});
    list.openNew();
    EXPECT_STREQ(keeper.record.HtmlFilename(), L"Animation");
    EXPECT_EQ(keeper.record.CaptureType(), KM_3dmAnimationProperties::none);
    EXPECT_EQ(keeper.record.FrameCount(), 100);
    EXPECT_EQ(keeper.record.CameraPoints().Count(), 0);
}

TEST_F(DocumentTest, PropertiesReachTheRecordThroughTheKeeper) {
    CQuarnDocProperties& properties = document.face().Properties();
    EXPECT_EQ(properties.AnimationProperties().FrameCount(), 100) << "nobody keeps a record";
    RecordKeeper keeper;
    KM_3dmAnimationProperties record;
    record.SetFrameCount(7);
    properties.SetAnimationProperties(record);
    EXPECT_EQ(keeper.record.FrameCount(), 7);
    EXPECT_EQ(properties.AnimationProperties().FrameCount(), 7);
}

TEST_F(DocumentTest, NamesOfObjectsBecomeUnique) {
    ObjectTable& objects = document.objects();
    for (int i = 0; i < 3; ++i)
        objects.addPoint(L"Wall", {0, 0, 0});
    objects.addPoint(L"wall", {0, 0, 0});
    EXPECT_STREQ(objects.objects()[0]->name, L"Wall");
    EXPECT_STREQ(objects.objects()[1]->name, L"Wall 2");
    EXPECT_STREQ(objects.objects()[2]->name, L"Wall 3");
    EXPECT_STREQ(objects.objects()[3]->name, L"wall 4");
    EXPECT_EQ(objects.findByName(L"WALL 2"), objects.objects()[1].get());
}

TEST_F(DocumentTest, AReferenceFindsItsObjectByIdAndKeepsNothingAlive) {
    const KM_3dPoint ends[] = {{0, 0, 0}, {1, 0, 0}};
    DocumentObject& line =
        document.objects().addCurve(L"Path", std::make_unique<KM_PolylineCurve>(ends));
    const KM_UUID id = line.id;
    const CQuarnObjRef reference(id);
    ASSERT_NE(reference.Object(), nullptr);
    EXPECT_EQ(reference.Object()->Id(), id);
    EXPECT_EQ(reference.Curve(), line.curve.get());
    EXPECT_TRUE(document.objects().remove(id));
    EXPECT_EQ(reference.Object(), nullptr);
    EXPECT_EQ(reference.Curve(), nullptr);
    EXPECT_FALSE(document.objects().remove(id));
    EXPECT_EQ(CQuarnObjRef().Object(), nullptr);
}

TEST_F(DocumentTest, AReferenceAlsoFindsObjectsOfOtherOpenDocuments) {
    const KM_UUID id = document.objects().addPoint(L"Here", {0, 0, 0}).id;
    list.openNew();
    EXPECT_NE(CQuarnObjRef(id).Object(), nullptr);
    list.commandEnded();
    EXPECT_EQ(CQuarnObjRef(id).Object(), nullptr);
}

TEST_F(DocumentTest, HidingAndShowingTellWhetherAnythingChanged) {
    const KM_UUID id = document.objects().addPoint(L"Here", {0, 0, 0}).id;
    const std::uint64_t revision = document.objects().revision();
    const CQuarnObjRef reference(id);
    CQuarnDoc& doc = document.face();
    EXPECT_FALSE(doc.ShowObject(reference, false));
    EXPECT_TRUE(doc.HideObject(reference, false));
    EXPECT_TRUE(reference.Object()->IsHidden());
    EXPECT_FALSE(doc.HideObject(reference, false));
    EXPECT_TRUE(doc.ShowObject(reference, false));
    EXPECT_FALSE(doc.HideObject(CQuarnObjRef(), false));
    EXPECT_EQ(document.objects().revision(), revision) << "nothing has to be built again";
}

ImportedModel boxModel(double size) {
    ImportedModel model;
    model.meshes.push_back({L"Box", {boxMesh({0, 0, 0}, {size, size, size})}});
    return model;
}

TEST_F(DocumentTest, TheToleranceSuitsTinyModels) {
    EXPECT_EQ(document.face().AbsoluteTolerance(), 0.001);
    document.addModel(boxModel(5000.0));
    EXPECT_EQ(document.face().AbsoluteTolerance(), 0.001);

    Document& tiny = list.openNew();
    tiny.addModel(boxModel(0.001));
    EXPECT_NEAR(tiny.face().AbsoluteTolerance(), 1e-6 * 0.001 * std::sqrt(3.0), 1e-15);
}

TEST_F(DocumentTest, TheFirstModelBringsItsUnits) {
    ImportedModel in_meters = boxModel(1.0);
    in_meters.units = UnitSystem::meters;
    document.addModel(in_meters);
    EXPECT_EQ(document.units(), UnitSystem::meters);
    document.addModel(boxModel(2.0));
    EXPECT_EQ(document.units(), UnitSystem::meters);
}

TEST_F(DocumentTest, LightsOfAModelAreThereAndStaySwitchedOff) {
    ImportedModel model = boxModel(1.0);
    KM_Light lamp;
    lamp.SetStyle(KM_LightStyle::world_point);
    lamp.Enable(false);
    model.lights = {lamp};
    document.addModel(model);
    ASSERT_EQ(document.lights().live().size(), 1U);
    EXPECT_TRUE(document.lights().shiningLights().empty());
}

TEST_F(DocumentTest, AModelIsSharedAndNotCopied) {
    ImportedModel model = boxModel(1.0);
    const KM_3dPoint path[] = {{0, 0, 0}, {1, 0, 0}, {1, 1, 0}};
    model.curves.push_back({L"Path", {}});
    for (const KM_3dPoint& corner : path)
        model.curves[0].points.Append(corner);
    model.points.Append({5, 5, 5});
    model.cameras.push_back({L"Shot", KM_Viewport()});
    document.addModel(model);

    const auto& objects = document.objects().objects();
    ASSERT_EQ(objects.size(), 3U);
    EXPECT_EQ(objects[0]->placed.mesh.get(), model.meshes[0].placed.mesh.get());
    EXPECT_EQ(objects[1]->curve->PointAtEnd(), path[2]);
    EXPECT_EQ(objects[2]->point, KM_3dPoint(5, 5, 5));
    ASSERT_EQ(document.namedViews().size(), 1U);
    EXPECT_STREQ(document.namedViews()[0].name, L"Shot");
    EXPECT_EQ(document.objects().visibleBox().m_max, KM_3dPoint(5, 5, 5));
}

} // namespace
} // namespace quarn::test
