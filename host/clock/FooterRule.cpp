#include "host/clock/FooterRule.h"

#include <array>
#include <cctype>

namespace quarn {

using namespace std::chrono;

sys_seconds FooterRule::Change::in(year of_year) const {
    sys_days day = sys_days(of_year / January / 1);
    if (counted == Day::from_zero)
        day += days(number);
    else if (counted == Day::without_leap_day)
        day += days(number - 1 + (of_year.is_leap() && number > 59 ? 1 : 0));
    else if (week == 5)
        day = sys_days(of_year / std::chrono::month(unsigned(month)) /
                       std::chrono::weekday(unsigned(weekday))[last]);
    else
        day = sys_days(of_year / std::chrono::month(unsigned(month)) /
                       std::chrono::weekday(unsigned(weekday))[unsigned(week)]);
    return day + time;
}

/// Reads a rule from its beginning to its end; whatever does not fit makes it bad.
class FooterRule::Reader {
public:
    explicit Reader(std::string_view text) : m_rest(text) {}

    std::optional<FooterRule> rule() {
        FooterRule rule;
        rule.m_standard_name = name();
        rule.m_standard = -time();
        if (!m_rest.empty()) {
            rule.m_saving_name = name();
            rule.m_saving = m_rest.starts_with(',') ? rule.m_standard + 1h : -time();
            rule.m_start = change();
            rule.m_end = change();
        }
        if (m_is_bad || !m_rest.empty())
            return std::nullopt;
        return rule;
    }

private:
    bool takes(char letter) {
        if (!m_rest.starts_with(letter))
            return false;
        m_rest.remove_prefix(1);
        return true;
    }

    std::string name() {
        const bool is_quoted = takes('<');
        std::string letters;
        while (!m_rest.empty() &&
               (is_quoted ? m_rest.front() != '>'
                          : std::isalpha(static_cast<unsigned char>(m_rest.front())) != 0)) {
            letters += m_rest.front();
            m_rest.remove_prefix(1);
        }
        m_is_bad |= letters.size() < 3 || (is_quoted && !takes('>'));
        return letters;
    }

    int number(int fewest, int most) {
        int value = 0;
        std::size_t digits = 0;
        while (digits < 3 && !m_rest.empty() && m_rest.front() >= '0' && m_rest.front() <= '9') {
            value = value * 10 + (m_rest.front() - '0');
            m_rest.remove_prefix(1);
            ++digits;
        }
        m_is_bad |= digits == 0 || value < fewest || value > most;
        return value;
    }

    seconds time() {
        const int sign = takes('-') ? -1 : 1;
        if (sign > 0)
            takes('+');
        seconds size = hours(number(0, 167));
        if (takes(':'))
            size += minutes(number(0, 59));
        if (takes(':'))
            size += seconds(number(0, 59));
        return sign * size;
    }

    Change change() {
        Change read;
        m_is_bad |= !takes(',');
        if (takes('M')) {
            read.month = number(1, 12);
            m_is_bad |= !takes('.');
            read.week = number(1, 5);
            m_is_bad |= !takes('.');
            read.weekday = number(0, 6);
        } else if (takes('J')) {
            read.counted = Change::Day::without_leap_day;
            read.number = number(1, 365);
        } else {
            read.counted = Change::Day::from_zero;
            read.number = number(0, 365);
        }
        if (takes('/'))
            read.time = time();
        return read;
    }

    std::string_view m_rest;
    bool m_is_bad = false;
};

std::optional<FooterRule> FooterRule::read(std::string_view text) {
    return Reader(text).rule();
}

ClockPeriod FooterRule::periodAt(sys_seconds utc) const {
    ClockPeriod period;
    period.offset = m_standard;
    period.abbreviation = m_standard_name;
    if (m_saving_name.empty())
        return period;
    // A change may belong to another year in UTC, and the period reaches into the years beside.
    const year middle = year_month_day(floor<days>(utc)).year();
    for (year of_year = middle - years(2); of_year <= middle + years(2); ++of_year) {
        const sys_seconds starts = m_start.in(of_year)-m_standard;
        const sys_seconds ends = m_end.in(of_year)-m_saving;
        const bool starts_last = starts > ends;
        for (const bool is_start : {!starts_last, starts_last}) {
            const sys_seconds change = is_start ? starts : ends;
            if (change > utc) {
                period.end = change;
                return period;
            }
            period.begin = change;
            period.is_daylight_saving = is_start;
            period.offset = is_start ? m_saving : m_standard;
            period.abbreviation = is_start ? m_saving_name : m_standard_name;
        }
    }
    return period;
}

} // namespace quarn
