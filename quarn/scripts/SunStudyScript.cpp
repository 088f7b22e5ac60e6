#include "quarn/scripts/SunStudyScript.h"

#include "quarn/words/Words.h"

namespace quarn::program {

namespace {

using namespace std::chrono;

std::string numbers(std::initializer_list<int> values) {
    std::string text;
    for (const int value : values)
        text += std::to_string(value) + " ";
    return text;
}

std::string site(const StudyCourse& course) {
    return numberText(course.site.latitude_deg) + " " + numberText(studyLongitude(course)) + " " +
           numberText(course.site.north_deg) + " ";
}

std::string date(local_seconds moment) {
    const year_month_day day{floor<days>(moment)};
    return numbers({static_cast<int>(unsigned(day.day())), static_cast<int>(unsigned(day.month())),
                    int(day.year())});
}

std::string time(local_seconds moment) {
    const hh_mm_ss clock{moment - floor<days>(moment)};
    return numbers(
        {static_cast<int>(clock.hours().count()), static_cast<int>(clock.minutes().count())});
}

std::string oneDay(const StudyCourse& course, const StudySpan& span) {
    return "_-SetOneDaySunAnimation " + site(course) + date(span.first) + time(span.first) +
           time(span.last);
}

std::string seasonal(const StudyCourse& course, const StudySpan& span) {
    return "_-SetSeasonalSunAnimation " + site(course) + date(span.first) + date(span.last) +
           time(span.first);
}

} // namespace

AnimationLines sunStudyLines(const SunStudyRequest& request) {
    const StudyCourse& course = request.course;
    const bool is_one_day = course.kind == StudyCourse::Kind::one_day;
    AnimationLines lines;
    lines.preparing = linesFor(request.view, isDocument(request.recording.model));
    const std::vector<StudySpan> spans = studySpans(course);
    for (const StudySpan& span : spans) {
        const bool is_first = lines.setting_up.empty();
        lines.setting_up.push_back((is_one_day ? oneDay(course, span) : seasonal(course, span)) +
                                   numbers({course.step}) + sharedAnswers(request.recording));
        if (spans.size() > 1)
            lines.setting_up.push_back(is_first ? "_-JoinSunStudy _Keep"
                                                : "_-JoinSunStudy _Append");
    }
    lines.setting_up.push_back("_-SunStudyPlace \"" + placeName(course.site) + "\" \"" +
                               course.site.zone.name() + "\"");
    lines.notes = studyNotes(course);
    return lines;
}

} // namespace quarn::program
