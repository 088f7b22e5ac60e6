#include "host/app/FrameNoter.h"

#include "ground/Checksum.h"
#include "host/app/StudyMoments.h"
#include "host/recording/RunningRecording.h"

namespace quarn {

void FrameNoter::frameRecorded(const RecordedFrame& frame) {
    ManifestFrame noted;
    noted.number = frame.number;
    noted.file = frame.file.filename().native();
    // What is read back is what stands on the disk; just written, it comes from memory.
    if (const auto sum = checksumOfFile(frame.file)) {
        noted.bytes = sum.value().bytes;
        noted.xxh64 = sum.value().xxh64;
    }
    noted.camera = frameCameraOf(frame.camera);
    noted.sun = sunOfFrame(m_record, frame.number, m_zone);
    m_recording.note(std::move(noted));
}

} // namespace quarn
