#include "host/share/ShareCommands.h"

namespace quarn {

namespace {

/// One line here, one function in the folder of its subject.
constexpr HostCommandEntry SHARE_COMMANDS[] = {
    {L"ExportCamera", "1B7F6C8E-5E0A-4C1B-9E55-0C6C2B9B3F11",
     L"Writes the camera of each frame of the animation to a file for other programs", 41080,
     runExportCamera},
    {L"Film", "8C0D7A3B-94F2-4B4E-8B1A-6B7E2D4C5F12", L"Makes a film of recorded frames", 41081,
     runFilm},
    {L"ViewerPage", "D2A94E57-3C68-4F0D-A7B9-1F5E8C6B7D13",
     L"Writes a page that shows recorded frames to others", 41082, runViewerPage},
};

} // namespace

std::vector<std::unique_ptr<CQuarnCommand>> makeShareCommands() {
    return makeCommands(SHARE_COMMANDS);
}

} // namespace quarn
