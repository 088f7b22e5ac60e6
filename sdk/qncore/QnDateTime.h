#pragma once

#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnExport.h"

#include <compare>
#include <cstdint>

/// A length of time in whole seconds, so that adding it any number of times loses nothing.
class QNCORE_API COleDateTimeSpan {
public:
    /// No time at all.
    COleDateTimeSpan() = default;
    /// As SetDateTimeSpan.
    COleDateTimeSpan(int days, int hours, int minutes, int seconds);

    /// The sum of the four; each may be negative and of any size.
    void SetDateTimeSpan(int days, int hours, int minutes, int seconds);
    std::int64_t GetTotalSeconds() const { return m_seconds; }

    auto operator<=>(const COleDateTimeSpan&) const = default;

private:
    std::int64_t m_seconds = 0;
};

/// A date of the Gregorian calendar, of the years 1 to 9999, and a time of day in whole seconds; no
/// zone, no daylight saving, no leap seconds.
///
/// One that is made of numbers that no calendar or clock shows (31 April, 24 o'clock) is not valid:
/// it keeps the numbers, so that a person can be shown them, but has no text and no place among
/// other date-times. Every comparison with it, but for `!=`, is false.
class QNCORE_API COleDateTime {
public:
    /// Not valid; all numbers are 0.
    COleDateTime() = default;
    /// As SetDateTime.
    COleDateTime(int year, int month, int day, int hour, int minute, int second);

    /// Midnight at the beginning of a date. @return true when the date is valid
    bool SetDate(int year, int month, int day);
    /// @param month   from 1
    /// @param day     of the month, from 1
    /// @param hour    0 to 23
    /// @param minute  0 to 59
    /// @param second  0 to 59
    /// @return true when the date-time is valid
    bool SetDateTime(int year, int month, int day, int hour, int minute, int second);

    bool IsValid() const { return m_is_valid; }
    int GetYear() const { return m_year; }
    int GetMonth() const { return m_month; }
    int GetDay() const { return m_day; }
    int GetHour() const { return m_hour; }
    int GetMinute() const { return m_minute; }
    int GetSecond() const { return m_second; }

    /// Moves on by a span, or back by a negative one. One that is not valid stays as it is; one
    /// that leaves the years 1 to 9999 becomes as one made of nothing.
    COleDateTime& operator+=(const COleDateTimeSpan& span);

    /// The earlier is the lesser; unordered unless both are valid.
    std::partial_ordering operator<=>(const COleDateTime& other) const;
    bool operator==(const COleDateTime& other) const;

    /// The text that everybody reads alike and that sorts by time: `2026-06-21 14:30:00`.
    ///
    /// @param flags   of no effect
    /// @param locale  of no effect: texts in records and pages do not depend on the machine
    /// @return the text; empty when the date-time is not valid
    KM_wString Format(unsigned int flags = 0, unsigned int locale = 0) const;

private:
    int m_year = 0;
    int m_month = 0;
    int m_day = 0;
    int m_hour = 0;
    int m_minute = 0;
    int m_second = 0;
    bool m_is_valid = false;
};
