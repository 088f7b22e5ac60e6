// Times of day as they are written.
#include "host/almanac/DayTimes.h"

#include "host/clock/WallText.h"

#include <charconv>
#include <utility>

namespace quarn {

namespace {

using namespace std::chrono;

/// Reads digits alone up to `end` and takes them off, with what stands at `end`.
std::optional<int> takeNumber(std::string_view& word, std::size_t end) {
    unsigned number = 0;
    const auto read = std::from_chars(word.data(), word.data() + end, number);
    if (end == 0 || end > 3 || read.ptr != word.data() + end)
        return std::nullopt;
    word.remove_prefix(end + 1);
    return static_cast<int>(number);
}

/// Reads "+1h30m", "-45m"; empty: nothing later.
std::optional<minutes> sinceTheSun(std::string_view word) {
    minutes later{0};
    if (word.empty())
        return later;
    const int sign = word.front() == '-' ? -1 : 1;
    if (word.size() < 3 || (word.front() != '+' && word.front() != '-'))
        return std::nullopt;
    word.remove_prefix(1);
    constexpr minutes HOUR{60};
    for (const auto& [unit, size] : {std::pair{'h', HOUR}, std::pair{'m', minutes(1)}}) {
        const std::size_t end = word.find(unit);
        if (end == std::string_view::npos)
            continue;
        const auto number = takeNumber(word, end);
        if (!number)
            return std::nullopt;
        later += sign * *number * size;
    }
    constexpr hours HALF_A_DAY{12};
    if (!word.empty() || abs(later) >= HALF_A_DAY)
        return std::nullopt;
    return later;
}

} // namespace

std::optional<minutes> timeOfDay(std::string_view word) {
    constexpr int LAST_HOUR = 23;
    constexpr int LAST_MINUTE = 59;
    const std::size_t colon = word.find(':');
    if (colon == 0 || colon > 2 || word.size() != colon + 3)
        return std::nullopt;
    const auto hour = takeNumber(word, colon);
    unsigned minute = 0;
    const char* const end = word.data() + word.size();
    if (!hour || std::from_chars(word.data(), end, minute).ptr != end)
        return std::nullopt;
    if (*hour > LAST_HOUR || minute > LAST_MINUTE)
        return std::nullopt;
    return hours(*hour) + minutes(minute);
}

std::optional<WantedTime> wantedTime(std::string_view word) {
    if (const auto time = timeOfDay(word))
        return WantedTime{WantedTime::Since::midnight, *time};
    for (const auto& [name, since] :
         {std::pair{std::string_view("sunrise"), WantedTime::Since::sunrise},
          std::pair{std::string_view("sunset"), WantedTime::Since::sunset}}) {
        if (!word.starts_with(name))
            continue;
        const auto later = sinceTheSun(word.substr(name.size()));
        return later ? std::optional(WantedTime{since, *later}) : std::nullopt;
    }
    return std::nullopt;
}

std::string wantedTimeText(const WantedTime& time) {
    if (time.since == WantedTime::Since::midnight)
        return timeText(WallTime{local_seconds(time.later), {}, {}, false});
    std::string text = time.since == WantedTime::Since::sunrise ? "sunrise" : "sunset";
    const hh_mm_ss later{time.later};
    if (time.later != minutes(0))
        text += later.is_negative() ? '-' : '+';
    if (later.hours() != hours(0))
        text += std::to_string(later.hours().count()) + "h";
    if (later.minutes() != minutes(0))
        text += std::to_string(later.minutes().count()) + "m";
    return text;
}

} // namespace quarn
