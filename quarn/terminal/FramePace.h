#pragma once

#include <chrono>
#include <string>

namespace quarn::program {

/// Tells how far a recording is: "frame 12 of 120, 34.5 frames/s, 3 s left".
class FramePace {
public:
    using Clock = std::chrono::steady_clock;

    /// Notes a picture.
    /// @param written  pictures so far, from 1
    /// @param total    pictures to come in all; 0 when that is not known
    void noteFrame(int written, int total, Clock::time_point now);

    std::string text() const;

private:
    double framesPerSecond() const;

    int m_written = 0;
    int m_total = 0;
    int m_first = 0;
    Clock::time_point m_first_time;
    Clock::time_point m_last_time;
};

/// A length of time in words: "0.25 s", "4.1 s", "3 min 20 s", "2 h 5 min".
std::string timeText(double seconds);
/// The same in whole seconds, rounded up.
std::string roughTimeText(double seconds);

} // namespace quarn::program
