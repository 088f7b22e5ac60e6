#include "desktop/animation/RecordingPace.h"

#include "desktop/texts/Texts.h"

#include <cmath>

namespace quarn::desktop {

namespace {

/// Rounded up to what a person wants to know: "8 s", "3 min", "2 h 5 min".
QString roughTime(double seconds) {
    const auto whole = static_cast<long long>(std::ceil(seconds));
    if (whole < 60)
        return localized(L"%1 s", 45230).arg(whole);
    const long long minutes = (whole + 59) / 60;
    if (minutes < 60)
        return localized(L"%1 min", 45231).arg(minutes);
    return localized(L"%1 h %2 min", 45232).arg(minutes / 60).arg(minutes % 60);
}

} // namespace

void RecordingPace::begin(Clock::time_point now) {
    *this = {};
    m_begin = now;
    m_now = now;
}

void RecordingPace::noteFrame(int written, int total, Clock::time_point now) {
    m_written = written;
    m_total = total;
    m_share = 0.0;
    m_now = now;
}

void RecordingPace::noteShare(double share, Clock::time_point now) {
    m_share = share < 1.0 ? share : 0.0; // the whole picture counts once it is written
    m_now = now;
}

double RecordingPace::share() const {
    return m_total > 0 ? std::min(1.0, framesDone() / m_total) : 0.0;
}

QString RecordingPace::text() const {
    if (m_total <= 0)
        return localized(L"Frame %1", 45233).arg(m_written);
    const double seconds = std::chrono::duration<double>(m_now - m_begin).count();
    const double left =
        framesDone() > 0.0 ? seconds / framesDone() * (m_total - framesDone()) : 0.0;
    if (left <= 0.0)
        return localized(L"Frame %1 of %2", 45234).arg(m_written).arg(m_total);
    return localized(L"Frame %1 of %2, about %3 left", 45235)
        .arg(m_written)
        .arg(m_total)
        .arg(roughTime(left));
}

} // namespace quarn::desktop
