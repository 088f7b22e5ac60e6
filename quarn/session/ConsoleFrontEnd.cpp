#include "quarn/session/ConsoleFrontEnd.h"

#include "quarn/session/Interruption.h"
#include "quarn/terminal/ShownText.h"
#include "quarn/words/Words.h"

#include <cmath>
#include <thread>
#include <utility>

namespace quarn::program {

namespace {

constexpr std::chrono::milliseconds PROGRESS_STEP{50};
/// What the host begins a line with that shows a command of a script.
constexpr std::string_view SHOWN_COMMAND = "Command: ";

/// "reading house.glb"
std::string stepText(ModelStep step, const std::filesystem::path& file) {
    const char* const verb = step == ModelStep::read   ? "reading "
                             : step == ModelStep::made ? "making the meshes of "
                                                       : "building ";
    return verb + file.filename().native();
}

std::string percentText(double share) {
    return std::to_string(std::lround(100.0 * share)) + " %";
}

std::string trimmed(const std::string& line) {
    constexpr const char* BLANKS = " \t\r\n";
    const std::size_t first = line.find_first_not_of(BLANKS);
    if (first == std::string::npos)
        return {};
    return line.substr(first, line.find_last_not_of(BLANKS) - first + 1);
}

} // namespace

ConsoleFrontEnd::ConsoleFrontEnd(Prints prints) : m_prints(prints), m_progress(stderr) {}

void ConsoleFrontEnd::beginRecording(int frames) {
    m_has_begun = false;
    m_frames_written = 0;
    m_frames_expected = frames;
    m_pace = {};
    m_next_progress = {};
    forgetLastWords();
}

std::string ConsoleFrontEnd::lastWords() const {
    const std::string open_line = trimmed(m_open_line);
    return open_line.empty() ? m_last_line : open_line;
}

std::string ConsoleFrontEnd::closingWords() const {
    const std::string open_line = trimmed(m_open_line);
    const std::string& before = open_line.empty() ? m_line_before : m_last_line;
    return before.empty() ? lastWords() : before + " " + lastWords();
}

void ConsoleFrontEnd::forgetLastWords() {
    m_line_before.clear();
    m_last_line.clear();
    m_open_line.clear();
}

void ConsoleFrontEnd::rememberWords(std::string_view text) {
    for (const char c : text) {
        if (c != '\n') {
            m_open_line += c;
            continue;
        }
        // A command that is shown while a recording runs it says nothing about how it went.
        std::string line = trimmed(m_open_line);
        if (!line.empty() && !line.starts_with(SHOWN_COMMAND))
            m_line_before = std::exchange(m_last_line, std::move(line));
        m_open_line.clear();
    }
}

std::string ConsoleFrontEnd::takeKeptWords() {
    m_keeps_words = false;
    return std::exchange(m_kept_words, {});
}

void ConsoleFrontEnd::print(std::wstring_view text) {
    const std::string bytes = utf8Text(text);
    rememberWords(bytes);
    if (m_keeps_words)
        m_kept_words += bytes;
    if (m_keeps_words || m_prints == Prints::hidden || bytes.empty())
        return;
    m_progress.clear();
    const std::string shown = shownText(bytes);
    std::fwrite(shown.data(), 1, shown.size(), stdout);
    m_is_inside_line = !bytes.ends_with('\n');
}

/// Where it is not printed it goes to the standard error stream; why something fails it does not
/// say.
void ConsoleFrontEnd::warn(std::wstring_view text) {
    if (m_prints == Prints::shown && !m_keeps_words)
        return FrontEnd::warn(text);
    m_progress.clear();
    std::fflush(stdout);
    std::fprintf(stderr, "quarn: %s\n", shownText(utf8Text(text)).c_str());
}

void ConsoleFrontEnd::endLine() {
    m_progress.clear();
    if (m_is_inside_line)
        std::fputc('\n', stdout);
    m_is_inside_line = false;
    std::fflush(stdout);
}

Answer ConsoleFrontEnd::ask(const Question&) {
    return {};
}

int ConsoleFrontEnd::showMessage(std::wstring_view text, std::wstring_view title, unsigned) {
    m_progress.clear();
    std::fflush(stdout);
    std::fprintf(stderr, "%s: %s\n", shownText(utf8Text(title)).c_str(),
                 shownText(trimmed(utf8Text(text))).c_str());
    return 1;
}

std::optional<std::filesystem::path>
ConsoleFrontEnd::chooseFolder(std::wstring_view, std::wstring_view, const std::filesystem::path&) {
    return std::nullopt;
}

void ConsoleFrontEnd::pumpEvents(unsigned milliseconds) {
    std::this_thread::sleep_for(std::chrono::milliseconds(milliseconds));
}

bool ConsoleFrontEnd::isKeyDown(int) {
    return false;
}

bool ConsoleFrontEnd::isInterrupted() const {
    return isInterruptionRequested();
}

HWND ConsoleFrontEnd::mainWindow() {
    return nullptr;
}

/// Frames that are there already are no work.
void ConsoleFrontEnd::recordingBegun(const RecordingStart& start) {
    m_has_begun = true;
    m_frames_expected = start.wanted - start.kept;
    m_pace = {};
}

void ConsoleFrontEnd::frameWritten(const std::filesystem::path&, int written, int total) {
    const auto now = FramePace::Clock::now();
    m_frames_written = written;
    forgetLastWords();
    const int expected = m_frames_expected > 0 ? m_frames_expected : total;
    m_pace.noteFrame(written, expected, now);
    if (m_progress.isOnTerminal() && (isProgressDue() || written == expected))
        m_progress.show(m_pace.text());
}

/// What a person sees of everything that is printed says what became of a recording too; it is not
/// the host's words.
void ConsoleFrontEnd::recordingEnded(const RecordingReport& report) {
    m_recordings.push_back({report, lastWords()});
    if (m_prints == Prints::hidden)
        return;
    endLine();
    const bool is_stopped = isInterruptionRequested() && !report.isComplete();
    const std::string shown =
        shownText(is_stopped ? interruptedText(report) : endText(m_recordings.back())) + "\n";
    std::fwrite(shown.data(), 1, shown.size(), stdout);
}

void ConsoleFrontEnd::sharedFileProgress(const std::filesystem::path& file, double share) {
    if (isProgressDue())
        m_progress.show("making " + file.filename().native() + ", " + percentText(share));
}

void ConsoleFrontEnd::sharedFileEnded(const SharedFileReport& report) {
    m_shared_files.push_back(report);
    m_progress.clear();
    if (m_prints == Prints::shown)
        FrontEnd::sharedFileEnded(report);
}

std::string ConsoleFrontEnd::lastSharedText() const {
    return m_shared_files.empty() ? "" : m_shared_files.back().text.ToUtf8();
}

bool ConsoleFrontEnd::isProgressDue() {
    const auto now = FramePace::Clock::now();
    if (now < m_next_progress)
        return false;
    m_next_progress = now + PROGRESS_STEP;
    return true;
}

/// The line is taken away at the end, but for the pace of a recording.
void ConsoleFrontEnd::pictureRendered(double share) {
    const std::string pace = m_frames_written > 0 ? m_pace.text() + ", " : "";
    if (share >= 1.0 && pace.empty())
        m_progress.clear();
    else if (share < 1.0 && isProgressDue())
        m_progress.show(pace + "rendering " + percentText(share));
}

/// The line is taken away at the end.
void ConsoleFrontEnd::modelRead(const std::filesystem::path& file, ModelStep step, double share) {
    if (step == ModelStep::built && share >= 1.0)
        m_progress.clear();
    else if (isProgressDue())
        m_progress.show(stepText(step, file) + (share > 0.0 ? ", " + percentText(share) : ""));
}

} // namespace quarn::program
