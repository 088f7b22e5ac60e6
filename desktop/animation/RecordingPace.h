#pragma once

#include <QString>

#include <chrono>

namespace quarn::desktop {

/// Tells how far a recording is, and how long it will take: "Frame 12 of 120, about 8 s left".
class RecordingPace {
public:
    using Clock = std::chrono::steady_clock;

    /// A recording begins, of an unknown number of pictures.
    void begin(Clock::time_point now);
    /// Notes a picture.
    /// @param written  pictures so far, from 1
    /// @param total    pictures to come in all; 0 when that is not known
    void noteFrame(int written, int total, Clock::time_point now);
    /// Notes how much of the next picture is rendered, from 0 to 1.
    void noteShare(double share, Clock::time_point now);

    /// How much is done, from 0 to 1; 0 as long as the number of pictures is not known.
    double share() const;
    /// In the user's language.
    QString text() const;

private:
    double framesDone() const { return m_written + m_share; }

    Clock::time_point m_begin;
    Clock::time_point m_now;
    int m_written = 0;
    int m_total = 0;
    double m_share = 0.0;
};

} // namespace quarn::desktop
