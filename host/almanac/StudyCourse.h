#pragma once

#include "host/almanac/CivilSite.h"
#include "sdk/qncore/QnExport.h"

#include <chrono>
#include <string>
#include <vector>

namespace quarn {

/// The moments of a sun study, and where on the earth they are seen.
struct StudyCourse {
    enum class Kind { one_day, seasonal };
    Kind kind = Kind::one_day;
    CivilSite site;
    std::chrono::sys_seconds start;   ///< of the first frame, a whole minute of UTC
    std::chrono::sys_seconds end;     ///< no frame is later; a whole minute too
    int step = 1;                     ///< between frames: minutes of a day, days of a season
    std::vector<std::string> notes{}; ///< what a person should know of how the times were found
};

/// Both ends of the span have a frame where the steps meet them.
QNCORE_API int frameCount(const StudyCourse& course);

/// The longitude that the study is set up with: the command of a seasonal one takes it eastward,
/// from 0 to 360, and takes the zone from that.
QNCORE_API double studyLongitude(const StudyCourse& course);

/// The first moment of a study, and one that no frame is later than, by the clock that the set-up
/// commands reckon in: the whole hours of the longitude.
struct StudySpan {
    std::chrono::local_seconds first;
    std::chrono::local_seconds last;
};

/// What the set-up commands are to be told. A day has one span for each date of that clock that its
/// frames fall on, as the command takes one date; a season has one.
QNCORE_API std::vector<StudySpan> studySpans(const StudyCourse& course);

/// What a person should know before a study is recorded: the place, its zone, when the first frame
/// is, and what is uncommon about the times. Sentences without their full stops.
QNCORE_API std::vector<std::string> studyNotes(const StudyCourse& course);

} // namespace quarn
