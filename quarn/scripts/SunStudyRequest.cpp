#include "quarn/scripts/SunStudyRequest.h"

#include "quarn/scripts/StudyView.h"
#include "quarn/words/Words.h"

namespace quarn::program {

namespace {

constexpr int FIRST_YEAR = 1800; // as the host's sun takes them
constexpr int LAST_YEAR_OF_DAY = 2199;
constexpr int LAST_YEAR_OF_SEASON = 2100; // as the command of a seasonal study takes them
constexpr int MINUTES_OF_DAY = 1440;

COleDateTime checkDate(const std::string& option, const std::string& typed, int last_year,
                       FirstMistake& mistake) {
    const std::optional<COleDateTime> date = isoDate(typed);
    if (!date) {
        mistake.note(option + " must be a date such as 2026-06-21" + notBut(typed));
        return {};
    }
    if (!date->IsValid())
        mistake.note(option + " must be a day of the calendar, where there is no " + typed + ".");
    else if (date->GetYear() < FIRST_YEAR || date->GetYear() > last_year)
        mistake.note(option + " must be in the years " + std::to_string(FIRST_YEAR) + " to " +
                     std::to_string(last_year) + notBut(typed));
    return *date;
}

ClockTime checkTime(const std::string& option, const std::string& typed, FirstMistake& mistake) {
    const std::optional<ClockTime> time = clockTime(typed);
    if (!time)
        mistake.note(option + " must be a time from 00:00 to 23:59" + notBut(typed));
    return time.value_or(ClockTime{0, 0});
}

/// @param most  nothing: as many as a number holds
int checkStep(const std::string& typed, const std::string& unit, std::optional<int> most,
              FirstMistake& mistake) {
    const int step = wholeNumber(typed).value_or(0);
    if (step >= 1 && (!most || step <= *most))
        return step;
    mistake.note("--every must be a whole number of " + unit + " from 1" +
                 (most ? " to " + std::to_string(*most) : "") + notBut(typed));
    return 1;
}

/// Both ends have a frame where the steps meet them.
int countFrames(const SunStudyRequest& request, std::int64_t minutes_of_step) {
    return static_cast<int>(minutesBetween(request.start, request.end) / minutes_of_step) + 1;
}

/// What both commands take.
template <class Options>
SunStudyRequest checkCommon(const Options& options, FirstMistake& mistake) {
    SunStudyRequest request{};
    request.recording = checkRecording(options.recording, mistake, CaptureSubject::moving_sun);
    request.site = checkSite(options.site, mistake);
    request.view_lines = studyViewLines(options.view, request.recording.model, mistake);
    return request;
}

/// @param minutes_of_unit  of what a step counts
std::variant<SunStudyRequest, Outcome> result(SunStudyRequest& request, const std::string& from,
                                              const std::string& to, std::int64_t minutes_of_unit,
                                              FirstMistake& mistake) {
    if (request.end < request.start)
        mistake.note("--to " + to + " is before --from " + from + ".");
    if (mistake.text())
        return Outcome::misuse(*mistake.text());
    request.recording.frames = countFrames(request, request.step * minutes_of_unit);
    return request;
}

} // namespace

std::variant<SunStudyRequest, Outcome> checkDay(const DayOptions& options) {
    FirstMistake mistake;
    SunStudyRequest request = checkCommon(options, mistake);
    request.kind = SunStudyRequest::Kind::one_day;
    const COleDateTime date = checkDate("--date", options.date, LAST_YEAR_OF_DAY, mistake);
    request.start = atTime(date, checkTime("--from", options.from, mistake));
    request.end = atTime(date, checkTime("--to", options.to, mistake));
    request.step = checkStep(options.every, "minutes", MINUTES_OF_DAY, mistake);
    return result(request, options.from, options.to, 1, mistake);
}

std::variant<SunStudyRequest, Outcome> checkSeason(const SeasonOptions& options) {
    FirstMistake mistake;
    SunStudyRequest request = checkCommon(options, mistake);
    request.kind = SunStudyRequest::Kind::seasonal;
    const COleDateTime first = checkDate("--from", options.from, LAST_YEAR_OF_SEASON, mistake);
    const COleDateTime last = checkDate("--to", options.to, LAST_YEAR_OF_SEASON, mistake);
    const ClockTime time = checkTime("--at", options.at, mistake);
    request.start = atTime(first, time);
    request.end = atTime(last, time);
    request.step = checkStep(options.every, "days", std::nullopt, mistake);
    return result(request, options.from, options.to, MINUTES_OF_DAY, mistake);
}

} // namespace quarn::program
