// How long it takes to see how far a recording is: the journals of 10,000 frames that a hundred
// writers made, each read whole; beside reading the same files and the names in the folder alone.

#include "bench/Timing.h"
#include "host/recording/RecordingFile.h"
#include "host/recording/RecordingJournal.h"
#include "host/session/RecordingProgress.h"

#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <unistd.h>
#include <vector>

namespace {

namespace fs = std::filesystem;

constexpr int FRAMES = 10'000;
constexpr int WRITERS = 100;
constexpr double BUDGET_MS = 3000.0;

const quarn::RecordingFingerprint FINGERPRINT = {"quarn 1.0.0", "0123456789abcdef",
                                                 "fedcba9876543210", "avx2"};

class BenchFolder {
public:
    BenchFolder()
        : m_path(fs::temp_directory_path() / ("bench_journals_" + std::to_string(getpid()))) {
        fs::create_directories(m_path);
    }
    ~BenchFolder() {
        std::error_code ignored;
        fs::remove_all(m_path, ignored);
    }
    BenchFolder(const BenchFolder&) = delete;
    BenchFolder& operator=(const BenchFolder&) = delete;

    const fs::path& path() const { return m_path; }

private:
    fs::path m_path;
};

quarn::JournalFrame frame(int number) {
    char name[32];
    std::snprintf(name, sizeof name, "house%04d.jpg", number);
    const double turn = 0.001 * number;
    quarn::ManifestFrame of = {number, name, 20'000u + number, 0x9e3779b97f4a7c15u * number,
                               {},     {}};
    of.camera =
        quarn::FrameCamera{{42.861718891157096 + turn, -37.147337728658535, 22.62664966458111},
                           {-0.012399673461914062, 0.015549659729003906, -0.2972381351392226},
                           {-0.28306873504, 0.24533, 0.9271838545667873},
                           false,
                           50.0,
                           0.0,
                           0.0};
    return {of, 1.0 + turn};
}

void writeJournal(const fs::path& folder, int writer) {
    auto journal = quarn::JournalWriter::create(
        folder, {"house", {"node" + std::to_string(writer), 1000 + writer, 1}, FINGERPRINT, 0.5});
    if (!journal)
        bench::fail(journal.message());
    for (int number = writer; number < FRAMES; number += WRITERS)
        bench::require(journal.value().add(frame(number)));
    journal.value().end("");
}

void writeRecording(const fs::path& folder) {
    quarn::RecordingFile recording;
    recording.animation = "house";
    recording.is_running = true;
    recording.is_shared = true;
    recording.settings = {"turntable", FRAMES, 1280, 720, "RenderFull", "jpg"};
    recording.fingerprint = FINGERPRINT;
    bench::require(quarn::writeRecordingFile(folder / "house.recording", recording));
    for (int writer = 0; writer < WRITERS; ++writer)
        writeJournal(folder, writer);
    for (int number = 0; number < FRAMES; ++number)
        std::ofstream(folder / frame(number).frame.file);
}

std::size_t readJournalsAlone(const fs::path& folder) {
    std::size_t bytes = 0;
    for (const fs::directory_entry& entry : fs::directory_iterator(folder)) {
        if (entry.path().extension() != ".journal")
            continue;
        std::ifstream file(entry.path(), std::ios::binary);
        bytes += std::string(std::istreambuf_iterator<char>(file), {}).size();
    }
    return bytes;
}

} // namespace

int main() {
    const BenchFolder folder;
    writeRecording(folder.path());
    double progress_ms = 1e9;
    double floor_ms = 1e9;
    std::size_t bytes = 0;
    bench::repeatFor(BUDGET_MS, [&] {
        bench::keepBest(progress_ms, [&] {
            const auto result = quarn::recordingProgress(folder.path());
            if (!result.trouble.empty() || !result.progress.missing.empty())
                bench::fail("the journals do not tell of all frames. " + result.trouble);
        });
        bench::keepBest(floor_ms, [&] { bytes = readJournalsAlone(folder.path()); });
    });
    std::printf("| frames | writers | journals (MB) | ms | reading the bytes alone |\n"
                "|---|---|---|---|---|\n"
                "| %d | %d | %.1f | %.0f | %.0f |\n",
                FRAMES, WRITERS, 1e-6 * static_cast<double>(bytes), progress_ms, floor_ms);
}
