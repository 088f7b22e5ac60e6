#pragma once

#include <string>

namespace quarn {

/// What decides every byte of the pictures of a recording. Two recordings of one name that have the
/// same of all of this are one recording.
struct RecordingFingerprint {
    std::string program;      ///< that draws them, with its version
    std::string document;     ///< of all that is seen of the document: 16 hexadecimal digits
    std::string settings;     ///< of all settings that change pictures: 16 hexadecimal digits
    std::string instructions; ///< the instruction set that they are drawn with

    friend bool operator==(const RecordingFingerprint&, const RecordingFingerprint&) = default;
};

} // namespace quarn
