// A window while a model file is read that never ends: the stand-in for the reading program hangs.
#include "tests/desktop/window/WindowFixture.h"

#include <QLabel>
#include <QPushButton>
#include <QThread>

#include <gmock/gmock.h>

namespace quarn::desktop::test {
namespace {

class ModelReadingTest : public WindowTest {
protected:
    ModelReadingTest() {
        qputenv("QUARN_READER", QUARN_STAND_IN_READER);
        for (const char* const name : {"hang.obj", "crash.obj"})
            quarn::test::writeFile(folder / name, "v 0 0 0\n");
    }
    ~ModelReadingTest() override { qunsetenv("QUARN_READER"); }

    void open(const char* name) { run("_-Open \"" + qtText(folder / name) + '"'); }

    /// Looks at the window some times a second while it works.
    void whileItWorks(const std::function<void()>& look) {
        QObject::connect(&m_clock, &QTimer::timeout, &window, look);
        m_clock.start(5); // what is looked for may last a tenth of a second
    }

    QTimer m_clock;
};

TEST_F(ModelReadingTest, ShowsHowFarItIsAndIsCancelledByItsButton) {
    QString text;
    whileItWorks([&] {
        auto* const label = window.findChild<QLabel*>("progressText");
        if (!label || !label->isVisible())
            return;
        text = label->text();
        window.findChild<QPushButton*>("progressCancel")->click();
    });
    open("hang.obj");
    EXPECT_EQ(text, "Making the meshes: 25 %");
    EXPECT_TRUE(printed().contains("hang.obj was not read: it was given up."));
    EXPECT_FALSE(window.findChild<QLabel*>("progressText")->isVisible());
}

TEST_F(ModelReadingTest, LeavesTheWindowAlive) {
    int looks = 0;
    whileItWorks([&] {
        if (++looks == 20)
            window.starter().stop();
    });
    open("hang.obj");
    EXPECT_EQ(looks, 20);
}

/// A field of half a million triangles.
std::string largeObj() {
    constexpr int SQUARES = 500;
    std::string text;
    for (int i = 0; i <= SQUARES; ++i)
        for (int j = 0; j <= SQUARES; ++j)
            text += "v " + std::to_string(i) + ' ' + std::to_string(j) + " 0\n";
    for (int i = 0; i < SQUARES; ++i)
        for (int j = 1; j <= SQUARES; ++j) {
            const int corner = i * (SQUARES + 1) + j;
            text += "f " + std::to_string(corner) + ' ' + std::to_string(corner + 1) + ' ' +
                    std::to_string(corner + SQUARES + 2) + ' ' +
                    std::to_string(corner + SQUARES + 1) + '\n';
        }
    return text;
}

TEST_F(ModelReadingTest, IsCancelledWhileTheSceneIsBuilt) {
    qunsetenv("QUARN_READER"); // the program that comes with the host reads it
    quarn::test::writeFile(folder / "large.obj", largeObj());
    run("_Point 1,2,3");
    QString text;
    bool has_waited = false;
    whileItWorks([&] {
        if (!std::exchange(has_waited, true))
            QThread::msleep(310); // so that it is worth showing
        const QString shown = window.findChild<QLabel*>("progressText")->text();
        if (!shown.startsWith("Building the scene"))
            return;
        text = shown;
        window.findChild<QPushButton*>("progressCancel")->click();
    });
    open("large.obj");
    EXPECT_TRUE(text.startsWith("Building the scene: ")) << text.toStdString();
    EXPECT_TRUE(printed().contains("large.obj was not read: it was given up."));
    run("_-List _Objects");
    EXPECT_TRUE(printed().contains("1 point;"));
}

TEST_F(ModelReadingTest, ThatCrashesLeavesTheDocumentAsItWas) {
    run("_Point 1,2,3");
    open("crash.obj");
    EXPECT_TRUE(
        printed().contains("crash.obj could not be read: the reader stopped unexpectedly."));
    run("_-List _Objects");
    EXPECT_TRUE(printed().contains("1 point;"));
}

} // namespace
} // namespace quarn::desktop::test
