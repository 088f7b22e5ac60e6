#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace quarn::program {

/// Frames of an animation, counted from 0.
struct FrameRange {
    int first = 0;
    int last = 0; ///< is in, where the step meets it
    int step = 1;
};

/// The frames of an animation that are wanted; without any range all of them are.
class FrameRanges {
public:
    FrameRanges() = default;
    explicit FrameRanges(std::vector<FrameRange> ranges) : m_ranges(std::move(ranges)) {}

    bool areAll() const { return m_ranges.empty(); }
    bool hold(int frame) const;
    /// Those of the frames that are wanted.
    std::vector<int> among(const std::vector<int>& frames) const;
    /// "0-9,20-30:2"; empty where all are wanted.
    std::string text() const;

private:
    std::vector<FrameRange> m_ranges;
};

/// What a text says about ranges of frames.
struct FrameRangesReading {
    FrameRanges ranges;
    std::string refusal; ///< what is wrong with the text, in a sentence; empty where nothing is
};

/// Reads "0-9,20-30:2": first and last frame, and a step other than 1.
/// @param option  that the text was given with, for the refusal
FrameRangesReading readFrameRanges(const std::string& option, std::string_view text);

/// Some frames as a person reads them: "3, 7-9 and 12", and of many only how they begin.
/// @param frames  in rising order
std::string frameListText(const std::vector<int>& frames);

} // namespace quarn::program
