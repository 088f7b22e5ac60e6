// What a film costs that is made while a turntable is recorded: the same recording without one and
// with one of each kind in turn, in whole from its command to the last file, so that the ratio
// holds on any machine.

#include "bench/Hills.h"
#include "host/front_end/ScriptedFrontEnd.h"
#include "host/session/Session.h"
#include "sdk/qncore/qncore.h"

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>
#include <sys/resource.h>
#include <unistd.h>
#include <vector>

namespace {

namespace fs = std::filesystem;

constexpr int CELLS = 707; // 2 * 707 * 707 = 999,698 triangles
constexpr int FRAMES = 120;
constexpr int ROUNDS = 3;

[[noreturn]] void fail(const std::string& why) {
    std::fprintf(stderr, "%s\n", why.c_str());
    std::exit(1);
}

std::wstring wide(const std::string& ascii) {
    return {ascii.begin(), ascii.end()};
}

double seconds(const timeval& time) {
    return static_cast<double>(time.tv_sec) + 1e-6 * static_cast<double>(time.tv_usec);
}

double processorSeconds() {
    rusage usage{};
    getrusage(RUSAGE_SELF, &usage);
    return seconds(usage.ru_utime) + seconds(usage.ru_stime);
}

/// Reads quickly, and is written with a few lines.
void writePly(const fs::path& file) {
    const auto mesh = bench::makeHills(CELLS);
    std::ofstream ply(file, std::ios::binary);
    constexpr int corners = (CELLS + 1) * (CELLS + 1);
    ply << "ply\nformat binary_little_endian 1.0\nelement vertex " << corners
        << "\nproperty float x\nproperty float y\nproperty float z\nelement face "
        << mesh->m_F.size() << "\nproperty list uchar int vertex_indices\nend_header\n";
    for (int i = 0; i < corners; ++i) {
        const auto& corner = mesh->m_V[static_cast<std::size_t>(i)];
        const float place[] = {static_cast<float>(corner.x), static_cast<float>(corner.y),
                               static_cast<float>(corner.z)};
        ply.write(reinterpret_cast<const char*>(place), sizeof place);
    }
    for (const auto& face : mesh->m_F) {
        ply.put(3);
        ply.write(reinterpret_cast<const char*>(face.vi), 12);
    }
}

/// What recordings of one kind took.
struct Taken {
    std::vector<double> wall_s;
    std::vector<double> processor_s;
    std::uintmax_t bytes = 0;
};

double median(std::vector<double> values) {
    std::ranges::sort(values);
    return values[values.size() / 2];
}

class FilmBench {
public:
    FilmBench()
        : m_folder(fs::temp_directory_path() / ("bench_film_" + std::to_string(getpid()))),
          m_session(m_front_end, options()) {
        fs::create_directories(m_folder / "frames");
        if (const auto load = m_session.loadPlugIn(ZOETRIX_PLUGIN_PATH); !load.ok())
            fail(load.message);
        writePly(m_folder / "hills.ply");
        run("_-Import \"" + (m_folder / "hills.ply").string() + "\"");
        run("_-ViewportSize 1280 720");
        run("_-Camera _Location 0,-62,34 _Target 0,-8,0 _Enter");
        run("_-SetTurntableAnimation " + std::to_string(FRAMES) +
            " _Clockwise _jpg _RenderedViewport _Enter _Enter");
    }
    ~FilmBench() {
        std::error_code ignored;
        fs::remove_all(m_folder, ignored);
    }
    FilmBench(const FilmBench&) = delete;
    FilmBench& operator=(const FilmBench&) = delete;

    /// @param kind  "mp4", or empty for none
    void record(const std::string& kind, Taken& taken) {
        const fs::path film = m_folder / ("film." + kind);
        fs::remove(film);
        const auto start = std::chrono::steady_clock::now();
        const double processor_start = processorSeconds();
        if (!kind.empty())
            run("_-Film _NextRecording \"" + film.string() + "\"");
        run("_-RecordAnimation _TargetFolder \"" + (m_folder / "frames").string() + "\" _Enter");
        const std::chrono::duration<double> wall = std::chrono::steady_clock::now() - start;
        taken.wall_s.push_back(wall.count());
        taken.processor_s.push_back(processorSeconds() - processor_start);
        if (kind.empty())
            return;
        if (!fs::exists(film))
            fail("no film was made: " + KM_wString(m_front_end.printed().c_str()).ToUtf8());
        taken.bytes = fs::file_size(film);
    }

private:
    static quarn::SessionOptions options() {
        quarn::SessionOptions options;
        options.language = "en";
        return options;
    }

    void run(const std::string& line) {
        if (m_session.runCommand(wide(line)) != CQuarnCommand::success)
            fail("'" + line + "' failed: " + KM_wString(m_front_end.printed().c_str()).ToUtf8());
    }

    fs::path m_folder;
    quarn::ScriptedFrontEnd m_front_end;
    quarn::Session m_session;
};

} // namespace

/// usage: bench_film [KIND...]
int main(int argument_count, char** arguments) {
    std::vector<std::string> kinds(arguments + 1, arguments + argument_count);
    if (kinds.empty())
        kinds = {"mp4", "gif", "webm"};
    kinds.insert(kinds.begin(), "");
    std::vector<Taken> taken(kinds.size());
    FilmBench bench;
    Taken warm_up;
    bench.record("", warm_up);
    for (int round = 0; round < ROUNDS; ++round)
        for (std::size_t i = 0; i < kinds.size(); ++i)
            bench.record(kinds[i], taken[i]);
    std::printf("%d frames of 1280x720, %d triangles, Rendered; medians of %d\n", FRAMES,
                2 * CELLS * CELLS, ROUNDS);
    std::printf("%-8s %9s %8s %22s %9s\n", "film", "seconds", "ratio", "processor ms a frame",
                "MB");
    const double plain_s = median(taken[0].wall_s);
    for (std::size_t i = 0; i < kinds.size(); ++i)
        std::printf("%-8s %9.2f %8.2f %22.1f %9.2f\n", i == 0 ? "none" : kinds[i].c_str(),
                    median(taken[i].wall_s), median(taken[i].wall_s) / plain_s,
                    1000.0 * median(taken[i].processor_s) / FRAMES,
                    static_cast<double>(taken[i].bytes) / 1e6);
    return 0;
}
