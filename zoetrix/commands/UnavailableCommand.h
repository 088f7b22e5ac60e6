#pragma once

#include "sdk/qncore/QnCommand.h"

/// Tells at the command line that a command cannot do its work in this version.
/// @return failure
CQuarnCommand::result ReportUnavailable(const wchar_t* command_name);
