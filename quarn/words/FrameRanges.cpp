#include "quarn/words/FrameRanges.h"

#include <algorithm>
#include <charconv>
#include <iterator>
#include <optional>

namespace quarn::program {

namespace {

constexpr std::size_t MOST_LISTED_RUNS = 8;

/// A piece of the text that is a range, or what is wrong with it.
struct Piece {
    FrameRange range;
    std::string refusal;
};

bool isDigits(std::string_view text) {
    return !text.empty() && std::ranges::all_of(text, [](char c) { return c >= '0' && c <= '9'; });
}

/// @return nothing for what is larger than a number of a frame can be
std::optional<int> numberOf(std::string_view digits) {
    int number = 0;
    const auto [end, error] = std::from_chars(digits.data(), digits.data() + digits.size(), number);
    return error == std::errc() ? std::optional(number) : std::nullopt;
}

Piece refused(const std::string& refusal) {
    return {{}, refusal};
}

Piece noRange(const std::string& option, std::string_view piece) {
    return refused(option + " takes ranges such as 0-9,20-30:2 without blanks, not \"" +
                   std::string(piece) + "\".");
}

Piece bareNumber(const std::string& option, std::string_view number) {
    const std::string frame(number);
    return refused(option + " takes ranges such as 0-9,20-30:2; one frame is " + frame + "-" +
                   frame + ". A number alone says how many frames, where an animation is made.");
}

Piece readPiece(const std::string& option, std::string_view piece) {
    if (isDigits(piece))
        return bareNumber(option, piece);
    const std::size_t hyphen = piece.find('-');
    if (hyphen == std::string_view::npos)
        return noRange(option, piece);
    const std::size_t colon = piece.find(':', hyphen);
    const bool has_step = colon != std::string_view::npos;
    const std::string_view words[] = {piece.substr(0, hyphen),
                                      piece.substr(hyphen + 1, colon - hyphen - 1),
                                      has_step ? piece.substr(colon + 1) : "1"};
    int numbers[3] = {};
    for (int i = 0; i < 3; ++i) {
        if (!isDigits(words[i]))
            return noRange(option, piece);
        const std::optional<int> number = numberOf(words[i]);
        if (!number)
            return refused(option + " " + std::string(piece) + ": " + std::string(words[i]) +
                           " is too large a number.");
        numbers[i] = *number;
    }
    const FrameRange range{numbers[0], numbers[1], numbers[2]};
    if (range.step == 0)
        return refused(option + " " + std::string(piece) + ": a step is at least 1, not 0.");
    if (range.first > range.last)
        return refused(option + " " + std::string(piece) + ": " + std::to_string(range.first) +
                       " is behind " + std::to_string(range.last) +
                       "; a range begins with its lower frame.");
    return {range, {}};
}

/// "7-9", or "7" alone.
std::string runText(int first, int last) {
    return std::to_string(first) + (last > first ? "-" + std::to_string(last) : "");
}

std::vector<std::string> runTexts(const std::vector<int>& frames) {
    std::vector<std::string> runs;
    for (std::size_t i = 0; i < frames.size();) {
        std::size_t end = i + 1;
        while (end < frames.size() && frames[end] == frames[end - 1] + 1)
            ++end;
        runs.push_back(runText(frames[i], frames[end - 1]));
        i = end;
    }
    return runs;
}

} // namespace

bool FrameRanges::hold(int frame) const {
    return areAll() || std::ranges::any_of(m_ranges, [frame](const FrameRange& range) {
               return frame >= range.first && frame <= range.last &&
                      (frame - range.first) % range.step == 0;
           });
}

std::vector<int> FrameRanges::among(const std::vector<int>& frames) const {
    std::vector<int> wanted;
    std::ranges::copy_if(frames, std::back_inserter(wanted),
                         [this](int frame) { return hold(frame); });
    return wanted;
}

std::string FrameRanges::text() const {
    std::string text;
    for (const FrameRange& range : m_ranges) {
        text += (text.empty() ? "" : ",") + std::to_string(range.first) + "-" +
                std::to_string(range.last);
        if (range.step > 1)
            text += ":" + std::to_string(range.step);
    }
    return text;
}

FrameRangesReading readFrameRanges(const std::string& option, std::string_view text) {
    std::vector<FrameRange> ranges;
    for (;;) {
        const std::size_t comma = text.find(',');
        const Piece piece = readPiece(option, text.substr(0, comma));
        if (!piece.refusal.empty())
            return {{}, piece.refusal};
        ranges.push_back(piece.range);
        if (comma == std::string_view::npos)
            return {FrameRanges(std::move(ranges)), {}};
        text.remove_prefix(comma + 1);
    }
}

std::string frameListText(const std::vector<int>& frames) {
    const std::vector<std::string> runs = runTexts(frames);
    std::string text;
    for (std::size_t i = 0; i < runs.size(); ++i) {
        if (i == MOST_LISTED_RUNS)
            return text + ", ...";
        const bool is_last = i + 1 == runs.size();
        text += (i == 0 ? "" : is_last ? " and " : ", ") + runs[i];
    }
    return text;
}

} // namespace quarn::program
