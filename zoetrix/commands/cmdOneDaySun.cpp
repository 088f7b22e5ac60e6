#include "zoetrix/commands/cmdOneDaySun.h"

#include "sdk/qncore/QnDoc.h"
#include "sdk/qncore/QnLocalize.h"
#include "zoetrix/commands/CommandGuard.h"
#include "zoetrix/commands/SunStudySetUp.h"
#include "zoetrix/commands/cmdZoetrix.h"
#include "zoetrix/plugin/ZoetrixPlugIn.h"

namespace {

bool AskPlace(SunStudy& study) {
    return AskNumber(QnLocalizeString(L"Latitude of animation location(-90 to 90)", 40401),
                     {-90.0, 90.0}, study.latitude) &&
           AskNumber(QnLocalizeString(L"Longitude of animation location(-180 to 180)", 40402),
                     {-180.0, 180.0}, study.longitude) &&
           AskNorthAngle(study.north_angle);
}

bool AskDate(int& day, int& month, int& year) {
    return AskNumber(QnLocalizeString(L"Day of animation", 40404), {1, 31}, day) &&
           AskNumber(QnLocalizeString(L"Month of animation", 40405), {1, 12}, month) &&
           AskNumber(QnLocalizeString(L"Year of animation", 40406), {}, year);
}

/// Asks for place, date and times; the study is unchanged unless all was answered.
bool AskStudy(SunStudy& study) {
    SunStudy answers = study;
    int day = study.start.GetDay();
    int month = study.start.GetMonth();
    int year = study.start.GetYear();
    int start_hour = study.start.GetHour();
    int start_minute = study.start.GetMinute();
    int end_hour = study.end.GetHour();
    int end_minute = study.end.GetMinute();
    const bool is_answered =
        AskPlace(answers) && AskDate(day, month, year) &&
        AskNumber(QnLocalizeString(L"Start hour for animation (0-23)", 40407), {0, 23},
                  start_hour) &&
        AskNumber(QnLocalizeString(L"Start minute (0-59)", 40408), {0, 59}, start_minute) &&
        AskNumber(QnLocalizeString(L"End hour for animation (0-23)", 40409), {0, 23}, end_hour) &&
        AskNumber(QnLocalizeString(L"End minute (0-59)", 40410), {0, 59}, end_minute) &&
        AskMagnitude(QnLocalizeString(L"Minutes between frames", 40411), {0, 1440}, answers.step);
    if (!is_answered)
        return false;
    study = answers;
    study.start.SetDateTime(year, month, day, start_hour, start_minute, 0);
    study.end.SetDateTime(year, month, day, end_hour, end_minute, 0);
    return true;
}

int AskAtCommandLine(CQuarnDoc& doc, KM_3dmAnimationProperties& props, SunStudy& study) {
    study = StudyIn(props);
    study.step = props.MinutesBetweenFrames();
    if (!AskStudy(study))
        return CQuarnCommand::failure;
    return GetAnimationOptions(doc, props, true);
}

int AskInDialog(KM_3dmAnimationProperties& props, SunStudy& study) {
    KM_3dmAnimationProperties edited;
    const int asked = AskInSunDialog(QnZoetrixVexUiDay, props, edited);
    study = StudyIn(edited);
    study.step = edited.MinutesBetweenFrames();
    return asked;
}

int SetUpOneDay(CQuarnDoc& doc, bool interactive) {
    KM_3dmAnimationProperties props = ZoetrixPlugIn().AnimationProperties(doc);
    SunStudy study;
    const int asked = interactive ? AskInDialog(props, study) : AskAtCommandLine(doc, props, study);
    if (asked != CQuarnCommand::success)
        return asked;
    SetFrames(study, COleDateTimeSpan(0, 0, study.step, 0), props);
    props.SetMinutesBetweenFrames(study.step);
    // The record's last date stays: it belongs to the seasonal study that was set up before.
    props.SetEndHour(study.end.GetHour());
    props.SetEndMinutes(study.end.GetMinute());
    props.SetEndSeconds(study.end.GetSecond());
    StoreStudy(doc, study, KM_3dmAnimationProperties::one_day_sun, props);
    return CQuarnCommand::success;
}

} // namespace

CCommandOneDaySun::CCommandOneDaySun() : CQuarnCommand(false, false, nullptr, false) {}

CCommandOneDaySun::~CCommandOneDaySun() = default;

KM_UUID CCommandOneDaySun::CommandUUID() {
    // 99C50CFF-7C59-4F46-B3A9-B1FB70C3A343
    return {0x99C50CFF, 0x7C59, 0x4F46, {0xB3, 0xA9, 0xB1, 0xFB, 0x70, 0xC3, 0xA3, 0x43}};
}

const wchar_t* CCommandOneDaySun::EnglishCommandName() {
    return L"SetOneDaySunAnimation";
}

const wchar_t* CCommandOneDaySun::CommandDescription() {
    return QnLocalizeString(L"Sets up a sun study of one day", 40110);
}

CQuarnCommand::result CCommandOneDaySun::RunCommand(const CQuarnCommandContext& context) {
    return RunGuarded(
        [&context] { return SetUpOneDay(context.Document(), context.IsInteractive()); });
}
