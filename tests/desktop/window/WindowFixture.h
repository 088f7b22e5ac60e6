#pragma once

#include "desktop/command_line/CommandPane.h"
#include "desktop/views/OpenViews.h"
#include "desktop/views/ViewArea.h"
#include "desktop/views/ViewWidget.h"
#include "desktop/window/MainWindow.h"
#include "tests/desktop/WindowParts.h"

#include <QSettings>

namespace quarn::desktop::test {

/// The whole window on a screen that nobody sees, with a square of lines and a triangle of a model
/// that can be read.
class WindowTest : public testing::Test {
protected:
    WindowTest() {
        QSettings().clear();
        const PlugInLoad load =
            session.loadPlugIn(programTree() / "lib" / "quarn" / "plug-ins" / "Zoetrix.qnp");
        EXPECT_TRUE(load.ok()) << load.message;
        window.resize(900, 700);
        window.show();
        settle();
    }

    static SessionOptions strictOptions(const std::filesystem::path& documents) {
        SessionOptions options = sessionOptions("C", documents);
        options.strict = true;
        options.builds_scenes = true;
        return options;
    }

    /// Lets the window do what it put off: layouts, and the drawing of views.
    static void settle() { QTest::qWait(20); }
    /// A slab of 4 by 4 by 1 about the origin's upper side, seen whole in all views.
    void readSlab() {
        quarn::test::writeFile(folder / "slab.obj", "o Slab\n"
                                                    "v -2 -2 0\nv 2 -2 0\nv 2 2 0\nv -2 2 0\n"
                                                    "v -2 -2 1\nv 2 -2 1\nv 2 2 1\nv -2 2 1\n"
                                                    "f 4 3 2 1\nf 5 6 7 8\nf 1 2 6 5\nf 2 3 7 6\n"
                                                    "f 3 4 8 7\nf 4 1 5 8\n");
        run("_-Open \"" + qtText(folder / "slab.obj") + '"');
        settle();
    }
    /// A turntable of the slab that plays in the view Perspective.
    void setUpTurntable(int frames) {
        run(QString("_-SetTurntableAnimation %1 _Clockwise _jpg _Wireframe Perspective Turn")
                .arg(frames));
    }
    void run(const QString& line) { window.starter().start(line); }

    ViewWidget& view(const QString& name) {
        ViewWidget* const found = window.views().widget(name);
        if (!found) {
            ADD_FAILURE() << "there is no view " << name.toStdString();
            std::abort();
        }
        return *found;
    }
    CQuarnView& hostView(const QString& name) { return *findView(session.document(), name); }
    KM_3dPoint cameraOf(const QString& name) {
        return hostView(name).MainViewport().VP().CameraLocation();
    }
    QString printed() { return window.commandPane().output().toPlainText(); }

    quarn::test::TempFolder folder;
    DesktopFrontEnd front_end;
    Session session{front_end, strictOptions(folder.path())};
    MainWindow window{session, front_end};
};

} // namespace quarn::desktop::test
