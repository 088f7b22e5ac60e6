#include "import/ModelFile.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/document/DocumentFixtures.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;

const char* const OBJECTS = "Roof  mesh, 12 triangles, selected\n"
                            "Walk  polyline\n"
                            "Mark  point, hidden\n";
const char* const TOTALS = "1 mesh with 12 triangles and 8 vertices, 0 materials, 1 curve, "
                           "1 point; 1 hidden, 1 selected\n"
                           "from 0,0,0 to 5,1,1, size 5 x 1 x 1\n";

class ListCommandTest : public HostTest {
protected:
    ListCommandTest() {
        ObjectTable& objects = document().objects();
        objects.select(objects.addMesh(L"Roof", {boxMesh({0, 0, 0}, {1, 1, 1})}).id);
        const KM_3dPoint corners[] = {{0, 0, 0}, {5, 0, 0}};
        objects.addCurve(L"Walk", std::make_unique<KM_PolylineCurve>(corners));
        objects.setVisible(objects.addPoint(L"Mark", {9, 9, 9}).id, false);
    }

    Document& document() { return Document::of(session.document()); }
};

TEST_F(ListCommandTest, ShowsObjectsViewsAndCounts) {
    run(L"ViewportSize 96 64");
    ASSERT_EQ(run(L"_-List"), CQuarnCommand::success);
    EXPECT_EQ(printed(), std::string(OBJECTS) +
                             "Top  view, Wireframe, 1280 x 720\n"
                             "Front  view, Wireframe, 1280 x 720\n"
                             "Right  view, Wireframe, 1280 x 720\n"
                             "Perspective  view, Shaded, 96 x 64, active\n"
                             "sun: on, azimuth 135, altitude 45\n" +
                             TOTALS);
}

TEST_F(ListCommandTest, ShowsObjectsAloneWhereThatIsWished) {
    ASSERT_EQ(run(L"_-List _Objects"), CQuarnCommand::success);
    EXPECT_EQ(printed(), std::string(OBJECTS) + TOTALS);
}

TEST_F(ListCommandTest, ShowsIdsWhereThatIsWishedAndForObjectsWithoutAName) {
    const KM_UUID nameless = document().objects().addPoint(L"", {0, 0, 0}).id;
    const std::string mark = KM_UuidToString(document().objects().findByName(L"Mark")->id).ToUtf8();
    ASSERT_EQ(run(L"_-List"), CQuarnCommand::success);
    EXPECT_THAT(printed(), HasSubstr(KM_UuidToString(nameless).ToUtf8() + "  point\n"));
    EXPECT_THAT(printed(), testing::Not(HasSubstr(mark)));
    front_end.clearPrinted();
    ASSERT_EQ(run(L"_-List _Ids"), CQuarnCommand::success);
    EXPECT_THAT(printed(), HasSubstr("Mark  point, hidden  " + mark + "\n"));
    EXPECT_THAT(printed(), HasSubstr("\n" + KM_UuidToString(nameless).ToUtf8() + "  point\n"));
}

TEST_F(ListCommandTest, ShowsWhatACameraCanFollow) {
    ObjectTable& objects = document().objects();
    const KM_3dPoint square[] = {{0, 0, 0}, {2, 0, 0}, {2, 2, 0}, {0, 2, 0}, {0, 0, 0}};
    const KM_UUID nameless = objects.addCurve(L"", std::make_unique<KM_PolylineCurve>(square)).id;
    const std::string id = KM_UuidToString(nameless).ToUtf8();
    ASSERT_EQ(run(L"_-List _Curves"), CQuarnCommand::success);
    EXPECT_EQ(printed(), "Walk  polyline, length 5, open, 2 points\n"
                         "Mark  point at 9,9,9, hidden\n" +
                             id + "  polyline, length 8, closed, 4 points\n");
}

TEST_F(ListCommandTest, LengthsOfCurvesAreInTheUnitsOfTheModel) {
    for (const wchar_t* name : {L"Roof", L"Walk", L"Mark"})
        document().objects().remove(document().objects().findByName(name)->id);
    ImportedModel model;
    model.units = UnitSystem::meters;
    document().addModel(model);
    const KM_3dPoint corners[] = {{0, 0, 0}, {3, 4, 0}};
    document().objects().addCurve(L"Ramp", std::make_unique<KM_PolylineCurve>(corners));
    ASSERT_EQ(run(L"_-List _Curves"), CQuarnCommand::success);
    EXPECT_EQ(printed(), "Ramp  polyline, length 5 metres, open, 2 points\n");
}

TEST_F(ListCommandTest, SaysWhenACameraCanFollowNothing) {
    for (const wchar_t* name : {L"Walk", L"Mark"})
        document().objects().remove(document().objects().findByName(name)->id);
    ASSERT_EQ(run(L"_-List _Curves"), CQuarnCommand::success);
    EXPECT_EQ(printed(), "There is no curve and no point.\n");
}

TEST_F(ListCommandTest, ShowsLightsUnderTheirIndexButNotDeletedOnes) {
    KM_Light light;
    light.SetStyle(static_cast<int>(KM_LightStyle::world_directional));
    light.SetDirection({0, 0, -1});
    ASSERT_EQ(document().lights().add(light), 0);
    light.SetLightName(L"Evening");
    light.Enable(false);
    ASSERT_EQ(document().lights().add(light), 1);
    light.SetLightName(L"Gone");
    ASSERT_EQ(document().lights().add(light), 2);
    document().lights().remove(2);
    ASSERT_EQ(run(L"_-List"), CQuarnCommand::success);
    EXPECT_THAT(printed(), HasSubstr("\nlight 0, directional\n"
                                     "Evening  light 1, directional, off\n"
                                     "sun: on, azimuth 135, altitude 45\n1 mesh"));
}

TEST_F(ListCommandTest, EndsWithTheAnimationWhereThereIsOne) {
    RecordKeeper keeper;
    ASSERT_EQ(run(L"_-List _Objects"), CQuarnCommand::success);
    EXPECT_EQ(printed(), std::string(OBJECTS) + TOTALS);

    front_end.clearPrinted();
    keeper.record.SetCaptureType(KM_3dmAnimationProperties::one_day_sun);
    keeper.record.SetFrameCount(25);
    keeper.record.SetViewportName(L"Perspective");
    ASSERT_EQ(run(L"_-List _Objects"), CQuarnCommand::success);
    EXPECT_EQ(printed(), std::string(OBJECTS) + TOTALS +
                             "animation: one-day sun study, 25 frames in Perspective\n");
}

TEST_F(ListCommandTest, AWordThatIsNoOptionIsToldAndNothingIsListed) {
    EXPECT_EQ(run(L"_-List Roof"), CQuarnCommand::failure);
    EXPECT_EQ(printed(),
              "List: \"Roof\" is no option here. The options are Objects, Ids, Curves.\n");
}

} // namespace
} // namespace quarn::test
