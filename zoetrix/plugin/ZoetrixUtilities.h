#pragma once

#include "kelmar/KM_3dPointArray.h"
#include "kelmar/KM_AnimationProperties.h"
#include "kelmar/KM_Curve.h"
#include "kelmar/KM_wString.h"

class CQuarnDoc;
class CQuarnView;

/// What every part of the plug-in may use. Each operation is defined in the folder of its subject.
class CZoetrixUtilities {
public:
    CZoetrixUtilities() = delete;

    /// Gives the plug-in's own record its starting values: the capture method is the local name of
    /// the wireframe mode, the sequence name the local "Animation", and the folder a folder of that
    /// name in the user's documents folder; it stays empty when there is no such documents folder.
    /// Nothing else changes.
    static void InitializeAnimationProperties(KM_3dmAnimationProperties& props);

    /// Computes the frame points of a path or a flythrough anew from the curves in the document, so
    /// that a curve that was edited after the set-up is followed. The lists may come out shorter
    /// than the frame count where a curve cannot be evaluated.
    ///
    /// @return false, with the record unchanged, when the curve of a flythrough yields no points;
    ///         true otherwise, also where there was nothing to do: a deleted curve, or another kind
    ///         of animation
    static bool ResetAnimation(KM_3dmAnimationProperties& props);

    /// Divides a curve into one point per frame, at equal steps of the curve's parameter.
    ///
    /// An open curve is divided from end to end. A closed one gives its seam once, as the last
    /// point. For a flythrough the curve is divided into one step more: the camera gets all points
    /// but the last, the target all but the first, so that it runs one step ahead.
    ///
    /// @param curve       may be null
    /// @param count       frames wanted
    /// @param points      emptied, then filled; untouched when the curve is null. Parameters at
    ///                    which the curve cannot be evaluated are left out
    /// @param look_ahead  camera and target ride the same curve
    /// @param is_camera   the camera's points (not the target's); only looked at with `look_ahead`
    /// @return true when there is at least one point; false also when memory does not hold them
    static bool GetPathPoints(const KM_Curve* curve, int count, KM_3dPointArray& points,
                              bool look_ahead, bool is_camera);

    /// The page that plays the recorded images in a browser, with the record's sequence name as its
    /// title. Names and labels stand in it as they are stored.
    static KM_wString GetHTMLtemplate(KM_3dmAnimationProperties& props);

    /// The first view of the document whose main viewport has this name, or null. Owned by the
    /// document; valid until the view is closed, which never happens while a command runs.
    static CQuarnView* FindQuarnViewByName(CQuarnDoc& doc, const KM_wString& name,
                                           bool ignore_case);

    /// Where the sun stands, by the host's sun. Local time is that of the whole-hour zone that the
    /// longitude lies in, counted from Greenwich toward it: longitude / 15 without its fraction.
    ///
    /// @param hour, minute      local time, from 0:00 to 24:00
    /// @param year, month, day  of the Gregorian calendar, 1800 to 2199
    /// @param northAngle        degrees from the world Y axis to north, clockwise seen from above
    /// @param latitude          degrees, north positive, -90 to 90
    /// @param longitude         degrees, east positive, -360 to 360
    /// @return the tip of the unit vector from the world origin toward the sun, below the XY plane
    ///         at night; the unset point for a place, date or time out of range or that does not
    ///         exist (31 April)
    static KM_3dPoint GetSunPoint(int hour, int minute, int year, int month, int day,
                                  double northAngle, double latitude, double longitude);

    // The sun by the day of the year: the formulas of the sheet "General Solar Position
    // Calculations" (NOAA Global Monitoring Division), whose series are those of J. W. Spencer,
    // Fourier series representation of the position of the sun, Search 2 (1971), p. 172. They
    // return radians, have no state and may be called from any thread. Nothing else calls them.

    /// The fraction of the year as an angle.
    ///
    /// @param day   of the year, 1 for 1 January; the year has 365 days
    /// @param hour  0 to 23 make no difference: unlike in the sheet only whole days from noon on
    ///              count, so that the sun's declination stays the same all day
    static double Gamma(int day, int hour);

    /// The sun's declination, north positive. The first cosine has the coefficient 0.39912 where
    /// the sheet has 0.399912, a difference of up to 0.0008 radians, or 0.05 degrees.
    ///
    /// @param day, hour  as for Gamma
    static double Declination(int day, int hour);

    /// The angle from 0 to pi that has this cosine, by way of the arctangent.
    /// @return not a number for a cosine below -1 or above 1
    static double Arccos(double x);

    /// The angle that the sun has turned since it stood highest; negative before. Longitude and
    /// time zone have the signs of an earlier edition of the sheet: positive to the west.
    ///
    /// @param day        of the year, as for Gamma
    /// @param hour, minute, second  what the clock shows. Seconds count in whole minutes, so those
    ///                              below 60 do not count
    /// @param longitude  degrees, west positive
    /// @param timeZone   hours that the clock is behind universal time
    static double HourAngle(int day, int hour, int minute, int second, double longitude,
                            double timeZone);

    /// The sun's angle from straight up.
    ///
    /// @param latitude  degrees, north positive; the others are as for HourAngle
    static double Zenith(int day, int hour, int minute, int second, double longitude,
                         double latitude, double timeZone);

    /// The sun's direction seen from above, counterclockwise from north: pi / 2 is west. (The sheet
    /// counts clockwise.) Before and after noon are told apart by the clock and not by the hour
    /// angle, so near noon east and west can be mistaken.
    ///
    /// @param latitude  degrees, north positive; the others are as for HourAngle
    /// @return 0 to 2 pi; not a number, or meaningless, at a pole and where the sun stands straight
    ///         up or down
    static double Azimuth(int day, int hour, int minute, int second, double longitude,
                          double latitude, double timeZone);
};
