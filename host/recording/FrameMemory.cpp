#include "host/recording/FrameMemory.h"

#include "ground/FreeMemory.h"
#include "sdk/qncore/QnLocalize.h"

#include <algorithm>

namespace quarn {

namespace {

/// Measured with turntables of 2,000 and 8,000 frames, from the set-up to the list of frames: 1,650
/// bytes a frame where the name of a picture is short; 94 of them by the set-up alone.
constexpr std::uint64_t bytes_per_frame = 1'700;
constexpr int few_frames = 100'000; ///< not worth asking the system

} // namespace

std::uint64_t memoryOfFrames(int frames) {
    return bytes_per_frame * static_cast<std::uint64_t>(std::max(frames, 0));
}

std::optional<KM_wString> framesBeyondMemory(int frames) {
    return frames > few_frames ? framesBeyondMemory(frames, freeMemory()) : std::nullopt;
}

std::optional<KM_wString> framesBeyondMemory(int frames, std::uint64_t free_bytes) {
    const std::uint64_t needed = memoryOfFrames(frames);
    if (needed <= free_bytes)
        return std::nullopt;
    return KM_wString::FormatToString(
        QnLocalizeString(L"%d frames would take about %s of memory, and %s are free; choose fewer "
                         L"frames",
                         42536),
        frames, KM_wString::FromUtf8(gigabyteText(needed)).Array(),
        KM_wString::FromUtf8(gigabyteText(free_bytes)).Array());
}

} // namespace quarn
