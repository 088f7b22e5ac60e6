#include "quarn/runs/JobsProgress.h"

#include "quarn/session/RecordingText.h"

#include <algorithm>

namespace quarn::program {

namespace {

using namespace std::chrono_literals;

constexpr FramePace::Clock::duration SHORTEST_STEP = 100ms;
/// Of the time that a look takes: 10,000 frames take a while.
constexpr int LOOKS_OF_A_STEP = 10;

} // namespace

JobsProgress::JobsProgress(const DocumentRecordingRequest& request)
    : m_request(request), m_line(stderr),
      m_kept(request.start == RecordingStartKind::anew ? 0 : count().there) {}

JobsProgress::Counts JobsProgress::count() const {
    const RecordingProgressResult found = recordingProgress(m_request.folder);
    if (!found.trouble.empty())
        return {};
    int wanted = 0;
    for (int frame = 0; frame < found.progress.frames; ++frame)
        wanted += m_request.part.hold(frame);
    const auto missing = m_request.part.among(found.progress.missing).size();
    return {wanted, wanted - static_cast<int>(missing)};
}

bool JobsProgress::hasWriter(pid_t process) const {
    const RecordingProgressResult found = recordingProgress(m_request.folder);
    return std::ranges::any_of(found.progress.writers, [process](const RecordingWriter& writer) {
        return writer.pid == process && writer.is_alive;
    });
}

void JobsProgress::show() {
    const auto start = FramePace::Clock::now();
    if (!m_line.isOnTerminal() || start < m_next_look)
        return;
    const Counts counts = count();
    const auto now = FramePace::Clock::now();
    m_next_look = now + std::max(SHORTEST_STEP, LOOKS_OF_A_STEP * (now - start));
    const int written = counts.there - m_kept;
    if (written <= m_shown)
        return;
    m_shown = written;
    m_pace.noteFrame(written, counts.wanted - m_kept, now);
    m_line.show(m_pace.text());
}

std::string JobsProgress::stoppedText() const {
    const Counts counts = count();
    RecordingReport report;
    report.expected = counts.wanted;
    report.kept = m_kept;
    report.written = std::max(0, counts.there - m_kept);
    return program::stoppedText(report);
}

} // namespace quarn::program
