#pragma once

#include "quarn/arguments/ProgramArguments.h"
#include "quarn/scripts/CaptureMode.h"
#include "quarn/words/FirstMistake.h"
#include "quarn/words/Words.h"

#include <filesystem>
#include <string>
#include <vector>

namespace quarn::program {

/// What every recording needs, whatever moves in it: every value is checked.
struct RecordingRequest {
    std::filesystem::path model;
    std::string up_axis; ///< "Y", "Z" or, by the format, empty
    std::filesystem::path folder;
    std::string name; ///< of the animation, its pictures and its page; UTF-8
    int frames;
    PixelSize size;
    std::string capture_option; ///< as the capture prompt knows it, with its underscore
    int samples = 0;            ///< of each pixel, by the render method; 0: as the document has it
    std::string format;         ///< "jpg", "png", "bmp" or "tga"
    std::vector<std::string> hidden; ///< names of objects; UTF-8
    std::filesystem::path document;  ///< to save, a .quarn file; empty: none
};

/// Checks what was typed, but for the number of frames.
RecordingRequest checkRecording(const RecordingOptions& options, FirstMistake& mistake,
                                CaptureSubject subject = CaptureSubject::moving_camera);

/// Reads a number of frames that was typed.
int checkFrames(const std::string& frames, FirstMistake& mistake);

/// The path of the page that the recording writes.
std::filesystem::path pagePath(const RecordingRequest& request);

} // namespace quarn::program
