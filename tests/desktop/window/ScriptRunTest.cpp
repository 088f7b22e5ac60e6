#include "tests/support/TempFolder.h"

#include <gtest/gtest.h>

#include <QProcess>

namespace quarn::desktop {
namespace {

using quarn::test::TempFolder;
using quarn::test::writeFile;

/// How the window ends that runs these lines.
int exitCodeOf(const char* lines) {
    const TempFolder folder;
    writeFile(folder / "script.txt", lines);
    QProcess window;
    QProcessEnvironment surroundings = QProcessEnvironment::systemEnvironment();
    surroundings.insert("HOME", QString::fromStdString(folder.path().string()));
    surroundings.insert("QT_QPA_PLATFORM", "offscreen");
    window.setProcessEnvironment(surroundings);
    window.start(
        QUARN_DESKTOP_PROGRAM,
        {"--run-script", QString::fromStdString((folder / "script.txt").string()), "--exit"});
    EXPECT_TRUE(window.waitForFinished(20000));
    return window.exitStatus() == QProcess::NormalExit ? window.exitCode() : -1;
}

TEST(ScriptRun, EndsTheProgramWithoutAskingAboutChanges) {
    EXPECT_EQ(exitCodeOf("_-ViewportSize 20 20\n_-Line 0,0,0 1,1,1\n"), 0);
}

TEST(ScriptRun, FailedCommandIsSeenInTheExitCode) {
    EXPECT_EQ(exitCodeOf("_-Line 0,0,0 1,1,1\n_-NoSuchCommand\n"), 1);
}

TEST(ScriptRun, RecordingThatWroteNothingIsSeenInTheExitCode) {
    // Pictures of such a name have more letters than the name of a file may have; the page has not.
    const std::string lines =
        "_-ViewportSize 20 20\n_-AnimationName " + std::string(250, 'a') +
        "\n_-SetTurntableAnimation 2 _Clockwise _png _Wireframe _Enter _Enter\n"
        "_-RecordAnimation _Enter\n";
    EXPECT_EQ(exitCodeOf(lines.c_str()), 1);
}

} // namespace
} // namespace quarn::desktop
