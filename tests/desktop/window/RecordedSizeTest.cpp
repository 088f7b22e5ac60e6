#include "tests/desktop/window/WindowFixture.h"

#include <QToolButton>

namespace quarn::desktop::test {
namespace {

/// How large a turntable of the view Perspective is recorded, and which size the button beside
/// Record tells.
class RecordedSizeTest : public WindowTest {
protected:
    RecordedSizeTest() {
        readSlab();
        setUpTurntable(2);
    }

    QToolButton& button() { return part<QToolButton>(window, "frameSize"); }
    void choose(const QString& text) {
        QMenu& menu = *button().menu();
        emit menu.aboutToShow();
        for (QAction* const action : menu.actions()) {
            if (action->text() == text)
                return action->trigger();
        }
        ADD_FAILURE() << "there is no size " << text.toStdString();
    }
    QString checked() {
        QMenu& menu = *button().menu();
        emit menu.aboutToShow();
        QStringList texts;
        for (const QAction* const action : menu.actions()) {
            if (action->isChecked())
                texts.append(action->text());
        }
        return texts.join('|');
    }
    /// Records, and tells the size of the last picture.
    QSize recorded(const char* folder_name) {
        const std::filesystem::path target = folder / folder_name;
        std::filesystem::create_directory(target);
        run("_-RecordAnimation TargetFolder \"" + qtText(target) + "\" _Enter");
        settle();
        return QImage(qtText(target / "Animation001.jpg")).size();
    }
    QSize frame() {
        CQuarnDisplayPipeline& pipeline = *hostView("Perspective").MainViewport().DisplayPipeline();
        return {pipeline.FrameWidth(), pipeline.FrameHeight()};
    }
};

TEST_F(RecordedSizeTest, IsThatOfAVideoAtFirstAndTheViewKeepsTheWindows) {
    EXPECT_EQ(button().text(), "1280 × 720");
    EXPECT_EQ(checked(), "1280 × 720");
    EXPECT_EQ(recorded("first"), QSize(1280, 720));
    EXPECT_EQ(frame(), view("Perspective").size());
    EXPECT_EQ(view("Perspective").picture().size(), view("Perspective").size());
    EXPECT_FALSE(view("Perspective").fixedFrame());
}

TEST_F(RecordedSizeTest, IsTheOneThatWasChosenAlsoInTheNextRunOfTheProgram) {
    choose("1920 × 1080");
    EXPECT_EQ(button().text(), "1920 × 1080");
    EXPECT_EQ(recorded("large"), QSize(1920, 1080));
    EXPECT_EQ(RecordedSize().chosen(), QSize(1920, 1080));
}

TEST_F(RecordedSizeTest, CanBeThatOfTheWindow) {
    choose("As in the window");
    const QSize size_px = view("Perspective").size();
    EXPECT_EQ(button().text(), QString("%1 × %2").arg(size_px.width()).arg(size_px.height()));
    EXPECT_EQ(recorded("window"), size_px);
    EXPECT_EQ(RecordedSize().chosen(), std::nullopt);
    EXPECT_EQ(checked(), "As in the window");
}

TEST_F(RecordedSizeTest, IsTheOneThatACommandGaveTheView) {
    run("_-ViewportSize 640 360");
    EXPECT_EQ(button().text(), "640 × 360");
    EXPECT_EQ(checked(), "640 × 360");
    EXPECT_EQ(recorded("command"), QSize(640, 360));
    EXPECT_EQ(frame(), QSize(640, 360));
    choose("1280 × 720");
    EXPECT_EQ(button().text(), "1280 × 720");
    EXPECT_EQ(frame(), view("Perspective").size());
}

TEST_F(RecordedSizeTest, HoldsForAViewThatIsNotShown) {
    window.views().toggleMaximized("Top");
    settle();
    EXPECT_EQ(recorded("hidden"), QSize(1280, 720));
    window.views().toggleMaximized("Top");
    settle();
    EXPECT_EQ(frame(), view("Perspective").size());
}

} // namespace
} // namespace quarn::desktop::test
