#include "zoetrix/commands/cmdSeasonalSun.h"

#include "sdk/qncore/QnDoc.h"
#include "sdk/qncore/QnLocalize.h"
#include "zoetrix/commands/CommandGuard.h"
#include "zoetrix/commands/SunStudySetUp.h"
#include "zoetrix/commands/cmdZoetrix.h"
#include "zoetrix/plugin/ZoetrixPlugIn.h"

namespace {

constexpr double last_year = 2100.0;

bool AskPlace(SunStudy& study) {
    return AskNumber(QnLocalizeString(L"Latitude of animation location", 40412), {-90.0, 90.0},
                     study.latitude) &&
           AskNumber(QnLocalizeString(L"Longitude of animation location", 40413), {0.0, 360.0},
                     study.longitude) &&
           AskNorthAngle(study.north_angle);
}

bool AskStartDate(int& day, int& month, int& year) {
    return AskMagnitude(QnLocalizeString(L"Start day", 40414), {1, 31}, day) &&
           AskMagnitude(QnLocalizeString(L"Start month", 40415), {1, 12}, month) &&
           AskMagnitude(QnLocalizeString(L"Start year", 40416), {}, year);
}

bool AskEndDate(int start_year, int& day, int& month, int& year) {
    return AskMagnitude(QnLocalizeString(L"End day", 40417), {1, 31}, day) &&
           AskMagnitude(QnLocalizeString(L"End month", 40418), {1, 12}, month) &&
           AskMagnitude(QnLocalizeString(L"End year", 40419),
                        {static_cast<double>(start_year), last_year}, year);
}

/// Asks for place, dates and time; the study is unchanged unless all was answered.
bool AskStudy(SunStudy& study) {
    SunStudy answers = study;
    int start_day = study.start.GetDay();
    int start_month = study.start.GetMonth();
    int start_year = study.start.GetYear();
    int end_day = study.end.GetDay();
    int end_month = study.end.GetMonth();
    int end_year = study.end.GetYear();
    int hour = study.start.GetHour();
    int minute = study.start.GetMinute();
    const bool is_answered =
        AskPlace(answers) && AskStartDate(start_day, start_month, start_year) &&
        AskEndDate(start_year, end_day, end_month, end_year) &&
        AskMagnitude(QnLocalizeString(L"Hour of the day for animation (0-23)", 40420), {0, 23},
                     hour) &&
        AskMagnitude(QnLocalizeString(L"Minute of the day (0-59)", 40421), {0, 59}, minute) &&
        AskMagnitude(QnLocalizeString(L"Days between frames", 40422), {0, KM_UNSET_VALUE},
                     answers.step);
    if (!is_answered)
        return false;
    study = answers;
    study.start.SetDateTime(start_year, start_month, start_day, hour, minute, 0);
    study.end.SetDateTime(end_year, end_month, end_day, hour, minute, 0);
    return true;
}

int AskAtCommandLine(CQuarnDoc& doc, KM_3dmAnimationProperties& props, SunStudy& study) {
    study = StudyIn(props);
    study.step = props.DaysBetweenFrames();
    if (!AskStudy(study))
        return CQuarnCommand::failure;
    return GetAnimationOptions(doc, props, true);
}

int AskInDialog(KM_3dmAnimationProperties& props, SunStudy& study) {
    KM_3dmAnimationProperties edited;
    const int asked = AskInSunDialog(QnZoetrixVexUiSeason, props, edited);
    study = StudyIn(edited);
    study.step = edited.DaysBetweenFrames();
    return asked;
}

int SetUpSeason(CQuarnDoc& doc, bool interactive) {
    KM_3dmAnimationProperties props = ZoetrixPlugIn().AnimationProperties(doc);
    SunStudy study;
    const int asked = interactive ? AskInDialog(props, study) : AskAtCommandLine(doc, props, study);
    if (asked != CQuarnCommand::success)
        return asked;
    COleDateTimeSpan step;
    step.SetDateTimeSpan(study.step, 0, 0, 0);
    SetFrames(study, step, props);
    props.SetDaysBetweenFrames(study.step);
    // The record's last time of day stays: it belongs to the one-day study that was set up before.
    props.SetEndDay(study.end.GetDay());
    props.SetEndMonth(study.end.GetMonth());
    props.SetEndYear(study.end.GetYear());
    StoreStudy(doc, study, KM_3dmAnimationProperties::seasonal_sun, props);
    return CQuarnCommand::success;
}

} // namespace

CCommandSeasonalSun::CCommandSeasonalSun() : CQuarnCommand(false, false, nullptr, false) {}

CCommandSeasonalSun::~CCommandSeasonalSun() = default;

KM_UUID CCommandSeasonalSun::CommandUUID() {
    // A768A27F-B022-4296-8549-FE87042CDF17
    return {0xA768A27F, 0xB022, 0x4296, {0x85, 0x49, 0xFE, 0x87, 0x04, 0x2C, 0xDF, 0x17}};
}

const wchar_t* CCommandSeasonalSun::EnglishCommandName() {
    return L"SetSeasonalSunAnimation";
}

const wchar_t* CCommandSeasonalSun::CommandDescription() {
    return QnLocalizeString(L"Sets up a sun study of a season", 40111);
}

CQuarnCommand::result CCommandSeasonalSun::RunCommand(const CQuarnCommandContext& context) {
    return RunGuarded(
        [&context] { return SetUpSeason(context.Document(), context.IsInteractive()); });
}
