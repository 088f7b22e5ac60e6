#pragma once

#include "kelmar/KM_AnimationProperties.h"
#include "kelmar/KM_Point.h"
#include "sdk/qncore/QnDateTime.h"
#include "zoetrix/commands/DialogChoices.h"

class CQuarnDoc;

// What the two commands that set up sun studies have in common.

/// The place and the times of a sun study.
struct SunStudy {
    double latitude = 0.0;    ///< degrees, north positive
    double longitude = 0.0;   ///< degrees, east positive
    double north_angle = 0.0; ///< degrees clockwise from the Y axis, seen from above
    COleDateTime start;       ///< of the first frame
    COleDateTime end;         ///< no frame is later; one may be exactly then
    int step = 0;             ///< between frames, in the command's own unit; below 1: one frame
};

/// The place that a record holds, and its first and last date with the times of day as they stand
/// there. The step is for the command to read.
SunStudy StudyIn(const KM_3dmAnimationProperties& props);

// ---- At the command line

/// The least and the greatest answer; the toolkit's unset value is no limit.
struct AnswerLimits {
    double lower = KM_UNSET_VALUE;
    double upper = KM_UNSET_VALUE;
};

/// Asks for a number. Nothing is told when there is no answer.
/// @param prompt  in the user's language
/// @param value   offered as the default; receives the answer
/// @return whether there was an answer
bool AskNumber(const wchar_t* prompt, const AnswerLimits& limits, double& value);
bool AskNumber(const wchar_t* prompt, const AnswerLimits& limits, int& value);
/// As AskNumber, but the value receives the answer without its sign.
bool AskMagnitude(const wchar_t* prompt, const AnswerLimits& limits, int& value);

/// Asks for the angle of north, which both commands do alike.
bool AskNorthAngle(double& north_angle);

// ---- In the dialog

/// Asks in a dialog. The choices for the frames and the sequence name, which is taken as it is, go
/// into the record.
///
/// @param edited  receives the record as the person edited it, for the command to read place and
///                times from
/// @return success; cancel when the dialog was not confirmed; failure when there is no such dialog.
///         Unless it is success the record is as it was
int AskInSunDialog(FindDialog find, KM_3dmAnimationProperties& props,
                   KM_3dmAnimationProperties& edited);

// ---- The record

/// Computes the frames of a study into the record: a date, a sun point and a target for each. A
/// time at which the sun has no position makes no frame; one at night does.
/// @param step  between frames; one that leads nowhere, or back, leaves the first frame alone
void SetFrames(const SunStudy& study, const COleDateTimeSpan& step,
               KM_3dmAnimationProperties& props);

/// Completes a record whose frames are set, and stores it in the document. Of the study it takes
/// the place and the start; what else is written of it the commands decide.
void StoreStudy(CQuarnDoc& doc, const SunStudy& study, KM_3dmAnimationProperties::CaptureTypes type,
                KM_3dmAnimationProperties& props);
