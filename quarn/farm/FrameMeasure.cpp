#include "quarn/farm/FrameMeasure.h"

#include "quarn/farm/ProgramRunner.h"
#include "quarn/session/HostSession.h"
#include "quarn/session/Interruption.h"

#include <cstdlib>
#include <optional>

namespace quarn::program {

namespace {

const std::string OWN_START = "quarn: ";

/// A folder that goes with all that is in it.
class PassingFolder {
public:
    PassingFolder() {
        std::error_code error;
        std::string name =
            (std::filesystem::temp_directory_path(error) / "quarn-measure-XXXXXX").native();
        if (!error && mkdtemp(name.data()))
            m_path = name;
    }
    ~PassingFolder() {
        std::error_code ignored;
        if (!m_path.empty())
            std::filesystem::remove_all(m_path, ignored);
    }
    PassingFolder(const PassingFolder&) = delete;
    PassingFolder& operator=(const PassingFolder&) = delete;

    const std::filesystem::path& path() const { return m_path; }

private:
    std::filesystem::path m_path;
};

std::vector<std::string> words(const FarmRequest& request, int frame,
                               const std::filesystem::path& folder) {
    const std::string number = std::to_string(frame);
    std::vector<std::string> words = {programFile().native(),
                                      "record",
                                      request.document.native(),
                                      "--out",
                                      folder.native(),
                                      "--frames",
                                      number + "-" + number,
                                      "--threads",
                                      std::to_string(request.cpus)};
    if (!request.instructions.empty())
        words.insert(words.end(), {"--instructions", request.instructions});
    return words;
}

/// The program's last words, without its own name.
std::string lastWords(std::string text) {
    text.resize(text.find_last_not_of('\n') + 1);
    const std::size_t start = text.rfind(OWN_START);
    return start == std::string::npos ? text : text.substr(start + OWN_START.size());
}

/// @return how the program ends where the frame cannot be drawn
std::optional<Outcome> draw(const std::vector<std::string>& words, int frame) {
    const ProgramEnd end = runProgram(words);
    if (isInterruptionRequested())
        return stopped("Stopped before anything was submitted.");
    if (end.ok())
        return std::nullopt;
    return Outcome::failure("frame " + std::to_string(frame) +
                            " cannot be recorded, so nothing was submitted: " + lastWords(end.err));
}

FrameCost costOf(const RecordingProgress& recording) {
    for (const RecordingWriter& writer : recording.writers)
        if (writer.frames > 0)
            return {writer.seconds / writer.frames, writer.loading_seconds};
    return {};
}

} // namespace

std::filesystem::path programFile() {
    std::error_code error;
    return std::filesystem::read_symlink("/proc/self/exe", error);
}

std::variant<MeasuredFrame, Outcome> measureFrame(const FarmRequest& request, int frame) {
    const PassingFolder folder;
    if (folder.path().empty())
        return Outcome::failure("cannot make a folder for temporary files to measure a frame; give "
                                "the time of one with --frame-time.");
    if (const auto trouble = draw(words(request, frame, folder.path()), frame))
        return *trouble;
    const RecordingProgressResult recorded = recordingProgress(folder.path());
    MeasuredFrame measured{costOf(recorded.progress), recorded.progress};
    if (measured.cost.frame_s <= 0.0)
        return Outcome::failure("one frame was recorded, but how long it took is not known; give "
                                "the time of one with --frame-time.");
    return measured;
}

std::optional<Outcome> beginAnew(const FarmRequest& request) {
    std::vector<std::string> all = words(request, 0, request.folder);
    all.push_back("--overwrite");
    return draw(all, 0);
}

} // namespace quarn::program
