#include "quarn/runs/RecorderJobs.h"

#include "quarn/runs/DocumentRecording.h"
#include "quarn/runs/JobsProgress.h"
#include "quarn/runs/OutputFolder.h"
#include "quarn/runs/RecorderProcess.h"
#include "quarn/session/Interruption.h"
#include "quarn/terminal/ShownText.h"

#include <algorithm>
#include <thread>

namespace quarn::program {

namespace {

using namespace std::chrono_literals;

constexpr std::chrono::milliseconds STEP = 50ms;

void tell(const std::string& text, std::FILE* stream) {
    std::fprintf(stream, "%s\n", shownText(text).c_str());
    std::fflush(stream);
}

/// The recorders, from their start to the end of the last one.
class Recorders {
public:
    Recorders(const DocumentRecordingRequest& request, int jobs, const CommonOptions& common)
        : m_request(request), m_jobs(jobs), m_common(common),
          m_threads(threadsOfEach(jobs, common.most_threads, coreCount())), m_progress(request) {
        m_recorders.reserve(static_cast<std::size_t>(jobs)); // none moves once it runs
    }

    /// @return why nothing is left to do; nothing where at least one recorded
    std::optional<Outcome> run() {
        tellCores();
        if (!startAll())
            return Outcome::failure("the system starts no more processes; give fewer --jobs.");
        waitForAll();
        m_progress.clear();
        if (isInterruptionRequested())
            return stopped(m_progress.stoppedText());
        if (std::ranges::all_of(m_recorders, hasFailed))
            return Outcome{*m_recorders.front().exitCode(), m_recorders.front().errors()};
        tellEnds(hasFailed);
        return std::nullopt;
    }

    int keptBefore() const { return m_progress.keptBefore(); }

private:
    static int coreCount() {
        return std::max(1, static_cast<int>(std::thread::hardware_concurrency()));
    }

    void tellCores() const {
        if (m_jobs > coreCount())
            tell(std::to_string(m_jobs) + " recorders share " + std::to_string(coreCount()) +
                     (coreCount() == 1 ? " core" : " cores") + ": fewer would be as fast.",
                 stdout);
    }

    bool startOne(bool begins_anew) {
        auto recorder =
            RecorderProcess::start(recorderArguments(m_request, m_common, m_threads, begins_anew));
        if (recorder)
            m_recorders.push_back(std::move(*recorder));
        return recorder.has_value();
    }

    /// Where all is made anew, the first one alone does away with what was there.
    bool startAll() {
        if (m_request.start == RecordingStartKind::anew && (!startOne(true) || !waitForFirst()))
            return !m_recorders.empty();
        while (m_recorders.size() < static_cast<std::size_t>(m_jobs))
            if (!startOne(false))
                return !m_recorders.empty();
        return true;
    }

    /// @return false when the first one ended, or the person stopped it, before it had begun
    bool waitForFirst() {
        while (!m_recorders.front().hasEnded() && !isInterruptionRequested()) {
            if (m_progress.hasWriter(m_recorders.front().id()))
                return true;
            std::this_thread::sleep_for(STEP);
        }
        return false;
    }

    void waitForAll() {
        bool is_told_to_stop = false;
        while (!allHaveEnded()) {
            if (isInterruptionRequested() && !is_told_to_stop) {
                is_told_to_stop = true;
                for (const RecorderProcess& recorder : m_recorders)
                    recorder.send(interruptionSignal());
            }
            m_progress.show();
            std::this_thread::sleep_for(STEP);
        }
    }

    bool allHaveEnded() {
        bool all = true;
        for (RecorderProcess& recorder : m_recorders)
            all = recorder.hasEnded() && all;
        tellEnds(hasDied);
        return all;
    }

    /// Tells once of each recorder that ended so.
    void tellEnds(bool (*isSo)(const RecorderProcess&)) {
        m_told.resize(m_recorders.size());
        for (std::size_t i = 0; i < m_recorders.size(); ++i) {
            if (m_told[i] || !isSo(m_recorders[i]))
                continue;
            m_told[i] = true;
            m_progress.clear();
            tell("quarn: " + endText(static_cast<int>(i) + 1, m_recorders[i]), stderr);
        }
    }

    std::string endText(int number, const RecorderProcess& recorder) const {
        const std::string errors = recorder.errors();
        const std::string last = errors.substr(errors.find_last_of('\n') + 1);
        return "recorder " + std::to_string(number) + " of " + std::to_string(m_jobs) +
               " (process " + std::to_string(recorder.id()) + ") " + recorder.endText() +
               "; its frames are made by others." + (last.empty() ? "" : " It said: " + last);
    }

    /// Told while the others go on.
    static bool hasDied(const RecorderProcess& recorder) { return recorder.signal() != 0; }

    /// Told once all have ended: what all of them refuse is told as one.
    static bool hasFailed(const RecorderProcess& recorder) {
        return recorder.exitCode() && *recorder.exitCode() != Outcome::done;
    }

    const DocumentRecordingRequest& m_request;
    const int m_jobs;
    const CommonOptions& m_common;
    const int m_threads;
    JobsProgress m_progress;
    std::vector<RecorderProcess> m_recorders;
    std::vector<bool> m_told;
};

} // namespace

int threadsOfEach(int jobs, int threads, int cores) {
    return std::max(1, (threads > 0 ? threads : cores) / jobs);
}

std::vector<std::string> recorderArguments(const DocumentRecordingRequest& request,
                                           const CommonOptions& common, int threads,
                                           bool begins_anew) {
    const std::string document = request.document.native();
    std::vector<std::string> arguments = {
        "record", document.starts_with('-') ? "./" + document : document,
        std::string("--recorder=") + (begins_anew ? "anew" : "same"),
        "--out=" + request.folder.native(), "--threads=" + std::to_string(threads)};
    const auto add = [&arguments](const char* option, const std::string& value) {
        if (!value.empty())
            arguments.push_back(option + value);
    };
    add("--frames=", request.part.text());
    add("--quality=", request.quality ? std::to_string(*request.quality) : "");
    add("--instructions=", common.instructions);
    add("--language=", common.language);
    add("--limit-memory=", common.most_memory > 0 ? std::to_string(common.most_memory) : "");
    if (common.overwrites)
        arguments.push_back("--overwrite");
    return arguments;
}

Outcome recordWithJobs(const DocumentRecordingRequest& request, int jobs,
                       const CommonOptions& common, std::chrono::steady_clock::time_point start) {
    if (const auto refusal = refuseFilm(request.film, request.folder, common.overwrites))
        return *refusal;
    if (const auto refusal = whyFolderCannotBeUsed(request.folder))
        return Outcome::failure(*refusal);
    Recorders recorders(request, jobs, common);
    if (const auto end = recorders.run())
        return *end;
    DocumentRecordingRequest rest = request;
    rest.start = RecordingStartKind::resume;
    return recordHere(rest, {.names_missing = true, .kept_before = recorders.keptBefore()}, common,
                      start);
}

} // namespace quarn::program
