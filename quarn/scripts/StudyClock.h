#pragma once

#include "quarn/scripts/SunStudyRequest.h"

#include <string>
#include <vector>

namespace quarn::program {

/// The longitude that the study is set up with: the command of a seasonal one takes it eastward,
/// from 0 to 360, and takes the zone from that.
double studyLongitude(const SunStudyRequest& request);

/// What a person should know before a study is recorded: the place, the zone that its clock shows,
/// and the universal time of the first frame.
std::vector<std::string> studyNotes(const SunStudyRequest& request);

} // namespace quarn::program
