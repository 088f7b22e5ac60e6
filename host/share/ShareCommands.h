#pragma once

#include "host/commands/HostCommands.h"

namespace quarn {

/// The commands that make of an animation what people send to others; the table is in
/// ShareCommands.cpp.
std::vector<std::unique_ptr<CQuarnCommand>> makeShareCommands();

CQuarnCommand::result runExportCamera(const CQuarnCommandContext& context);
CQuarnCommand::result runFilm(const CQuarnCommandContext& context);
CQuarnCommand::result runViewerPage(const CQuarnCommandContext& context);

} // namespace quarn
