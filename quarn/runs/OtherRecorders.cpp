#include "quarn/runs/OtherRecorders.h"

#include "quarn/session/Interruption.h"
#include "quarn/terminal/FramePace.h"

#include <algorithm>
#include <set>
#include <unistd.h>

namespace quarn::program {

namespace {

using namespace std::chrono_literals;
using Clock = OtherRecorders::Clock;

constexpr unsigned STEP_MS = 100;
constexpr Clock::duration FIRST_GLANCE = 100ms;
constexpr Clock::duration BETWEEN_GLANCES = 500ms;
constexpr Clock::duration SHORTEST_WAIT = 1s;
constexpr Clock::duration LONGEST_WAIT = 20s;
/// Of the time that a look takes: looking is to be a small part of waiting.
constexpr int LOOKS_OF_A_WAIT = 10;
constexpr Clock::duration LEASE_AND_SOME = 75s;
constexpr double SLOW_FRAMES = 4.0;

bool isAnotherAtWork(const RecordingWriter& writer) {
    return writer.is_alive && writer.pid != getpid();
}

} // namespace

std::string livingHostsText(const RecordingProgress& progress) {
    std::set<std::string> hosts;
    for (const RecordingWriter& writer : progress.writers)
        if (isAnotherAtWork(writer))
            hosts.insert(writer.host);
    std::string text;
    for (auto host = hosts.begin(); host != hosts.end(); ++host)
        text += (text.empty() ? "" : std::next(host) == hosts.end() ? " and " : ", ") + *host;
    return text;
}

Clock::duration patienceWith(const RecordingProgress& progress) {
    double slowest_s = 0.0;
    for (const RecordingWriter& writer : progress.writers)
        if (writer.frames > 0)
            slowest_s = std::max(slowest_s, writer.seconds / writer.frames);
    const auto slow = std::chrono::duration<double>(SLOW_FRAMES * slowest_s);
    return std::max(LEASE_AND_SOME, std::chrono::duration_cast<Clock::duration>(slow));
}

void OtherRecorders::noteMissing(const RecordingProgress& progress) {
    std::vector<int> missing = m_part.among(progress.missing);
    if (m_last_change != Clock::time_point{} && missing == m_missing)
        return;
    m_missing = std::move(missing);
    m_last_change = Clock::now();
}

bool OtherRecorders::areGivenUp(const RecordingProgress& progress) {
    const Clock::duration since = Clock::now() - m_last_change;
    if (since <= patienceWith(progress))
        return false;
    const std::string hosts = livingHostsText(progress);
    m_reason = "nothing has come" + (hosts.empty() ? "" : " from " + hosts) + " for " +
               roughTimeText(std::chrono::duration<double>(since).count());
    return true;
}

bool OtherRecorders::wait(Clock::duration look) {
    const Clock::time_point start = Clock::now();
    const Clock::time_point end =
        start + std::clamp(LOOKS_OF_A_WAIT * look, SHORTEST_WAIT, LONGEST_WAIT);
    for (Clock::time_point next_glance = start + FIRST_GLANCE; Clock::now() < end;
         m_front_end.pumpEvents(STEP_MS)) {
        if (isInterruptionRequested())
            return false;
        if (Clock::now() < next_glance)
            continue;
        next_glance = Clock::now() + BETWEEN_GLANCES;
        const RecordingProgress progress = recordingProgress(m_recording).progress;
        noteMissing(progress);
        if (m_missing.empty())
            break;
        if (areGivenUp(progress))
            return false;
        const std::string hosts = livingHostsText(progress);
        m_front_end.showStep("waiting for " + std::to_string(m_missing.size()) +
                             (m_missing.size() == 1 ? " frame" : " frames") + " that " +
                             (hosts.empty() ? "others record" : hosts + " records"));
    }
    m_front_end.clearProgress();
    return true;
}

} // namespace quarn::program
