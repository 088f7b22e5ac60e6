// What recording a frame costs besides drawing it, encoding it and the host's wait: the plug-in and
// the host record a turntable, then the same frames are drawn and written alone. All runs on one
// processor, its time is what counts, and of each frame the best of several rounds, so that the
// difference holds on a busy machine too.

#include "host/front_end/ScriptedFrontEnd.h"
#include "host/session/Session.h"
#include "sdk/qncore/qncore.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sched.h>
#include <string>
#include <string_view>
#include <time.h>
#include <unistd.h>
#include <utility>
#include <vector>

namespace {

namespace fs = std::filesystem;

constexpr int cells = 40; // 2 * 40 * 40 = 3200 triangles
constexpr unsigned wait_ms = 10;

/// Processor time of the whole program.
double usedMilliseconds() {
    timespec time{};
    clock_gettime(CLOCK_PROCESS_CPUTIME_ID, &time);
    return 1e3 * static_cast<double>(time.tv_sec) + 1e-6 * static_cast<double>(time.tv_nsec);
}

[[noreturn]] void fail(std::string_view why, std::string_view output = {}) {
    std::fprintf(stderr, "%.*s\n%.*s\n", static_cast<int>(why.size()), why.data(),
                 static_cast<int>(output.size()), output.data());
    std::exit(1);
}

void require(bool condition, std::string_view what) {
    if (!condition)
        fail(what);
}

std::wstring wide(const std::string& ascii) {
    return {ascii.begin(), ascii.end()};
}

/// A front end that measures, for every frame, the time outside the host's wait.
class MeasuringFrontEnd final : public quarn::ScriptedFrontEnd {
public:
    void pumpEvents(unsigned milliseconds) override {
        m_busy_ms += usedMilliseconds() - m_resumed;
        quarn::ScriptedFrontEnd::pumpEvents(milliseconds);
        if (m_frame_is_written)
            m_frames_ms.push_back(m_busy_ms);
        else if (m_frames_ms.empty())
            m_busy_ms = 0.0; // what comes before the first frame belongs to none
        if (std::exchange(m_frame_is_written, false))
            m_busy_ms = 0.0;
        m_resumed = usedMilliseconds();
    }

    void frameWritten(const fs::path&, int, int) override { m_frame_is_written = true; }

    /// The frames since the last call.
    std::vector<double> takeFrames() { return std::exchange(m_frames_ms, {}); }

private:
    double m_resumed = usedMilliseconds();
    double m_busy_ms = 0.0;
    bool m_frame_is_written = false;
    std::vector<double> m_frames_ms;
};

/// A folder that goes away with its files.
class BenchFolder {
public:
    BenchFolder()
        : m_path(fs::temp_directory_path() / ("bench_recording_" + std::to_string(getpid()))) {
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

/// Hills over a square of 10 by 10.
void writeHills(const fs::path& file) {
    std::ofstream obj(file);
    for (int j = 0; j <= cells; ++j)
        for (int i = 0; i <= cells; ++i)
            obj << "v " << 0.25 * i - 5.0 << ' ' << 0.25 * j - 5.0 << ' '
                << std::sin(0.2 * i) * std::cos(0.17 * j) << '\n';
    for (int j = 0; j < cells; ++j)
        for (int i = 0; i < cells; ++i) {
            const int a = j * (cells + 1) + i + 1;
            obj << "f " << a << ' ' << a + 1 << ' ' << a + cells + 2 << '\n'
                << "f " << a << ' ' << a + cells + 2 << ' ' << a + cells + 1 << '\n';
        }
}

struct FrameTimes {
    std::vector<double> recorded;
    std::vector<double> drawn;
    std::vector<double> written;
};

void keepBest(std::vector<double>& best, const std::vector<double>& round) {
    require(best.empty() || best.size() == round.size(), "a frame was not recorded");
    best.resize(round.size(), 1e9);
    for (std::size_t i = 0; i < round.size(); ++i)
        best[i] = std::min(best[i], round[i]);
}

double meanOf(const std::vector<double>& times, std::size_t first, std::size_t end) {
    double sum = 0.0;
    for (std::size_t i = first; i < end; ++i)
        sum += times[i];
    return sum / static_cast<double>(end - first);
}

class RecordingBench {
public:
    RecordingBench() : m_session(m_front_end, options()) {
        const quarn::PlugInLoad load = m_session.loadPlugIn(ZOETRIX_PLUGIN_PATH);
        require(load.ok(), load.message);
        fs::create_directories(framesFolder());
        const fs::path model = m_folder.path() / "hills.obj";
        writeHills(model);
        run("_-Import \"" + model.string() + "\"");
        run("_-Camera _Location 0,-14,8 _Target 0,0,0 _Enter");
    }

    void measure(int width, int height, const std::string& mode, const std::string& format,
                 int frame_count, int rounds) {
        run("_-ViewportSize " + std::to_string(width) + " " + std::to_string(height));
        run("_-SetTurntableAnimation " + std::to_string(frame_count) + " _Clockwise _" + format +
            " _" + (mode == "Rendered" ? "RenderedViewport" : mode) + " _Enter _Enter");
        FrameTimes best;
        for (int round = 0; round < rounds; ++round) {
            keepBest(best.recorded, record());
            drawAndWrite(format, best);
        }
        require(best.recorded.size() == static_cast<std::size_t>(frame_count),
                "a frame was not recorded");
        print(width, height, mode, format, best);
    }

private:
    static quarn::SessionOptions options() {
        quarn::SessionOptions options;
        options.language = "en";
        return options;
    }

    fs::path framesFolder() const { return m_folder.path() / "frames"; }

    void run(const std::string& line) {
        if (m_session.runCommand(wide(line)) != CQuarnCommand::success)
            fail("'" + line + "' failed", KM_wString(m_front_end.printed().c_str()).ToUtf8());
    }

    std::vector<double> record() {
        m_front_end.takeFrames();
        run("_-RecordAnimation _TargetFolder \"" + framesFolder().string() + "\" _Enter");
        return m_front_end.takeFrames();
    }

    /// The same frames again: each is drawn into a picture that is there already and written over
    /// the file of the recording.
    void drawAndWrite(const std::string& format, FrameTimes& best) {
        const KM_3dmAnimationProperties props =
            m_session.document().Properties().AnimationProperties();
        CQuarnViewport& viewport = QuarnApp().ActiveView()->ActiveViewport();
        require(viewport.SetDisplayMode(props.DisplayMode()), "the display mode is not known");
        CQuarnDisplayPipeline& pipeline = *viewport.DisplayPipeline();
        pipeline.CurrentDisplayAttributes()->m_antialiasing_level = 2;
        const std::wstring path = wide((framesFolder() / ("alone." + format)).string());
        std::vector<double> drawn;
        std::vector<double> written;
        CQuarnDib picture;
        for (int i = 0; i < props.FrameCount(); ++i) {
            viewport.SetTargetAndCameraLocation(props.TargetPoints()[i], props.CameraPoints()[i],
                                                true, true);
            const double start = usedMilliseconds();
            require(pipeline.DrawToDib(picture, pipeline.FrameWidth(), pipeline.FrameHeight(),
                                       *pipeline.CurrentDisplayAttributes()),
                    "a frame was not drawn");
            const double drawn_at = usedMilliseconds();
            require(picture.WriteToFile(path.c_str(), 0), "a frame was not written");
            drawn.push_back(drawn_at - start);
            written.push_back(usedMilliseconds() - drawn_at);
            QuarnApp().Wait(wait_ms); // the recording's processor rests as well
        }
        keepBest(best.drawn, drawn);
        keepBest(best.written, written);
    }

    static void print(int width, int height, const std::string& mode, const std::string& format,
                      const FrameTimes& best) {
        const std::size_t count = best.recorded.size();
        const std::size_t part = count > 200 ? 100 : count;
        for (const std::size_t first : {std::size_t{0}, count - part}) {
            const double recorded = meanOf(best.recorded, first, first + part);
            const double drawn = meanOf(best.drawn, first, first + part);
            const double written = meanOf(best.written, first, first + part);
            std::printf("%5d x %-5d %-9s %-4s %5zu to %-5zu %9.2f %9.2f %9.2f %9.2f\n", width,
                        height, mode.c_str(), format.c_str(), first, first + part - 1, recorded,
                        drawn, written, recorded - drawn - written);
            if (part == count)
                return;
        }
    }

    BenchFolder m_folder;
    MeasuringFrontEnd m_front_end;
    quarn::Session m_session;
};

void stayOnOneProcessor() {
    cpu_set_t allowed;
    require(sched_getaffinity(0, sizeof allowed, &allowed) == 0, "the processors are not known");
    int first = 0;
    while (!CPU_ISSET(first, &allowed))
        ++first;
    CPU_ZERO(&allowed);
    CPU_SET(first, &allowed);
    require(sched_setaffinity(0, sizeof allowed, &allowed) == 0, "no processor can be chosen");
}

} // namespace

int main() {
    stayOnOneProcessor();
    std::printf("Milliseconds of one processor a frame, mesh of %d triangles\n", 2 * cells * cells);
    std::printf("%13s %-9s %-4s %14s %9s %9s %9s %9s\n", "picture", "mode", "kind", "frames",
                "recorded", "drawing", "encoding", "overhead");
    RecordingBench bench;
    // What is cheap to draw shows the overhead best.
    for (const char* const mode : {"Wireframe", "Rendered"})
        for (const char* const format : {"jpg", "png"}) {
            bench.measure(320, 180, mode, format, 20, 5);
            bench.measure(1280, 720, mode, format, 20, 5);
        }
    bench.measure(64, 36, "Wireframe", "jpg", 1000, 2);
    return 0;
}
