#pragma once

#include "quarn/arguments/ProgramArguments.h"
#include "quarn/words/FirstMistake.h"
#include "quarn/words/Words.h"

#include <string>
#include <vector>

namespace quarn::program {

/// Checks from where a sun study is seen, and composes the host commands that take the camera
/// there. The camera of a document is somebody's choice: without an option it stays.
///
/// @return one host command a line; with a mistake they are not to be run
std::vector<std::string> studyViewLines(const StudyViewOptions& options,
                                        const std::filesystem::path& model, FirstMistake& mistake);

} // namespace quarn::program
