#include "quarn/session/RecordingText.h"

#include "quarn/terminal/FramePace.h"
#include "quarn/words/Words.h"

namespace quarn::program {

namespace {

/// " were written to out": frames or pictures of them.
std::string writtenTo(const RecordingReport& report) {
    return " were written to " + report.folder.native();
}

std::string reasonText(const std::string& reason) {
    if (reason.empty())
        return ". Is there space left?";
    return ": " + reason + (reason.ends_with('.') ? "" : ".");
}

std::string pageText(const RecordingReport& report) {
    if (!report.has_page)
        return "";
    const std::string page = " " + report.page.native();
    if (report.there == 0)
        return page + " shows nothing.";
    return report.there < report.written ? page + " lists pictures that are not there." : "";
}

/// "3 frames were written to out", "3 frames are in out (2 of them were there already)"
std::string thereText(const RecordingReport& report) {
    const bool is_one = report.there == 1;
    const std::string folder = report.folder.native();
    return frameCountText(report.there) +
           (report.kept > 0 ? (is_one ? " is in " : " are in ") + folder + keptText(report)
                            : (is_one ? " was written to " : " were written to ") + folder);
}

/// "Stopped after 7 of 100 frames"
std::string stopText(const RecordingReport& report) {
    return "Stopped after " + std::to_string(report.written + report.kept) + " of " +
           frameCountText(report.expected) + keptText(report);
}

} // namespace

std::string frameCountText(int frames) {
    return std::to_string(frames) + (frames == 1 ? " frame" : " frames");
}

std::string keptText(const RecordingReport& report) {
    if (report.kept == 0)
        return "";
    const bool is_all = report.kept >= report.expected;
    return " (" + (is_all ? "all" : std::to_string(report.kept)) + " of them were there already)";
}

std::string incompleteText(const EndedRecording& recording) {
    const RecordingReport& report = recording.report;
    const std::string all = frameCountText(report.expected);
    if (report.elsewhere > 0)
        return std::to_string(report.there) + " of " + all + " are in " + report.folder.native() +
               "; other programs are recording " + std::to_string(report.elsewhere) + " of them.";
    if (report.kept > 0)
        return "only " + std::to_string(report.there) + " of " + all + " are in " +
               report.folder.native() + keptText(report) + reasonText(recording.last_words) +
               pageText(report);
    if (report.written < report.expected)
        return "only " + std::to_string(report.written) + " of " + all + writtenTo(report) +
               (report.there < report.written
                    ? ", and " + std::to_string(report.there) + " of these are there"
                    : "") +
               reasonText(recording.last_words) + pageText(report);
    return all + writtenTo(report) + ", but only " + std::to_string(report.there) +
           " are there: the others were removed while it was recorded." + pageText(report);
}

std::string interruptedText(const RecordingReport& report) {
    if (report.is_part)
        return stopText(report) + ".";
    const std::string page = report.page.native();
    return stopText(report) + (report.has_page ? "; " + page + " plays what is there."
                                               : "; the page " + page + " could not be written.");
}

std::string stoppedText(const RecordingReport& report) {
    return stopText(report) +
           (report.has_page ? "; " + report.page.native() + " plays what is there" : "") +
           ". The same command goes on where it stopped.";
}

std::string doneText(const RecordingReport& report, double seconds) {
    const std::string frames = frameCountText(report.there);
    const std::string taken = " in " + timeText(seconds) + keptText(report);
    if (!report.is_part)
        return frames + " and " + report.page.native() + taken;
    return frames + " of " + report.page.stem().native() + " in " + report.folder.native() + taken +
           "; quarn finish " + shellWord(report.folder.native()) +
           " makes the page once all are there";
}

std::string leftOverText(const RecordingReport& report) {
    if (report.left_over == 0)
        return "";
    const bool is_one = report.left_over == 1;
    return report.folder.native() + " still holds " + std::to_string(report.left_over) +
           (is_one ? " picture" : " pictures") +
           " of an earlier recording: " + report.first_left_over.ToUtf8() + (is_one ? "" : ", ...");
}

std::string sharedText(const std::vector<SharedFileReport>& files) {
    std::string text;
    for (const SharedFileReport& file : files)
        text += "\n" + file.text.ToUtf8();
    return text;
}

std::string endText(const EndedRecording& recording) {
    const RecordingReport& report = recording.report;
    if (!report.isComplete())
        return incompleteText(recording);
    const std::string left_over = leftOverText(report);
    if (report.is_part)
        return thereText(report) + ".";
    return thereText(report) +
           (report.has_page
                ? "; " + report.page.native() + " plays " + (report.there == 1 ? "it." : "them.")
                : "; the page " + report.page.native() + " could not be.") +
           (left_over.empty() ? "" : "\n" + left_over);
}

} // namespace quarn::program
