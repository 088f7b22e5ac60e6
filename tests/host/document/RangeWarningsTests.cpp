#include "host/document/DisplayPolyline.h"
#include "host/document/DocumentDrawing.h"
#include "host/document/ViewFit.h"
#include "host/session/ViewNavigation.h"
#include "host/session/ViewPicking.h"
#include "kelmar/KM_NurbsCurve.h"
#include "tests/host/document/DocumentFixtures.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

class RangeWarningsTest : public DocumentTest {
protected:
    void SetUp() override {
        addBox(document, {-1, -1, -1}, {1, 1, 1});
        for (const auto& each : document.views())
            ASSERT_TRUE(each->setFrameSize(32, 24));
    }

    /// What a redraw of the view tells.
    std::string told(ViewState& redrawn) {
        front_end.clearPrinted();
        redrawn.redraw(0);
        return KM_wString(front_end.printed()).ToUtf8();
    }
    void look(ViewState& from, double distance) {
        ASSERT_TRUE(
            from.setTargetAndCamera(KM_3dPoint::Origin, {distance, distance, 0}, true, true));
    }
};

TEST_F(RangeWarningsTest, ObjectsAreToldOnceByName) {
    EXPECT_THAT(told(view), IsEmpty());
    document.objects().addPoint(L"Star", {1e19, 0, 0});
    EXPECT_THAT(told(view), HasSubstr("beyond 1e12 units or has an extreme scale: Star. It stays"));
    EXPECT_THAT(told(view), IsEmpty());
    EXPECT_THAT(told(*document.findView(L"Top")), IsEmpty()) << "another view";
    document.objects().addPoint(L"Comet", {0, -1e300, 0});
    EXPECT_THAT(told(view), AllOf(HasSubstr("Comet"), Not(HasSubstr("Star"))));
}

TEST_F(RangeWarningsTest, HiddenObjectsWaitUntilTheyAreShown) {
    const DocumentObject& star = document.objects().addPoint(L"Star", {1e19, 0, 0});
    document.objects().setVisible(star.id, false);
    EXPECT_THAT(told(view), IsEmpty());
    document.objects().setVisible(star.id, true);
    EXPECT_THAT(told(view), HasSubstr("Star"));
}

TEST_F(RangeWarningsTest, ManyObjectsAreCounted) {
    for (int i = 0; i < 30; ++i)
        document.objects().addPoint(L"Star", {1e19, 0, 0});
    EXPECT_THAT(told(view), HasSubstr("Star, Star 2, Star 3, Star 4, Star 5 and 25 more"));
}

TEST_F(RangeWarningsTest, ACameraIsToldOnceUntilItIsBack) {
    look(view, 1e19);
    EXPECT_THAT(told(view), HasSubstr("The camera is out of range"));
    look(view, 1e20);
    EXPECT_THAT(told(view), IsEmpty());
    EXPECT_THAT(told(*document.findView(L"Top")), IsEmpty());
    EXPECT_THAT(told(view), IsEmpty()) << "another view shows the scene";
    look(view, 5.0);
    EXPECT_THAT(told(view), IsEmpty());
    look(view, 1e19);
    EXPECT_THAT(told(view), HasSubstr("The camera is out of range"));
}

TEST_F(RangeWarningsTest, ACommandIsToldOnceWhateverItsCamerasDo) {
    for (int command = 0; command < 2; ++command) {
        list.commandStarted();
        std::string all;
        for (const double distance : {5.0, 1e19, 5.0, 1e19, 1e300}) {
            look(view, distance);
            all += told(view);
        }
        EXPECT_EQ(all.find("out of range"), all.rfind("out of range"));
        EXPECT_THAT(all, HasSubstr("The camera is out of range"));
        list.commandEnded();
    }
    EXPECT_THAT(told(view), IsEmpty()) << "told already";
}

TEST_F(RangeWarningsTest, PicturesOfACameraOutOfRangeCountAsShown) {
    look(view, 1e19);
    const auto shown = view.showCount();
    const auto drawn = view.drawCount();
    view.redraw(0);
    EXPECT_EQ(view.showCount(), shown + 1);
    EXPECT_EQ(view.drawCount(), drawn + 1);
    EXPECT_EQ(view.frameBuffer().width, 32);
}

TEST_F(RangeWarningsTest, FitBoxAndToleranceLookPastWhatIsNotDrawn) {
    const auto fitted = fitViewport(view.viewport(), document.objects(), {});
    ASSERT_TRUE(fitted.ok());
    const KM_3dPoint far[] = {{0, 0, 0}, {1e308, 0, 0}, {-1e308, 1, 0}};
    document.objects().addCurve(L"Orbit", std::make_unique<KM_PolylineCurve>(far));
    document.objects().addPoint(L"Star", {0, 1e19, 0});
    KM_Xform place = KM_Xform::Translation(1e19, 0, 0);
    document.objects().addMesh(L"Planet", {boxMesh({0, 0, 0}, {1, 1, 1}), nullptr, place});
    EXPECT_EQ(document.objects().visibleBox().m_max, KM_3dPoint(1, 1, 1));
    const auto fitted_again = fitViewport(view.viewport(), document.objects(), {});
    ASSERT_TRUE(fitted_again.ok());
    EXPECT_EQ(fitted_again.value().CameraLocation(), fitted.value().CameraLocation());
    document.objects().setVisible(document.objects().findByName(L"Box")->id, false);
    const auto nothing = fitViewport(view.viewport(), document.objects(), {});
    ASSERT_FALSE(nothing.ok());
    EXPECT_THAT(nothing.message(), HasSubstr("All that is visible lies too far from the origin"));
}

TEST_F(RangeWarningsTest, NothingIsPickedWhereNothingIsDrawn) {
    look(view, 5.0);
    EXPECT_TRUE(objectAt(view.face(), 16, 12).has_value());
    look(view, 2e13); // a ray from here would meet it
    EXPECT_FALSE(objectAt(view.face(), 16, 12).has_value());
    look(view, 1e300);
    EXPECT_FALSE(objectAt(view.face(), 16, 12).has_value());
    (void)pointAt(view.face(), 16, 12);
}

TEST_F(RangeWarningsTest, ACurveOfTheSmallestNumbersIsDividedNoFurtherThanOthers) {
    std::vector<KM_3dPoint> points;
    for (int i = 0; i < 400; ++i)
        points.emplace_back(5e-324 * (i % 7), 5e-324 * (i % 5), 5e-324 * i);
    KM_NurbsCurve curve;
    ASSERT_TRUE(curve.CreateClampedUniformNurbs(points, 4));
    EXPECT_LT(displayPolyline(curve, 5e-5).Count(), 20000);
}

TEST_F(RangeWarningsTest, NavigationSurvivesCamerasAnywhere) {
    for (const double distance : {1e13, 1e19, 1e150, 1e300}) {
        look(view, distance);
        orbitView(view.face(), 10, 5);
        panView(view.face(), 10, 5);
        zoomView(view.face(), 1.2, 16, 12);
        zoomView(view.face(), 1e-9, 16, 12);
        EXPECT_TRUE(view.viewport().IsValidCamera());
        view.redraw(0);
    }
}

} // namespace
} // namespace quarn::test
