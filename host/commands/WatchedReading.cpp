#include "host/commands/WatchedReading.h"

#include "sdk/qncore/QnPlatform.h"

namespace quarn {

namespace {

constexpr std::chrono::milliseconds MOMENT{300};

ModelStep shownStep(ReadingStep step) {
    return step == ReadingStep::read ? ModelStep::read : ModelStep::made;
}

} // namespace

WatchedReading::~WatchedReading() {
    if (m_is_shown)
        m_front_end.modelRead(m_file, ModelStep::built, 1.0);
}

bool WatchedReading::goesOn(ReadingStep step, double share) {
    // Where the model is read inside this process its threads ask; the front end knows only one.
    if (std::this_thread::get_id() != m_thread)
        return true;
    return goesOn(shownStep(step), share);
}

bool WatchedReading::goesOn(ModelStep step, double share) {
    m_is_shown = m_is_shown || std::chrono::steady_clock::now() - m_begin > MOMENT;
    if (m_is_shown)
        m_front_end.modelRead(m_file, step, share);
    m_front_end.pumpEvents(0);
    m_is_given_up =
        m_is_given_up || m_front_end.isInterrupted() || m_front_end.isKeyDown(VK_ESCAPE);
    return !m_is_given_up;
}

} // namespace quarn
