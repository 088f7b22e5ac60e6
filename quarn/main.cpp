#include "quarn/arguments/ProgramArguments.h"
#include "quarn/console/Console.h"
#include "quarn/reports/CurveReport.h"
#include "quarn/reports/ModelReport.h"
#include "quarn/reports/PlaceList.h"
#include "quarn/runs/CameraPath.h"
#include "quarn/runs/ScriptRun.h"
#include "quarn/runs/SingleFrame.h"
#include "quarn/runs/SunStudy.h"
#include "quarn/runs/Turntable.h"

#include <cstdio>
#include <exception>

namespace {

using namespace quarn::program;

Outcome answer(const Outcome& outcome) {
    return outcome;
}
Outcome answer(const TurntableOptions& options) {
    return recordTurntable(options);
}
Outcome answer(const FlythroughOptions& options) {
    return recordFlythrough(options);
}
Outcome answer(const PathOptions& options) {
    return recordPath(options);
}
Outcome answer(const DayOptions& options) {
    return recordDay(options);
}
Outcome answer(const SeasonOptions& options) {
    return recordSeason(options);
}
Outcome answer(const PlacesOptions& options) {
    return listPlaces(options);
}
Outcome answer(const CurvesOptions& options) {
    return reportCurves(options);
}
Outcome answer(const ScriptOptions& options) {
    return runScript(options);
}
Outcome answer(const ModelOptions& options) {
    return reportModel(options);
}
Outcome answer(const ConsoleOptions& options) {
    return runConsole(options);
}
Outcome answer(const FrameOptions& options) {
    return writeSingleFrame(options);
}

Outcome runProgram(int argument_count, char** arguments) {
    try {
        return std::visit([](const auto& request) { return answer(request); },
                          readCommandLine(argument_count, arguments));
    } catch (const std::exception& error) {
        return Outcome::failure(std::string("cannot go on: ") + error.what());
    }
}

void tell(const std::string& text, std::FILE* stream) {
    if (text.empty())
        return;
    std::fputs(text.c_str(), stream);
    if (text.back() != '\n')
        std::fputc('\n', stream);
}

} // namespace

int main(int argument_count, char** arguments) {
    const Outcome outcome = runProgram(argument_count, arguments);
    tell(outcome.text, outcome.exit_code == Outcome::done ? stdout : stderr);
    if (std::fflush(stdout) == 0)
        return outcome.exit_code;
    tell("quarn: cannot write to the standard output", stderr);
    return outcome.exit_code == Outcome::done ? Outcome::failed : outcome.exit_code;
}
