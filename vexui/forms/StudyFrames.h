#pragma once

#include <QDateTime>
#include <QString>

#include <cstdint>

namespace vexui {

/// From so many frames on a form warns.
inline constexpr std::int64_t many_frames = 100'000;

/// The frames of a sun study, as the command will compute them.
struct StudyFrames {
    std::int64_t count = 0;
    QDateTime last; ///< of the last frame; not set without frames
};

/// One frame at the start and one after each step that does not lead beyond the end. A step that
/// leads nowhere leaves one frame.
StudyFrames studyFrames(const QDateTime& start, const QDateTime& end, std::int64_t step_s);

/// The warning of very many frames.
QString manyFramesText(std::int64_t count);

} // namespace vexui
