#include "host/prompt/FrameCountAnswer.h"

#include "host/app/Application.h"
#include "host/recording/FrameMemory.h"

#include <algorithm>
#include <array>

namespace quarn {

namespace {

/// SetPathAnimation, SetTurntableAnimation, SetFlythroughAnimation.
constexpr std::array<KM_UUID, 3> commands_with_frame_counts = {{
    // BBFB4E20-1E39-4047-8109-D953556A2441
    {0xBBFB4E20, 0x1E39, 0x4047, {0x81, 0x09, 0xD9, 0x53, 0x55, 0x6A, 0x24, 0x41}},
    // 24E39B43-B4C1-44AC-8479-4CB1AB388ED5
    {0x24E39B43, 0xB4C1, 0x44AC, {0x84, 0x79, 0x4C, 0xB1, 0xAB, 0x38, 0x8E, 0xD5}},
    // 66C3E01D-DE14-43D9-B796-DA7B7411E343
    {0x66C3E01D, 0xDE14, 0x43D9, {0xB7, 0x96, 0xDA, 0x7B, 0x74, 0x11, 0xE3, 0x43}},
}};

} // namespace

std::optional<KM_wString> refuseFrameCount(Application& application, int number) {
    const RunningCommand* const running = application.runner().current();
    if (!running ||
        std::ranges::find(commands_with_frame_counts, running->command->CommandUUID()) ==
            commands_with_frame_counts.end())
        return std::nullopt;
    return framesBeyondMemory(number);
}

} // namespace quarn
