#include "host/recording/FrameRanges.h"

#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnLocalize.h"

#include <charconv>
#include <optional>

namespace quarn {

namespace {

/// More than any recording has.
constexpr int MOST_FRAMES = 10'000'000;

struct SteppedRange {
    int first;
    int last;
    int step;
};

Error sentence(const wchar_t* text, std::string_view part) {
    return {
        KM_wString::FormatToString(text, KM_wString::FromUtf8(std::string(part)).Array()).ToUtf8()};
}

std::optional<int> numberOf(std::string_view digits) {
    int number = 0;
    const char* const end = digits.data() + digits.size();
    const auto read = std::from_chars(digits.data(), end, number);
    const bool is_number = !digits.empty() && read.ec == std::errc() && read.ptr == end;
    return is_number && number >= 0 && number < MOST_FRAMES ? std::optional(number) : std::nullopt;
}

/// What stands before a mark, and what behind it; nothing behind where there is none.
std::pair<std::string_view, std::optional<std::string_view>> split(std::string_view text,
                                                                   char mark) {
    const std::size_t at = text.find(mark);
    if (at == text.npos)
        return {text, std::nullopt};
    return {text.substr(0, at), text.substr(at + 1)};
}

Result<SteppedRange> rangeOf(std::string_view part) {
    const auto [range, step_text] = split(part, ':');
    const auto [first_text, last_text] = split(range, '-');
    const auto first = numberOf(first_text);
    if (first && !last_text)
        return sentence(QnLocalizeString(L"\"%s\" is a bare number. Frames are chosen by ranges "
                                         L"from 0 on such as 0-9 or 0-99:10; one frame is 12-12.",
                                         42850),
                        part);
    const auto last = last_text ? numberOf(*last_text) : std::nullopt;
    const auto step = step_text ? numberOf(*step_text) : std::optional(1);
    if (!first || !last || !step || *step == 0 || *last < *first)
        return sentence(QnLocalizeString(L"\"%s\" is no range of frames. Frames are chosen by "
                                         L"ranges from 0 on such as 0-9, 20-30:2 or 12-12.",
                                         42851),
                        part);
    return SteppedRange{*first, *last, *step};
}

} // namespace

Result<FrameSet> parseFrameRanges(std::string_view text) {
    FrameSet frames;
    if (text == "none")
        return frames;
    for (std::optional<std::string_view> rest = text; rest;) {
        const auto [part, behind] = split(*rest, ',');
        const auto range = rangeOf(part);
        if (!range)
            return range.error();
        const auto [first, last, step] = range.value();
        if (step == 1)
            frames.add(FrameSet::Range{first, last});
        else
            for (int frame = first; frame <= last; frame += step)
                frames.add(frame);
        rest = behind;
    }
    return frames;
}

} // namespace quarn
