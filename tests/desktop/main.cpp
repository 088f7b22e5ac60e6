#include <gtest/gtest.h>

#include <QApplication>
#include <QSettings>
#include <QTemporaryDir>

/// The window's parts need an application object, but no screen: the pictures stay in memory.
int main(int argument_count, char** arguments) {
    if (!qEnvironmentVariableIsSet("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
    testing::InitGoogleTest(&argument_count, arguments);
    const QTemporaryDir settings;
    QSettings::setDefaultFormat(QSettings::IniFormat);
    QSettings::setPath(QSettings::IniFormat, QSettings::UserScope, settings.path());
    qputenv("XDG_STATE_HOME", settings.path().toUtf8()); // of the programs that tests start, too
    QApplication application(argument_count, arguments);
    QApplication::setOrganizationName("Quarn");
    QApplication::setApplicationName("quarn-desktop");
    return RUN_ALL_TESTS();
}
