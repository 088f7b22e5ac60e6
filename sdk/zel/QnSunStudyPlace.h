#pragma once

#include "kelmar/KM_AnimationProperties.h"
#include "kelmar/KM_Array.h"
#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnExport.h"

// What the form of a sun study offers and tells beside the fields of its record: the record reckons
// in the whole hours of the longitude, people by the clocks on their walls.

/// A place on the earth, and the clocks there.
struct QnSunStudyPlace {
    double latitude = 0.0;  ///< degrees, north positive
    double longitude = 0.0; ///< degrees, east positive, -360 to 360
    KM_wString clocks;      ///< "Europe/Berlin", "+05:30" or "solar"; empty: as the nearest city's
};

/// A day of a year that the sun names.
struct QnSunStudyDay {
    KM_wString name; ///< in the user's language
    int year = 0;
    int month = 0;
    int day = 0;
};

/// The place of a record, with the clocks that the active document keeps for it.
QNCORE_API QnSunStudyPlace QnPlaceOfSunStudy(const KM_3dmAnimationProperties& record);

/// Keeps the clocks and the city of a place in the active document; they count as long as its
/// record has these coordinates.
QNCORE_API void QnKeepPlaceOfSunStudy(const QnSunStudyPlace& place);

/// "Athens, Greece", where that city stands there; else empty.
QNCORE_API KM_wString QnCityOfSunStudy(const QnSunStudyPlace& place);

/// What the clocks there are called: "Europe/Athens"; empty where the place names unknown ones.
QNCORE_API KM_wString QnClocksOfSunStudy(const QnSunStudyPlace& place);

/// Today, and the equinoxes, the longest and the shortest day of a year there, in this order; today
/// alone outside the years that the sun is known for.
QNCORE_API KM_ClassArray<QnSunStudyDay> QnDaysOfSunStudy(const QnSunStudyPlace& place, int year);

/// Has a study of one day begin and end with the sun: writes the first and the last of the moments
/// of its date at which the sun is above the horizon there, whole steps of its minutes after
/// midnight; from nine to three o'clock where the sun does not rise.
QNCORE_API void QnOfferSunTimes(const QnSunStudyPlace& place, KM_3dmAnimationProperties& record);

/// Has a seasonal study go through the present year at noon of the clocks there, without daylight
/// saving.
QNCORE_API void QnOfferSunYear(const QnSunStudyPlace& place, KM_3dmAnimationProperties& record);

/// What a study's times are by the clocks there, a sentence in the user's language: "03:58 - 18:06
/// UTC+2 is 05:58 - 20:06 CEST by the clocks there."; empty where they are not known.
/// @param is_one_day  whether start and end are times of one day, else dates at one time
QNCORE_API KM_wString QnLocalTimesOfSunStudy(const QnSunStudyPlace& place,
                                             const KM_3dmAnimationProperties& record,
                                             bool is_one_day);
