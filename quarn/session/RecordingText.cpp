#include "quarn/session/RecordingText.h"

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

} // namespace

std::string frameCountText(int frames) {
    return std::to_string(frames) + (frames == 1 ? " frame" : " frames");
}

std::string incompleteText(const EndedRecording& recording) {
    const RecordingReport& report = recording.report;
    const std::string all = frameCountText(report.expected);
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
    const std::string page = report.page.native();
    return "Stopped after " + std::to_string(report.written) + " of " +
           frameCountText(report.expected) +
           (report.has_page ? "; " + page + " plays what is there."
                            : "; the page " + page + " could not be written.");
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
    return frameCountText(report.there) + (report.there == 1 ? " was" : " were") + " written to " +
           report.folder.native() +
           (report.has_page
                ? "; " + report.page.native() + " plays " + (report.there == 1 ? "it." : "them.")
                : "; the page " + report.page.native() + " could not be.") +
           (left_over.empty() ? "" : "\n" + left_over);
}

} // namespace quarn::program
