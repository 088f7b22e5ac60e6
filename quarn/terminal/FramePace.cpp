#include "quarn/terminal/FramePace.h"

#include "quarn/words/Words.h"

#include <cmath>

namespace quarn::program {

namespace {

/// @param steps  how many steps there are from one whole number to the next
std::string rounded(double value, double steps) {
    return numberText(std::round(value * steps) / steps);
}

std::string longTimeText(long long seconds) {
    if (seconds < 3600)
        return std::to_string(seconds / 60) + " min " + std::to_string(seconds % 60) + " s";
    return std::to_string(seconds / 3600) + " h " + std::to_string(seconds % 3600 / 60) + " min";
}

} // namespace

void FramePace::noteFrame(int written, int total, Clock::time_point now) {
    if (m_first == 0 || written <= m_written) {
        m_first = written;
        m_first_time = now;
    }
    m_written = written;
    m_total = total;
    m_last_time = now;
}

double FramePace::framesPerSecond() const {
    const double seconds = std::chrono::duration<double>(m_last_time - m_first_time).count();
    return seconds > 0.0 ? (m_written - m_first) / seconds : 0.0;
}

std::string FramePace::text() const {
    std::string text = "frame " + std::to_string(m_written);
    if (m_total > 0)
        text += " of " + std::to_string(m_total);
    const double pace = framesPerSecond();
    if (pace <= 0.0)
        return text;
    text += ", " + rounded(pace, 10.0) + " frames/s";
    if (m_total >= m_written)
        text += ", " + roughTimeText((m_total - m_written) / pace) + " left";
    return text;
}

std::string timeText(double seconds) {
    if (seconds >= 59.95)
        return roughTimeText(seconds);
    return rounded(seconds, seconds < 1.0 ? 100.0 : 10.0) + " s";
}

std::string roughTimeText(double seconds) {
    const long long whole = std::llround(std::ceil(seconds));
    return whole < 60 ? std::to_string(whole) + " s" : longTimeText(whole);
}

} // namespace quarn::program
