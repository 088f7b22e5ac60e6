#pragma once

#include "quarn/scripts/DocumentRecordingScript.h"
#include "quarn/session/HostSession.h"
#include "quarn/words/Outcome.h"

#include <chrono>
#include <string>
#include <vector>

namespace quarn::program {

/// The threads of each of several recorders that share a machine.
/// @param threads  of all together; 0: one for each core
int threadsOfEach(int jobs, int threads, int cores);

/// The arguments of a recorder.
/// @param begins_anew  whether it is the one that makes the folder ready for all
std::vector<std::string> recorderArguments(const DocumentRecordingRequest& request,
                                           const CommonOptions& common, int threads,
                                           bool begins_anew);

/// Records with several recorders that share the frames, each a process that reads the document for
/// itself, and then, in this process, what they left: frames of those that died, page and list.
/// @param common  of the recording, its instruction set too
/// @param start   when the work began
Outcome recordWithJobs(const DocumentRecordingRequest& request, int jobs,
                       const CommonOptions& common, std::chrono::steady_clock::time_point start);

} // namespace quarn::program
