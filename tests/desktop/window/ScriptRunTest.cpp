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

} // namespace
} // namespace quarn::desktop
