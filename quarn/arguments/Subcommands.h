#pragma once

#include "quarn/words/Outcome.h"

#include <functional>

namespace CLI {
class App;
}

namespace quarn::program {

/// What a command of the program does once its words are read.
using Action = std::function<Outcome()>;

/// These add the options of a command, and give its action. The action holds what is read.
Action addTurntable(CLI::App& command);
Action addShare(CLI::App& command);
Action addFlythrough(CLI::App& command);
Action addPath(CLI::App& command);
Action addDay(CLI::App& command);
Action addSeason(CLI::App& command);
Action addSunHours(CLI::App& command);
Action addRecord(CLI::App& command);
Action addFinish(CLI::App& command);
Action addFarm(CLI::App& command);
Action addVideo(CLI::App& command);
Action addSun(CLI::App& command);
Action addSunPath(CLI::App& command);
Action addPlaces(CLI::App& command);
Action addCurves(CLI::App& command);
Action addFrame(CLI::App& command);
Action addCamera(CLI::App& command);
Action addPage(CLI::App& command);
Action addRun(CLI::App& command);
Action addConsole(CLI::App& command);
Action addInfo(CLI::App& command);

} // namespace quarn::program
