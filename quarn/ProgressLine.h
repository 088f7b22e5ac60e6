#pragma once

#include <chrono>
#include <cstdio>
#include <string>
#include <string_view>

namespace quarn::program {

/// One line of a terminal that is written over and over. Anything but a terminal is left alone.
class ProgressLine {
public:
    explicit ProgressLine(std::FILE* stream);
    ~ProgressLine() { clear(); }
    ProgressLine(const ProgressLine&) = delete;
    ProgressLine& operator=(const ProgressLine&) = delete;

    /// Whether anything is shown at all.
    bool isOnTerminal() const { return m_is_terminal; }
    /// Shows the text in place of the last one.
    void show(std::string_view text);
    /// Takes the line away, so that other text can be printed.
    void clear();

private:
    std::FILE* m_stream;
    bool m_is_terminal;
    bool m_is_shown = false;
};

/// Tells how far a recording is: "frame 12 of 120, 34.5 frames/s, 3 s left".
class RecordingPace {
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
