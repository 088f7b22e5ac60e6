#include "quarn/scripts/SunStudyScript.h"

#include "quarn/scripts/StudyClock.h"
#include "quarn/words/Words.h"

namespace quarn::program {

namespace {

std::string numbers(std::initializer_list<int> values) {
    std::string text;
    for (const int value : values)
        text += std::to_string(value) + " ";
    return text;
}

std::string site(const SunStudyRequest& request) {
    return numberText(request.site.latitude_deg) + " " + numberText(studyLongitude(request)) + " " +
           numberText(request.site.north_deg) + " ";
}

std::string date(const COleDateTime& moment) {
    return numbers({moment.GetDay(), moment.GetMonth(), moment.GetYear()});
}

std::string time(const COleDateTime& moment) {
    return numbers({moment.GetHour(), moment.GetMinute()});
}

std::string oneDay(const SunStudyRequest& request) {
    return "_-SetOneDaySunAnimation " + site(request) + date(request.start) + time(request.start) +
           time(request.end);
}

std::string seasonal(const SunStudyRequest& request) {
    return "_-SetSeasonalSunAnimation " + site(request) + date(request.start) + date(request.end) +
           time(request.start);
}

} // namespace

AnimationLines sunStudyLines(const SunStudyRequest& request) {
    const bool is_one_day = request.kind == SunStudyRequest::Kind::one_day;
    AnimationLines lines;
    lines.preparing = linesFor(request.view, isDocument(request.recording.model));
    lines.setting_up = (is_one_day ? oneDay(request) : seasonal(request)) +
                       numbers({request.step}) + sharedAnswers(request.recording);
    lines.notes = studyNotes(request);
    return lines;
}

} // namespace quarn::program
