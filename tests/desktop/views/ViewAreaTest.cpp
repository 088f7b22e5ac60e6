#include "desktop/views/PicturePlace.h"
#include "tests/desktop/window/WindowFixture.h"

#include <gmock/gmock.h>

namespace quarn::desktop::test {
namespace {

using testing::ElementsAre;

QAction& actionOf(QMenu& menu, const QString& text) {
    for (QAction* const action : menu.actions()) {
        if (action->text() == text)
            return *action;
        if (action->menu())
            for (QAction* const inner : action->menu()->actions())
                if (inner->text() == text)
                    return *inner;
    }
    ADD_FAILURE() << "there is no entry " << text.toStdString();
    std::abort();
}

class ViewAreaTest : public WindowTest {
protected:
    QStringList names() {
        QStringList names;
        for (const ViewWidget* widget : window.views().widgets())
            names.append(widget->viewName());
        return names;
    }
    /// Opens the menu of a view, without showing it, and clicks an entry.
    void choose(const QString& view_name, const QString& text) {
        QMenu& menu = view(view_name).menu();
        emit menu.aboutToShow();
        actionOf(menu, text).trigger();
    }
    QSize frameOf(const QString& view_name) {
        CQuarnDisplayPipeline& pipeline = *hostView(view_name).MainViewport().DisplayPipeline();
        return {pipeline.FrameWidth(), pipeline.FrameHeight()};
    }
};

TEST(PicturePlace, WidePictureStandsInTheMiddleOfASquare) {
    EXPECT_EQ(picturePlace({200, 200}, {400, 100}), QRectF(0, 75, 200, 50));
}

TEST(PicturePlace, PointOfTheWidgetIsAPixelOfThePicture) {
    const QRectF place(0, 75, 200, 50);
    EXPECT_EQ(picturePoint({0, 75}, place, {400, 100}), QPointF(0, 0));
    EXPECT_EQ(picturePoint({100, 100}, place, {400, 100}), QPointF(200, 50));
}

TEST(ViewGrid, FourViewsStandTwoByTwoWithThePerspectiveAboveRight) {
    EXPECT_THAT(gridRows({"Top", "Front", "Right", "Perspective"}),
                ElementsAre(QStringList{"Top", "Perspective"}, QStringList{"Front", "Right"}));
}

TEST(ViewGrid, ThreeViewsStandInTwoRowsAndOneStandsAlone) {
    EXPECT_THAT(gridRows({"A", "B", "C"}), ElementsAre(QStringList{"A", "B"}, QStringList{"C"}));
    EXPECT_THAT(gridRows({"A"}), ElementsAre(QStringList{"A"}));
}

TEST_F(ViewAreaTest, NewDocumentHasFourViewsOfWhichThePerspectiveIsMarked) {
    EXPECT_EQ(names(), QStringList({"Top", "Front", "Right", "Perspective"}));
    EXPECT_TRUE(view("Perspective").isActive());
    EXPECT_FALSE(view("Top").isActive());
}

TEST_F(ViewAreaTest, FramesHaveTheSizesOfTheirWidgets) {
    for (const QString& name : names())
        EXPECT_EQ(frameOf(name), view(name).size()) << name.toStdString();
    window.resize(1000, 800);
    settle();
    for (const QString& name : names()) {
        EXPECT_EQ(frameOf(name), view(name).size()) << name.toStdString();
        EXPECT_EQ(view(name).picture().size(), view(name).size()) << name.toStdString();
    }
}

TEST_F(ViewAreaTest, ButtonGivesOneViewAllTheRoomAndBack) {
    click(view("Top").maximizeButton());
    EXPECT_TRUE(view("Top").isVisible());
    EXPECT_FALSE(view("Front").isVisible());
    EXPECT_FALSE(view("Perspective").isVisible());
    click(view("Top").maximizeButton());
    for (const QString& name : names())
        EXPECT_TRUE(view(name).isVisible()) << name.toStdString();
}

TEST_F(ViewAreaTest, MenuShowsTheModesWithTheCurrentOneCheckedAndChangesIt) {
    choose("Front", "X-Ray");
    EXPECT_EQ(hostView("Front").DisplayAttributes()->EnglishName(), L"X-Ray");
    QMenu& menu = view("Front").menu();
    emit menu.aboutToShow();
    EXPECT_TRUE(actionOf(menu, "X-Ray").isChecked());
    EXPECT_FALSE(actionOf(menu, "Wireframe").isChecked());
}

TEST_F(ViewAreaTest, ModeOfOneViewLeavesTheOthers) {
    choose("Front", "Clay");
    EXPECT_EQ(hostView("Front").DisplayAttributes()->EnglishName(), L"Clay");
    EXPECT_EQ(hostView("Top").DisplayAttributes()->EnglishName(), L"Wireframe");
}

TEST_F(ViewAreaTest, FixedFrameKeepsItsSizeAndIsShownWhole) {
    choose("Perspective", "1920 × 1080");
    settle();
    EXPECT_EQ(frameOf("Perspective"), QSize(1920, 1080));
    EXPECT_EQ(view("Perspective").picture().size(), QSize(1920, 1080));
    window.resize(1000, 800);
    settle();
    EXPECT_EQ(frameOf("Perspective"), QSize(1920, 1080));
    choose("Perspective", "As in the window");
    EXPECT_EQ(frameOf("Perspective"), view("Perspective").size());
}

TEST_F(ViewAreaTest, SizeThatACommandChoseIsKept) {
    run("_-ViewportSize 640 360");
    window.resize(1000, 800);
    settle();
    EXPECT_EQ(frameOf("Perspective"), QSize(640, 360));
    EXPECT_EQ(frameOf("Top"), view("Top").size());
}

TEST_F(ViewAreaTest, AddedAndRemovedViewsComeAndGo) {
    run("_-AddView Detail _Top");
    EXPECT_EQ(names(), QStringList({"Top", "Front", "Right", "Perspective", "Detail"}));
    EXPECT_TRUE(view("Detail").isVisible());
    EXPECT_TRUE(view("Detail").isActive());
    run("_-RemoveView Top");
    EXPECT_EQ(names(), QStringList({"Front", "Right", "Perspective", "Detail"}));
}

TEST_F(ViewAreaTest, ClosedMaximizedViewLeavesTheOthersInSight) {
    click(view("Top").maximizeButton());
    run("_-RemoveView Top");
    for (const QString& name : names())
        EXPECT_TRUE(view(name).isVisible()) << name.toStdString();
}

TEST_F(ViewAreaTest, EmptyDocumentSaysWhereModelsComeFrom) {
    settle();
    const QImage with_words = view("Perspective").grab().toImage();
    readSlab();
    run("_-Select _All");
    run("_-Delete");
    view("Perspective").setHint({});
    EXPECT_NE(view("Perspective").grab().toImage(), with_words);
}

/// A frame that a command shows stays to be seen although what it showed is gone again.
TEST_F(ViewAreaTest, PictureThatACommandShowsStaysAfterIt) {
    readSlab();
    run("_-SetOneDaySunAnimation 51.5 0 0 21 6 2026 6 0 18 0 60 _Enter _Enter Perspective _Enter");
    run("_-ViewFrameNumber 3");
    const QImage frame = view("Perspective").picture();
    settle();
    EXPECT_EQ(view("Perspective").picture(), frame);
    hostView("Perspective").Redraw();
    EXPECT_NE(view("Perspective").picture(), frame) << "the light of the study is gone";
}

TEST_F(ViewAreaTest, LastFrameOfAPlayGoesWhenCameraAndModeAreBack) {
    readSlab();
    setUpTurntable(3); // in wireframe, about a view that is shaded
    const QImage before = view("Perspective").picture();
    run("_-PlayAnimation");
    EXPECT_NE(view("Perspective").picture(), before);
    settle();
    EXPECT_EQ(view("Perspective").picture(), before);
}

} // namespace
} // namespace quarn::desktop::test
