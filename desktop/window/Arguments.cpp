#include "desktop/window/Arguments.h"

#include "host/session/MemorySize.h"

#include <QCommandLineParser>

#include <cmath>

namespace quarn::desktop {

namespace {

constexpr double SHORTEST_BEAT_S = 0.1;
constexpr double LONGEST_BEAT_S = 3600.0;

bool isSet(const char* variable) {
    return !qEnvironmentVariableIsEmpty(variable);
}

/// The steady beat that keeps unsaved work; a mistake where it is none.
void readBeat(const QString& seconds, Arguments& read) {
    bool is_number = false;
    const double every_s = seconds.toDouble(&is_number);
    if (!is_number || !(every_s >= SHORTEST_BEAT_S) || every_s > LONGEST_BEAT_S)
        read.mistake = "--recovery-every takes seconds from 0.1 to 3600, such as 10 or 0.5.";
    else
        read.recovery_every = std::chrono::milliseconds(std::llround(every_s * 1000.0));
}

/// What reading a model may take; a mistake where it is no size.
void readMemory(const QString& size, Arguments& read) {
    const std::optional<std::uint64_t> bytes = memorySize(size.toStdString());
    if (bytes)
        read.most_memory = *bytes;
    else
        read.mistake = "--limit-memory takes a size from 1M, such as 500M or 2G.";
}

} // namespace

Arguments readArguments(const QStringList& arguments) {
    QCommandLineParser parser;
    parser.setApplicationDescription(
        "The window of Quarn: shows models, and sets up and records their animations.");
    parser.addPositionalArgument("file", "A model or a document to open.", "[file]");
    const QCommandLineOption help({"h", "help"}, "Shows this help.");
    const QCommandLineOption version("version", "Shows the version.");
    const QCommandLineOption language("language",
                                      "The language of the window: en, de, es, fr, ja "
                                      "or zh. Default: the environment's.",
                                      "code");
    const QCommandLineOption script("run-script", "Runs the command lines of a file in the window.",
                                    "script");
    const QCommandLineOption exit(
        "exit", "Ends when the script has ended: with 0, or with 1 where a command failed or "
                "a recording lacks pictures.");
    const QCommandLineOption overwrite(
        "overwrite",
        "Replaces write-protected files, and by a recording those that none of its name wrote.");
    const QCommandLineOption memory("limit-memory",
                                    "Memory that reading a model may take, such as 500M or 2G. "
                                    "Default: half of what is free.",
                                    "size");
    const QCommandLineOption every(
        "recovery-every", "Keeps unsaved work for recovery so often. Default: 10.", "seconds");
    const QCommandLineOption no_recovery(
        "no-recovery", "Neither keeps unsaved work for recovery nor offers that of earlier runs.");
    parser.addOptions(
        {help, version, language, overwrite, script, exit, memory, every, no_recovery});

    Arguments read;
    const bool is_good = parser.parse(arguments);
    if (!is_good)
        read.mistake = parser.errorText();
    else if (parser.positionalArguments().size() > 1)
        read.mistake = "Only one file can be opened at the start.";
    else if (parser.isSet(help))
        read.answer = parser.helpText();
    else if (parser.isSet(version))
        read.answer = "quarn-desktop " QUARN_VERSION "\n";
    read.file = parser.positionalArguments().value(0);
    read.language = parser.value(language);
    read.script = parser.value(script);
    read.overwrites = parser.isSet(overwrite);
    read.wants_exit = parser.isSet(exit);
    read.wants_recovery = !parser.isSet(no_recovery);
    if (read.mistake.isEmpty() && parser.isSet(every))
        readBeat(parser.value(every), read);
    if (read.mistake.isEmpty() && parser.isSet(memory))
        readMemory(parser.value(memory), read);
    return read;
}

QString whyNoWindow() {
#ifdef Q_OS_LINUX
    const bool has_display = isSet("DISPLAY") || isSet("WAYLAND_DISPLAY");
    if (!has_display && !isSet("QT_QPA_PLATFORM"))
        return "There is no display to open a window on: neither DISPLAY nor WAYLAND_DISPLAY is "
               "set. The program quarn does the same without one.";
#endif
    return {};
}

} // namespace quarn::desktop
