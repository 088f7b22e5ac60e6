#include "sdk/qncore/QnDateTime.h"

#include "host/sun/CalendarDay.h"

#include <cwchar>
#include <tuple>

using namespace std::chrono;

namespace {

bool isTimeOfDay(int hour, int minute, int second) {
    return hour >= 0 && hour < 24 && minute >= 0 && minute < 60 && second >= 0 && second < 60;
}

auto numbersOf(const COleDateTime& time) {
    return std::tuple(time.GetYear(), time.GetMonth(), time.GetDay(), time.GetHour(),
                      time.GetMinute(), time.GetSecond());
}

/// Only for a valid one.
sys_seconds secondsOf(const COleDateTime& time) {
    const sys_days day = *quarn::calendarDay(time.GetYear(), time.GetMonth(), time.GetDay());
    return day + hours(time.GetHour()) + minutes(time.GetMinute()) + seconds(time.GetSecond());
}

/// Not valid outside the years that a date-time can have.
COleDateTime dateTimeOf(sys_seconds moment) {
    static constexpr sys_days FIRST_DAY = year(1) / January / 1;
    static constexpr sys_days LAST_DAY = year(9999) / December / 31;
    const sys_days day = floor<days>(moment);
    if (day < FIRST_DAY || day > LAST_DAY)
        return {};
    const year_month_day date(day);
    const hh_mm_ss time(moment - day);
    return {static_cast<int>(date.year()),
            static_cast<int>(static_cast<unsigned>(date.month())),
            static_cast<int>(static_cast<unsigned>(date.day())),
            static_cast<int>(time.hours().count()),
            static_cast<int>(time.minutes().count()),
            static_cast<int>(time.seconds().count())};
}

} // namespace

COleDateTimeSpan::COleDateTimeSpan(int days, int hours, int minutes, int seconds) {
    SetDateTimeSpan(days, hours, minutes, seconds);
}

void COleDateTimeSpan::SetDateTimeSpan(int days, int hours, int minutes, int seconds) {
    m_seconds = ((std::int64_t{days} * 24 + std::int64_t{hours}) * 60 + minutes) * 60 + seconds;
}

COleDateTime::COleDateTime(int year, int month, int day, int hour, int minute, int second) {
    SetDateTime(year, month, day, hour, minute, second);
}

bool COleDateTime::SetDate(int year, int month, int day) {
    return SetDateTime(year, month, day, 0, 0, 0);
}

bool COleDateTime::SetDateTime(int year, int month, int day, int hour, int minute, int second) {
    m_year = year;
    m_month = month;
    m_day = day;
    m_hour = hour;
    m_minute = minute;
    m_second = second;
    m_is_valid = quarn::calendarDay(year, month, day) && isTimeOfDay(hour, minute, second);
    return m_is_valid;
}

COleDateTime& COleDateTime::operator+=(const COleDateTimeSpan& span) {
    if (m_is_valid)
        *this = dateTimeOf(secondsOf(*this) + seconds(span.GetTotalSeconds()));
    return *this;
}

std::partial_ordering COleDateTime::operator<=>(const COleDateTime& other) const {
    if (!m_is_valid || !other.m_is_valid)
        return std::partial_ordering::unordered;
    return numbersOf(*this) <=> numbersOf(other);
}

bool COleDateTime::operator==(const COleDateTime& other) const {
    return (*this <=> other) == 0;
}

KM_wString COleDateTime::Format(unsigned int /*flags*/, unsigned int /*locale*/) const {
    if (!m_is_valid)
        return {};
    wchar_t text[sizeof "9999-12-31 23:59:59"];
    std::swprintf(text, std::size(text), L"%04d-%02d-%02d %02d:%02d:%02d", m_year, m_month, m_day,
                  m_hour, m_minute, m_second);
    return text;
}
