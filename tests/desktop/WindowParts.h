#pragma once

#include "desktop/command_line/CommandStarter.h"
#include "desktop/front_end/DesktopFrontEnd.h"
#include "desktop/texts/Texts.h"
#include "host/session/Session.h"
#include "tests/support/TempFolder.h"

#include <QApplication>
#include <QSettings>
#include <QTest>
#include <QTimer>

#include <gtest/gtest.h>

#include <functional>

namespace quarn::desktop::test {

/// The tree that the tested program runs from.
inline std::filesystem::path programTree() {
    return std::filesystem::path(QUARN_DESKTOP_PROGRAM).parent_path().parent_path();
}

inline SessionOptions sessionOptions(const std::string& language,
                                     const std::filesystem::path& documents_folder) {
    const std::filesystem::path shared = programTree() / "share" / "quarn";
    const std::filesystem::path locale = shared / "locale";
    SessionOptions options;
    options.plug_in_folders = {programTree() / "lib" / "quarn" / "plug-ins"};
    options.locale_folders = {locale / "host"};
    options.program_locale_folder = locale / "desktop";
    options.dialog_folders = {shared / "dialogs"};
    options.viewer_folder = shared / "viewer";
    options.language = language;
    options.documents_folder = documents_folder;
    return options;
}

/// The running host with the animation plug-in, behind the window's front end. What it prints is
/// kept; tests set the other parts.
class WindowPartsTest : public testing::Test {
protected:
    explicit WindowPartsTest(const std::string& language = "C")
        : m_session_options(sessionOptions(language, folder.path())) {
        QSettings().clear();
        const PlugInLoad load =
            session.loadPlugIn(programTree() / "lib" / "quarn" / "plug-ins" / "Zoetrix.qnp");
        EXPECT_TRUE(load.ok()) << load.message;
        usePart([](FrontEndParts&) {});
        QObject::connect(&starter, &CommandStarter::started,
                         [this](const QString& line) { started.append(line); });
        QObject::connect(&starter, &CommandStarter::ended,
                         [this](CQuarnCommand::result result) { last_result = result; });
    }

    /// Changes the parts that the front end uses.
    void usePart(const std::function<void(FrontEndParts&)>& change) {
        parts.print = [this](std::wstring_view text) { printed += qtText(text); };
        change(parts);
        front_end.setParts(parts);
    }
    /// Runs a command line that needs nobody.
    void run(const QString& line) {
        EXPECT_EQ(session.runCommand(wideText(line).View()), CQuarnCommand::success)
            << line.toStdString() << '\n'
            << printed.toStdString();
    }
    /// Sets up a turntable of a small square, in a small picture.
    void setUpTurntable(int frames) {
        run("_Polyline 0,0,0 4,0,0 4,4,0 _Enter");
        run("_ViewportSize 64 48");
        run("_FitView _Enter");
        run("_AnimationName Turn");
        run(QString("_SetTurntableAnimation %1 _Clockwise _jpg _Wireframe Perspective _Enter")
                .arg(frames));
    }
    KM_3dmAnimationProperties record() {
        return session.document().Properties().AnimationProperties();
    }

    quarn::test::TempFolder folder;
    SessionOptions m_session_options;
    QString printed;
    FrontEndParts parts;
    DesktopFrontEnd front_end;
    Session session{front_end, m_session_options};
    CommandStarter starter{session, front_end};
    QStringList started; ///< command lines, in their order
    std::optional<CQuarnCommand::result> last_result;
};

/// Does something once the event loop comes to it, such as answering what is asked meanwhile.
inline void later(std::function<void()> work) {
    QTimer::singleShot(0, std::move(work));
}

/// A part of a widget by its name; a failure where there is none.
template <class Widget> Widget& part(QObject& parent, const QString& name) {
    auto* const found = parent.findChild<Widget*>(name);
    if (!found) {
        ADD_FAILURE() << "there is no " << name.toStdString();
        std::abort();
    }
    return *found;
}

inline void click(QWidget& widget) {
    QTest::mouseClick(&widget, Qt::LeftButton);
}

} // namespace quarn::desktop::test
