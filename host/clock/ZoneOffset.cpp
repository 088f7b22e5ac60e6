#include "host/clock/ZoneOffset.h"

#include "sdk/zel/QnZone.h"

#include <charconv>

namespace quarn {
namespace {

using namespace std::chrono;

/// One or two digits and nothing else; -1 for another text.
int shortNumber(std::string_view text) {
    int number = -1;
    if (text.empty() || text.size() > 2 || text.front() == '-')
        return -1;
    const auto read = std::from_chars(text.data(), text.data() + text.size(), number);
    return read.ptr == text.data() + text.size() ? number : -1;
}

} // namespace

std::optional<minutes> writtenOffset(std::string_view text) {
    const bool names_utc = text.starts_with("UTC");
    if (names_utc)
        text.remove_prefix(3);
    if (names_utc && text.empty())
        return minutes(0);
    if (text.empty() || (text.front() != '+' && text.front() != '-'))
        return std::nullopt;
    const int sign = text.front() == '-' ? -1 : 1;
    text.remove_prefix(1);
    const std::size_t colon = text.find(':');
    const int whole = shortNumber(text.substr(0, colon));
    const int rest = colon == std::string_view::npos ? 0 : shortNumber(text.substr(colon + 1));
    constexpr int MINUTES_OF_DAY = 1440;
    if (whole < 0 || rest < 0 || rest > 59 || whole * 60 + rest > MINUTES_OF_DAY)
        return std::nullopt;
    return minutes(sign * (whole * 60 + rest));
}

std::string offsetText(minutes east) {
    return QnZoneText(static_cast<int>(east.count())).ToUtf8();
}

std::string letteredName(const std::string& abbreviation, seconds offset) {
    const bool has_letters = !abbreviation.starts_with('+') && !abbreviation.starts_with('-');
    return has_letters ? abbreviation : offsetText(duration_cast<minutes>(offset));
}

} // namespace quarn
