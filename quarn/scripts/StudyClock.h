#pragma once

#include "quarn/scripts/SunStudyRequest.h"

#include <chrono>
#include <string>
#include <vector>

namespace quarn::program {

/// The longitude that the study is set up with: the command of a seasonal one takes it eastward,
/// from 0 to 360, and takes the zone from that.
double studyLongitude(const SunStudyRequest& request);

/// The first moment of a study, and one that no frame is later than, by the clock that the set-up
/// commands reckon in: the whole hours of the longitude.
struct StudySpan {
    std::chrono::local_seconds first;
    std::chrono::local_seconds last;
};

/// What the set-up commands are to be told. A day has one span for each date of that clock that its
/// frames fall on, as the command takes one date; a season has one.
std::vector<StudySpan> studySpans(const SunStudyRequest& request);

/// What a person should know before a study is recorded: the place, its zone, when the first frame
/// is, and what is uncommon about the times.
std::vector<std::string> studyNotes(const SunStudyRequest& request);

} // namespace quarn::program
