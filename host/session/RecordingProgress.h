#pragma once

#include "sdk/qncore/QnExport.h"

#include <filesystem>
#include <string>
#include <vector>

namespace quarn {

/// A program that records, or recorded, frames of a recording.
struct RecordingWriter {
    std::string host;
    int pid = 0;
    int frames = 0;               ///< that it has written
    double seconds = 0.0;         ///< that drawing and writing these took, together
    double loading_seconds = 0.0; ///< from its start to its first frame; 0: there was none yet
    bool is_alive = false;        ///< as far as can be told from here
    /// Why it ended before its frames were done, in a sentence; empty: it did not, or nobody knows.
    std::string trouble;
};

/// How far a recording is, as its folder tells.
struct RecordingProgress {
    std::string name;               ///< of the animation, UTF-8
    std::filesystem::path document; ///< absolute path of the document; empty: not known
    int frames = 0;                 ///< of the whole animation
    int jpeg_quality = 0;           ///< 1 to 100; 0: not known, or no JPEG pictures
    std::vector<int> missing;       ///< frames that nobody has recorded, in rising order, from 0
    std::string instructions;       ///< the instruction set that its pictures are drawn with
    std::string document_mark;      ///< fingerprint of the document, 16 hexadecimal digits
    std::string settings_mark;      ///< fingerprint of all settings that change pictures
    std::vector<RecordingWriter> writers; ///< those whose journals are there
    bool has_page = false;
    bool is_finished = false; ///< all frames are there and listed in NAME.frames.json
};

struct RecordingProgressResult {
    RecordingProgress progress;
    std::string trouble; ///< a sentence for the person where there is no recording; else empty
};

/// Looks through a folder that is recorded into, now or earlier: its NAME.recording, the journals
/// and the list of frames. Looks whether the frames' files are there, not whether they are whole.
/// @param folder  or the file NAME.recording in it, where the folder holds several recordings
QNCORE_API RecordingProgressResult recordingProgress(const std::filesystem::path& folder);

/// The same without frames and writers, which takes a moment however many there are: no frame is
/// missing then.
QNCORE_API RecordingProgressResult recordingSettings(const std::filesystem::path& folder);

} // namespace quarn
