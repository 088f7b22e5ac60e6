#include "desktop/command_line/CommandStarter.h"
#include "desktop/documents/ProgramEnd.h"
#include "desktop/documents/StartedLine.h"
#include "desktop/recovery/RecoveryOffer.h"
#include "desktop/texts/Texts.h"
#include "desktop/window/Arguments.h"
#include "desktop/window/InstalledFiles.h"
#include "desktop/window/Language.h"
#include "desktop/window/MainWindow.h"
#include "host/session/DocumentState.h"
#include "host/session/Recovery.h"
#include "host/session/StopSignals.h"

#include <QApplication>
#include <QTimer>

#include <cstdio>

namespace {

using namespace quarn::desktop;

/// @param is_attended  whether a person is there, who may be asked which way a model is up
void openFile(MainWindow& window, const QString& file, bool is_attended) {
    if (file.isEmpty())
        return;
    const QString word = quotedPath(std::filesystem::absolute(nativePath(file)));
    if (!word.isEmpty())
        window.starter().start((is_attended ? "_Open " : "_-Open ") + word);
}

/// The program holds one document: a recovered one is not replaced by the file.
void tellNotOpened(quarn::Session& session, MainWindow& window, const QString& file) {
    std::error_code is_other;
    const std::filesystem::path at_work = quarn::documentFile(session.document());
    if (!file.isEmpty() && !std::filesystem::equivalent(at_work, nativePath(file), is_other))
        window.tellAndPrint(
            localized(L"%1 was not opened: the recovered document is at work.", 45401).arg(file));
}

/// Offers the unsaved work of earlier runs before anything is opened; where nobody may be there to
/// answer it is only told.
void begin(quarn::Session& session, MainWindow& window, const Arguments& arguments) {
    RecoveryOffer* const offer = window.recoveryOffer();
    const bool is_attended = arguments.script.isEmpty();
    if (offer && is_attended && offer->offer(nativePath(arguments.file)))
        tellNotOpened(session, window, arguments.file);
    else
        openFile(window, arguments.file, is_attended);
    if (offer && !is_attended && offer->count() > 0)
        window.tellAndPrint(localized(
            L"An earlier run ended with unsaved work: File > Recover unsaved work.", 45402));
    if (!arguments.script.isEmpty())
        window.runScript(arguments.script, arguments.wants_exit);
}

int runWindow(QApplication& application, const Arguments& arguments) {
    const Language language(arguments.language);
    DesktopFrontEnd front_end;
    quarn::SessionOptions options = sessionOptions(arguments.language.toStdString());
    options.overwrites = arguments.overwrites;
    options.most_memory = arguments.most_memory;
    options.builds_scenes = true;
    quarn::Session session(front_end, std::move(options));
    const quarn::PlugInLoad load = session.loadPlugIn(plugInFolder() / "Zoetrix.qnp");
    MainWindow window(session, front_end);
    window.restoreLayout();
    window.show();
    if (!load.ok())
        front_end.print(KM_wString::FromUtf8(load.message + "\n").View());
    window.programEnd().watchSignals();
    if (arguments.wants_recovery)
        window.keepUnsavedWork({.state_folder = {}, .every = arguments.recovery_every});
    QTimer::singleShot(0, &window, [&] { begin(session, window, arguments); });
    const int exit_code = application.exec();
    window.finish();
    return quarn::stopSignal() == 0 ? exit_code : 128 + quarn::stopSignal();
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
    QApplication application(argument_count, arguments);
    QApplication::setOrganizationName("Quarn");
    QApplication::setApplicationName("quarn-desktop");
    QApplication::setApplicationVersion(QUARN_VERSION);
    return runWindow(application, typed);
}
