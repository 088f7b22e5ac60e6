#include "host/recording/FrameNames.h"

#include <algorithm>
#include <charconv>

namespace quarn {

namespace {

constexpr std::size_t fewest_digits = 3;

bool isDigit(char c) {
    return c >= '0' && c <= '9';
}

/// Whether a number is written so: with noughts in front up to three digits, and no more of them.
bool isFrameNumber(std::string_view digits) {
    return digits.size() >= fewest_digits && std::ranges::all_of(digits, isDigit) &&
           (digits.size() == fewest_digits || digits.front() != '0');
}

} // namespace

std::string FrameNames::fileName(int frame) const {
    std::string digits = std::to_string(frame);
    if (digits.size() < fewest_digits)
        digits.insert(0, fewest_digits - digits.size(), '0');
    return animation + digits + "." + extension;
}

std::optional<int> FrameNames::frameOf(std::string_view file_name) const {
    const std::string end = "." + extension;
    if (file_name.size() < animation.size() + end.size() || !file_name.starts_with(animation) ||
        !file_name.ends_with(end))
        return std::nullopt;
    file_name.remove_prefix(animation.size());
    file_name.remove_suffix(end.size());
    int frame = 0;
    const char* const last = file_name.data() + file_name.size();
    if (!isFrameNumber(file_name) ||
        std::from_chars(file_name.data(), last, frame).ec != std::errc())
        return std::nullopt;
    return frame;
}

std::string pageName(const std::string& animation) {
    return animation + ".html";
}

std::string recordingFileName(const std::string& animation) {
    return animation + ".recording";
}

} // namespace quarn
