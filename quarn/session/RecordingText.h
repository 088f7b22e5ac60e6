#pragma once

#include "host/front_end/RecordingReport.h"
#include "host/front_end/SharedFileReport.h"

#include <string>
#include <vector>

namespace quarn::program {

/// A recording that has ended.
struct EndedRecording {
    RecordingReport report;
    /// What the host told last since the last picture: why there are no more. UTF-8.
    std::string last_words;
};

/// "1 frame", "12 frames"
std::string frameCountText(int frames);

/// " (150 of them were there already)"; empty where none was.
std::string keptText(const RecordingReport& report);

/// What a recording lacks, as a sentence: how many of its pictures were written, how many are
/// there, and what its page shows then.
std::string incompleteText(const EndedRecording& recording);

/// What a recording that a person stopped has written, and whether its page plays that.
std::string interruptedText(const RecordingReport& report);

/// The same of a recording that goes on when the same command is given again.
std::string stoppedText(const RecordingReport& report);

/// "200 frames and out/site.html in 12 s"; of a part what makes the page.
std::string doneText(const RecordingReport& report, double seconds);

/// "out still holds 5 pictures of an earlier recording: house005.jpg, ..."; empty where it does
/// not.
std::string leftOverText(const RecordingReport& report);

/// What became of each file that was made of a recording, each on a line that is begun here.
std::string sharedText(const std::vector<SharedFileReport>& files);

/// What a whole recording has written: "3 frames were written to out; out/house.html plays them."
/// and what is left over there; for every other one incompleteText.
std::string endText(const EndedRecording& recording);

} // namespace quarn::program
