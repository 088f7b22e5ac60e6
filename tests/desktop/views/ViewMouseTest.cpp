#include "host/session/DocumentState.h"
#include "host/session/ViewFrame.h"
#include "tests/desktop/window/WindowFixture.h"

#include <QWheelEvent>

#include <cmath>

namespace quarn::desktop::test {
namespace {

class ViewMouseTest : public WindowTest {
protected:
    QPoint middle() { return perspective.rect().center(); }
    void drag(Qt::MouseButton button, Qt::KeyboardModifiers modifiers, QPoint distance) {
        QTest::mousePress(&perspective, button, modifiers, middle());
        for (const QPoint& step : {distance / 2, distance}) {
            const QPointF point = middle() + step;
            QMouseEvent move(QEvent::MouseMove, point, perspective.mapToGlobal(point), Qt::NoButton,
                             button, modifiers);
            QApplication::sendEvent(&perspective, &move);
        }
        QTest::mouseRelease(&perspective, button, modifiers, middle() + distance);
    }
    void turnWheel(int notches) {
        const QPointF point = middle();
        QWheelEvent wheel(point, perspective.mapToGlobal(point), {}, {0, 120 * notches},
                          Qt::NoButton, Qt::NoModifier, Qt::NoScrollPhase, false);
        QApplication::sendEvent(&perspective, &wheel);
    }
    KM_3dPoint camera() { return cameraOf("Perspective"); }
    KM_3dPoint target() { return hostView("Perspective").MainViewport().Target(); }
    double distance() { return (camera() - target()).Length(); }

    /// Opening a document makes new widgets.
    ViewWidget& viewOfSlab() {
        readSlab();
        return view("Perspective");
    }

    ViewWidget& perspective = viewOfSlab();
};

TEST_F(ViewMouseTest, RightDragTurnsTheCameraAboutItsTargetAndKeepsItsDistance) {
    const KM_3dPoint camera_before = camera();
    const KM_3dPoint target_before = target();
    const double distance_before = distance();
    drag(Qt::RightButton, Qt::NoModifier, {60, 0});
    EXPECT_GT((camera() - camera_before).Length(), 0.1);
    EXPECT_LT((target() - target_before).Length(), 1e-9);
    EXPECT_NEAR(distance(), distance_before, 1e-9 * distance_before);
    EXPECT_NEAR(camera().z, camera_before.z, 1e-9) << "a level drag keeps the height";
}

TEST_F(ViewMouseTest, LeftDragTurnsTooAndSelectsNothing) {
    const KM_3dPoint camera_before = camera();
    drag(Qt::LeftButton, Qt::NoModifier, {60, 20});
    EXPECT_GT((camera() - camera_before).Length(), 0.1);
    EXPECT_FALSE(printed().contains("selected"));
}

TEST_F(ViewMouseTest, MiddleDragAndShiftMoveTargetAndCameraAlike) {
    for (const auto& [button, modifiers] :
         {std::pair{Qt::MiddleButton, Qt::KeyboardModifiers()},
          std::pair{Qt::RightButton, Qt::KeyboardModifiers(Qt::ShiftModifier)}}) {
        const KM_3dPoint camera_before = camera();
        const KM_3dPoint target_before = target();
        drag(button, modifiers, {40, 30});
        const KM_3dVector moved = target() - target_before;
        EXPECT_GT(moved.Length(), 0.01);
        EXPECT_LT((camera() - camera_before - moved).Length(), 1e-9);
    }
}

TEST_F(ViewMouseTest, WheelForwardComesNearer) {
    const double distance_before = distance();
    turnWheel(1);
    EXPECT_LT(distance(), distance_before);
    turnWheel(-2);
    EXPECT_GT(distance(), distance_before);
}

TEST_F(ViewMouseTest, MovedCameraIsDrawnInTheNextTurnOfTheEventLoop) {
    settle();
    const QImage before = perspective.picture();
    drag(Qt::RightButton, Qt::NoModifier, {80, 0});
    settle();
    EXPECT_NE(perspective.picture(), before);
}

TEST_F(ViewMouseTest, TurningAloneAsksNobodyToSave) {
    run("_-SaveAs \"" + qtText(folder / "slab.quarn") + '"');
    ASSERT_FALSE(isModified(session.document()));
    drag(Qt::RightButton, Qt::NoModifier, {80, 0});
    turnWheel(1);
    EXPECT_FALSE(isModified(session.document()));
}

TEST_F(ViewMouseTest, ClickOnAnObjectSelectsItAndClickBesideItSelectsNothing) {
    QTest::mouseClick(&perspective, Qt::LeftButton, Qt::NoModifier, middle());
    EXPECT_TRUE(printed().contains("Slab")) << printed().toStdString();
    EXPECT_TRUE(printed().contains("1 object selected")) << printed().toStdString();
    window.commandPane().output().clear();
    QTest::mouseClick(&perspective, Qt::LeftButton, Qt::NoModifier,
                      perspective.rect().bottomLeft() + QPoint(3, -3));
    EXPECT_FALSE(printed().contains("1 object selected")) << printed().toStdString();
    EXPECT_TRUE(printed().contains("selected")) << printed().toStdString();
}

TEST_F(ViewMouseTest, ClickAnswersAQuestionForObjects) {
    later([&] {
        QTest::mouseClick(&perspective, Qt::LeftButton, Qt::NoModifier, middle());
        later([&] { QTest::keyClick(&window.commandPane().line(), Qt::Key_Return); });
    });
    run("_Delete");
    EXPECT_EQ(objectCount(session.document()), 0) << printed().toStdString();
}

TEST_F(ViewMouseTest, ClicksAnswerTheQuestionsForPointsOfALine) {
    const int objects_before = objectCount(session.document());
    later([&] {
        QTest::mouseClick(&perspective, Qt::LeftButton, Qt::NoModifier, middle());
        later([&] {
            QTest::mouseClick(&perspective, Qt::LeftButton, Qt::NoModifier,
                              middle() + QPoint(30, 10));
        });
    });
    window.starter().start("_Line");
    EXPECT_EQ(objectCount(session.document()), objects_before + 1) << printed().toStdString();
}

TEST_F(ViewMouseTest, PressOnAnotherViewMakesItTheActiveOne) {
    QTest::mousePress(&view("Top"), Qt::RightButton);
    QTest::mouseRelease(&view("Top"), Qt::RightButton);
    EXPECT_EQ(activeViewName(session.document()), "Top");
    EXPECT_TRUE(view("Top").isActive());
    EXPECT_FALSE(perspective.isActive());
}

TEST_F(ViewMouseTest, DoubleClickFitsTheViewToTheModel) {
    turnWheel(-8);
    const double far = distance();
    QTest::mouseDClick(&perspective, Qt::LeftButton, Qt::NoModifier, middle());
    EXPECT_LT(distance(), 0.7 * far);
}

TEST_F(ViewMouseTest, MouseLeavesTheCameraAloneWhileAnAnimationPlays) {
    setUpTurntable(3);
    bool was_tried = false;
    KM_3dPoint before;
    KM_3dPoint after;
    const QMetaObject::Connection watched =
        QObject::connect(&window.starter(), &CommandStarter::started, [&] {
            later([&] {
                was_tried = session.isCommandRunning();
                before = camera();
                drag(Qt::RightButton, Qt::NoModifier, {90, 0});
                turnWheel(3);
                after = camera();
            });
        });
    run("_-PlayAnimation");
    QObject::disconnect(watched);
    ASSERT_TRUE(was_tried);
    EXPECT_EQ((after - before).Length(), 0.0);
}

} // namespace
} // namespace quarn::desktop::test
