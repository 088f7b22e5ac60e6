#pragma once

#include "sdk/qncore/QnCommand.h"

#include <memory>
#include <span>
#include <vector>

namespace quarn {

/// One of the host's own commands.
struct HostCommandEntry {
    const wchar_t* name;        ///< English; letters and digits only
    const char* id;             ///< its fixed UUID
    const wchar_t* description; ///< English, one line without a full stop, shown by `Help`
    int description_id;         ///< its number in the string tables, from 41001
    CQuarnCommand::result (*run)(const CQuarnCommandContext& context);
    /// Whether `Help` leaves it out: programs offer it where it can do something.
    bool is_hidden = false;
};

/// Makes the command objects of a table, in its order. They are announced nowhere: whoever takes
/// them registers them.
/// @param entries  must outlive the commands
std::vector<std::unique_ptr<CQuarnCommand>> makeCommands(std::span<const HostCommandEntry> entries);

/// The commands of the table in HostCommands.cpp.
std::vector<std::unique_ptr<CQuarnCommand>> makeHostCommands();

CQuarnCommand::result runExit(const CQuarnCommandContext& context);
CQuarnCommand::result runHelp(const CQuarnCommandContext& context);
CQuarnCommand::result runLoadPlugIn(const CQuarnCommandContext& context);
CQuarnCommand::result runRun(const CQuarnCommandContext& context);
CQuarnCommand::result runAddView(const CQuarnCommandContext& context);
CQuarnCommand::result runAnimationName(const CQuarnCommandContext& context);
CQuarnCommand::result runCamera(const CQuarnCommandContext& context);
CQuarnCommand::result runCircle(const CQuarnCommandContext& context);
CQuarnCommand::result runCloseRenderWindow(const CQuarnCommandContext& context);
CQuarnCommand::result runDelete(const CQuarnCommandContext& context);
CQuarnCommand::result runDisplayEdges(const CQuarnCommandContext& context);
CQuarnCommand::result runDisplayMode(const CQuarnCommandContext& context);
CQuarnCommand::result runEvenSpeed(const CQuarnCommandContext& context);
CQuarnCommand::result runFitView(const CQuarnCommandContext& context);
CQuarnCommand::result runHide(const CQuarnCommandContext& context);
CQuarnCommand::result runImport(const CQuarnCommandContext& context);
CQuarnCommand::result runImportCurve(const CQuarnCommandContext& context);
CQuarnCommand::result runJoinSunStudy(const CQuarnCommandContext& context);
CQuarnCommand::result runJpegQuality(const CQuarnCommandContext& context);
CQuarnCommand::result runLine(const CQuarnCommandContext& context);
CQuarnCommand::result runList(const CQuarnCommandContext& context);
CQuarnCommand::result runMovePoint(const CQuarnCommandContext& context);
CQuarnCommand::result runNextRecording(const CQuarnCommandContext& context);
CQuarnCommand::result runNew(const CQuarnCommandContext& context);
CQuarnCommand::result runOpen(const CQuarnCommandContext& context);
CQuarnCommand::result runPoint(const CQuarnCommandContext& context);
CQuarnCommand::result runPolyline(const CQuarnCommandContext& context);
CQuarnCommand::result runRecover(const CQuarnCommandContext& context);
CQuarnCommand::result runRemoveView(const CQuarnCommandContext& context);
CQuarnCommand::result runRename(const CQuarnCommandContext& context);
CQuarnCommand::result runRender(const CQuarnCommandContext& context);
CQuarnCommand::result runRenderPreview(const CQuarnCommandContext& context);
CQuarnCommand::result runRenderSettings(const CQuarnCommandContext& context);
CQuarnCommand::result runSave(const CQuarnCommandContext& context);
CQuarnCommand::result runSaveAs(const CQuarnCommandContext& context);
CQuarnCommand::result runSaveFrame(const CQuarnCommandContext& context);
CQuarnCommand::result runSaveRenderWindowAs(const CQuarnCommandContext& context);
CQuarnCommand::result runSaveSelected(const CQuarnCommandContext& context);
CQuarnCommand::result runSelect(const CQuarnCommandContext& context);
CQuarnCommand::result runShow(const CQuarnCommandContext& context);
CQuarnCommand::result runSpline(const CQuarnCommandContext& context);
CQuarnCommand::result runSplineThrough(const CQuarnCommandContext& context);
CQuarnCommand::result runStandardView(const CQuarnCommandContext& context);
CQuarnCommand::result runSun(const CQuarnCommandContext& context);
CQuarnCommand::result runSunStudyPlace(const CQuarnCommandContext& context);
CQuarnCommand::result runViewportSize(const CQuarnCommandContext& context);

} // namespace quarn
