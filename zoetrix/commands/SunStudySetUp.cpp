#include "zoetrix/commands/SunStudySetUp.h"

#include "sdk/qncore/QnCommand.h"
#include "sdk/qncore/QnGet.h"
#include "sdk/qncore/QnLocalize.h"
#include "zoetrix/commands/CameraSetUp.h"
#include "zoetrix/plugin/ZoetrixUtilities.h"

#include <cstdlib>
#include <limits>

namespace {

/// Flags of a date's text.
constexpr unsigned int no_format_flags = 0;
constexpr unsigned int text_locale = 52;

/// Asks a question whose text and default are set.
template <class Prompt> bool IsAnswered(Prompt& prompt, const AnswerLimits& limits) {
    prompt.SetLowerLimit(limits.lower, false);
    prompt.SetUpperLimit(limits.upper, false);
    prompt.GetNumber();
    return prompt.CommandResult() == CQuarnCommand::success;
}

/// A number without its sign; the least int has no counterpart and gives the greatest.
int Magnitude(int value) {
    return value == std::numeric_limits<int>::min() ? std::numeric_limits<int>::max()
                                                    : std::abs(value);
}

KM_3dPoint SunAt(const COleDateTime& time, const SunStudy& study) {
    return CZoetrixUtilities::GetSunPoint(time.GetHour(), time.GetMinute(), time.GetYear(),
                                          time.GetMonth(), time.GetDay(), study.north_angle,
                                          study.latitude, study.longitude);
}

} // namespace

SunStudy StudyIn(const KM_3dmAnimationProperties& props) {
    SunStudy study;
    study.latitude = props.Latitude();
    study.longitude = props.Longitude();
    study.north_angle = props.NorthAngle();
    study.start.SetDateTime(props.StartYear(), props.StartMonth(), props.StartDay(),
                            props.StartHour(), props.StartMinutes(), props.StartSeconds());
    study.end.SetDateTime(props.EndYear(), props.EndMonth(), props.EndDay(), props.EndHour(),
                          props.EndMinutes(), props.EndSeconds());
    return study;
}

bool AskNumber(const wchar_t* prompt, const AnswerLimits& limits, double& value) {
    CQuarnGetNumber get;
    get.SetCommandPrompt(prompt);
    get.SetDefaultNumber(value);
    if (!IsAnswered(get, limits))
        return false;
    value = get.Number();
    return true;
}

bool AskNumber(const wchar_t* prompt, const AnswerLimits& limits, int& value) {
    CQuarnGetInteger get;
    get.SetCommandPrompt(prompt);
    get.SetDefaultInteger(value);
    if (!IsAnswered(get, limits))
        return false;
    value = get.Number();
    return true;
}

bool AskMagnitude(const wchar_t* prompt, const AnswerLimits& limits, int& value) {
    if (!AskNumber(prompt, limits, value))
        return false;
    value = Magnitude(value);
    return true;
}

bool AskNorthAngle(double& north_angle) {
    return AskNumber(QnLocalizeString(L"North angle (clockwise from Y axis)", 40403),
                     {-360.0, 360.0}, north_angle);
}

int AskInSunDialog(FindDialog find, KM_3dmAnimationProperties& props,
                   KM_3dmAnimationProperties& edited) {
    CZoetrixDataUI lists;
    DisplayModeIds modes;
    FillLists(props, true, lists, modes);
    edited = props;
    if (const int asked = RunDialog(find, lists, edited); asked != CQuarnCommand::success)
        return asked;
    props.SetHtmlFilename(edited.HtmlFilename());
    TakeSelections(lists, modes, PreviewRenders::full, props);
    return CQuarnCommand::success;
}

void SetFrames(const SunStudy& study, const COleDateTimeSpan& step,
               KM_3dmAnimationProperties& props) {
    props.Dates().Empty();
    props.CameraPoints().Empty();
    props.TargetPoints().Empty();
    const bool leads_on = step > COleDateTimeSpan();
    for (COleDateTime time = study.start; time <= study.end; time += step) {
        const KM_3dPoint sun = SunAt(time, study);
        if (sun.IsValid()) {
            props.Dates().Append(time.Format(no_format_flags, text_locale));
            props.CameraPoints().Append(sun);
            props.TargetPoints().Append(KM_3dPoint::Origin);
        }
        if (!leads_on)
            return;
    }
}

void StoreStudy(CQuarnDoc& doc, const SunStudy& study, KM_3dmAnimationProperties::CaptureTypes type,
                KM_3dmAnimationProperties& props) {
    props.SetStartDay(study.start.GetDay());
    props.SetStartMonth(study.start.GetMonth());
    props.SetStartYear(study.start.GetYear());
    props.SetStartHour(study.start.GetHour());
    props.SetStartMinutes(study.start.GetMinute());
    props.SetStartSeconds(study.start.GetSecond());
    props.SetLatitude(study.latitude);
    props.SetLongitude(study.longitude);
    props.SetNorthAngle(study.north_angle);
    StoreAnimation(doc, props, type, props.CameraPoints().Count());
}
