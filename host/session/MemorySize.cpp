#include "host/session/MemorySize.h"

#include <charconv>

namespace quarn {

namespace {

constexpr double MEGABYTE = 1 << 20;
constexpr double MOST_MEGABYTES = 1e9;

} // namespace

std::optional<std::uint64_t> memorySize(std::string_view word) {
    double number = 0.0;
    const char* const end = word.data() + word.size();
    const auto [unit, failure] =
        std::from_chars(word.data(), end, number, std::chars_format::fixed);
    if (failure != std::errc() || end - unit != 1)
        return std::nullopt;
    const bool is_gigabytes = *unit == 'G' || *unit == 'g';
    if (!is_gigabytes && *unit != 'M' && *unit != 'm')
        return std::nullopt;
    const double megabytes = is_gigabytes ? 1024.0 * number : number;
    if (!(megabytes >= 1.0) || megabytes > MOST_MEGABYTES)
        return std::nullopt;
    return static_cast<std::uint64_t>(megabytes * MEGABYTE);
}

} // namespace quarn
