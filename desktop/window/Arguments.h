#pragma once

#include <chrono>
#include <cstdint>

#include <QString>
#include <QStringList>

namespace quarn::desktop {

/// What a person typed behind the program's name.
struct Arguments {
    QString file;                  ///< model or document to open; may be empty
    QString language;              ///< empty: the environment's
    QString script;                ///< command lines to run in the window; may be empty
    bool overwrites = false;       ///< as SessionOptions has it
    std::uint64_t most_memory = 0; ///< as SessionOptions has it
    bool wants_exit = false;       ///< ends when the script has
    bool wants_recovery = true;    ///< unsaved work is kept, and that of earlier runs offered
    std::chrono::milliseconds recovery_every{10000};
    QString answer;  ///< printed instead of opening a window: help or the version
    QString mistake; ///< why the arguments cannot be taken; then nothing else counts
};

/// Reads the arguments, the program's name first.
Arguments readArguments(const QStringList& arguments);

/// Why no window can be opened here, before Qt ends the program over it; empty where one can.
QString whyNoWindow();

} // namespace quarn::desktop
