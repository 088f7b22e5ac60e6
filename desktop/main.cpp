#include "desktop/command_line/CommandStarter.h"
#include "desktop/documents/StartedLine.h"
#include "desktop/texts/Texts.h"
#include "desktop/window/Arguments.h"
#include "desktop/window/InstalledFiles.h"
#include "desktop/window/Language.h"
#include "desktop/window/MainWindow.h"

#include <QApplication>
#include <QTimer>

#include <csignal>
#include <cstdio>

namespace {

using namespace quarn::desktop;

/// A document is opened; a model is read into the new document that is there.
void openFile(MainWindow& window, const QString& file) {
    if (file.isEmpty())
        return;
    const QString word = quotedPath(std::filesystem::absolute(nativePath(file)));
    if (!word.isEmpty())
        window.starter().start("_-Open " + word);
}

int runWindow(QApplication& application, const Arguments& arguments) {
    const Language language(arguments.language);
    DesktopFrontEnd front_end;
    quarn::SessionOptions options = sessionOptions(arguments.language.toStdString());
    options.overwrites = arguments.overwrites;
    quarn::Session session(front_end, std::move(options));
    const quarn::PlugInLoad load = session.loadPlugIn(plugInFolder() / "Zoetrix.qnp");
    MainWindow window(session, front_end);
    window.restoreLayout();
    window.show();
    if (!load.ok())
        front_end.print(KM_wString::FromUtf8(load.message + "\n").View());
    QTimer::singleShot(0, &window, [&] {
        openFile(window, arguments.file);
        if (!arguments.script.isEmpty())
            window.runScript(arguments.script, arguments.wants_exit);
    });
    return application.exec();
}

int answer(const QString& text, std::FILE* stream, int exit_code) {
    std::fputs(qPrintable(text), stream);
    return exit_code;
}

} // namespace

int main(int argument_count, char** arguments) {
    QStringList words;
    for (int i = 0; i < argument_count; ++i)
        words.append(QString::fromLocal8Bit(arguments[i]));
    const Arguments typed = readArguments(words);
    if (!typed.mistake.isEmpty())
        return answer("quarn-desktop: " + typed.mistake + "\n", stderr, 2);
    if (!typed.answer.isEmpty())
        return answer(typed.answer, stdout, 0);
    if (const QString why = whyNoWindow(); !why.isEmpty())
        return answer("quarn-desktop: " + why + "\n", stderr, 1);
    std::signal(SIGXFSZ, SIG_IGN); // a file that may not grow is a write that fails, no crash
    QApplication application(argument_count, arguments);
    QApplication::setOrganizationName("Quarn");
    QApplication::setApplicationName("quarn-desktop");
    QApplication::setApplicationVersion(QUARN_VERSION);
    return runWindow(application, typed);
}
