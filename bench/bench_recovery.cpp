// What keeping unsaved work for recovery costs the main thread on a beat: when nothing changed,
// when a curve was added and when a mesh was, in a document of a million triangles with an
// animation and a picture in its view; beside saving the whole document. Processor time of the main
// thread, so that it holds on a busy machine; the worst of all rounds counts.

#include "host/front_end/ScriptedFrontEnd.h"
#include "host/session/Recovery.h"
#include "host/session/Session.h"
#include "host/session/ViewFrame.h"
#include "sdk/qncore/qncore.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <functional>
#include <optional>
#include <string>
#include <time.h>
#include <unistd.h>
#include <vector>

namespace {

namespace fs = std::filesystem;

/// Processor time of this thread.
double usedMilliseconds() {
    timespec time{};
    clock_gettime(CLOCK_THREAD_CPUTIME_ID, &time);
    return 1e3 * static_cast<double>(time.tv_sec) + 1e-6 * static_cast<double>(time.tv_nsec);
}

[[noreturn]] void fail(const std::string& why) {
    std::fprintf(stderr, "%s\n", why.c_str());
    std::exit(1);
}

/// Waves over a square, cut into this many objects a side, each of 2 * cells * cells triangles.
void writeWaves(const fs::path& file, int objects_a_side, int cells) {
    std::ofstream obj(file);
    const double step = 100.0 / (objects_a_side * cells);
    for (int object = 0; object < objects_a_side * objects_a_side; ++object) {
        const int column = object % objects_a_side * cells;
        const int row = object / objects_a_side * cells;
        obj << "o wave" << object << '\n';
        for (int j = row; j <= row + cells; ++j)
            for (int i = column; i <= column + cells; ++i)
                obj << "v " << step * i << ' ' << step * j << ' '
                    << std::sin(0.2 * step * i) * std::cos(0.17 * step * j) << '\n';
        const int first = object * (cells + 1) * (cells + 1) + 1;
        for (int j = 0; j < cells; ++j)
            for (int i = 0; i < cells; ++i) {
                const int a = first + j * (cells + 1) + i;
                obj << "f " << a << ' ' << a + 1 << ' ' << a + cells + 2 << '\n'
                    << "f " << a << ' ' << a + cells + 2 << ' ' << a + cells + 1 << '\n';
            }
    }
}

class BenchFolder {
public:
    BenchFolder()
        : m_path(fs::temp_directory_path() / ("bench_recovery_" + std::to_string(getpid()))) {
        fs::create_directories(m_path);
    }
    ~BenchFolder() {
        std::error_code ignored;
        fs::remove_all(m_path, ignored);
    }
    BenchFolder(const BenchFolder&) = delete;
    BenchFolder& operator=(const BenchFolder&) = delete;

    fs::path operator/(const char* name) const { return m_path / name; }

private:
    fs::path m_path;
};

/// A session with a model in it, an animation of it, a picture in its view, and a file.
class Bench {
public:
    Bench(const BenchFolder& folder, const fs::path& model) {
        if (!m_session.loadPlugIn(ZOETRIX_PLUGIN_PATH).ok())
            fail("the plug-in cannot be loaded");
        run("_-Import \"" + model.native() + '"');
        run("_-SetTurntableAnimation 360 _Clockwise _png _Shaded _Enter _Enter");
        quarn::activeView(m_session.document()).Redraw();
        m_save_line = "_-SaveAs \"" + (folder / "bench.quarn").native() + '"';
        m_save_ms = timeOf([this] { run(m_save_line); });
        m_keeper.emplace(m_session, quarn::RecoveryOptions{folder / "state", {}});
        change();
        finish();
    }

    void run(const std::string& line) {
        if (m_session.runCommand(KM_wString::FromUtf8(line).View()) != CQuarnCommand::success)
            fail(line + ": " + KM_wString(m_front_end.printed()).ToUtf8());
    }
    /// Draws a line.
    void change() { run("_-Line 0,0,0 1,1," + std::to_string(++m_lines)); }

    /// Shows the model from elsewhere.
    void turn() {
        run("_-Camera _Location -50,-50," + std::to_string(++m_lines) + " _Enter");
        quarn::activeView(m_session.document()).Redraw();
    }

    void printRow(const char* document, const char* what, int rounds,
                  const std::function<void()>& prepare) {
        std::vector<double> beats;
        for (int i = 0; i < rounds; ++i) {
            prepare();
            beats.push_back(timeOf([this] { m_keeper->beat(); }));
            finish();
        }
        std::ranges::sort(beats);
        std::printf("| %s | %s | %.2f | %.2f | %.0f | %.4f |\n", document, what,
                    beats[beats.size() / 2], beats.back(), m_save_ms, beats.back() / m_save_ms);
        std::fflush(stdout);
    }

private:
    static double timeOf(const std::function<void()>& work) {
        const double start = usedMilliseconds();
        work();
        return usedMilliseconds() - start;
    }
    void finish() {
        if (const auto trouble = m_keeper->keepNow())
            fail(*trouble);
    }

    quarn::ScriptedFrontEnd m_front_end;
    quarn::Session m_session{m_front_end, {}};
    std::optional<quarn::RecoveryKeeper> m_keeper;
    std::string m_save_line;
    double m_save_ms = 0.0;
    int m_lines = 0;
};

void measure(const BenchFolder& folder, const char* document, int objects_a_side, int cells) {
    const fs::path model = folder / "model.obj";
    const fs::path added = folder / "added.obj";
    writeWaves(model, objects_a_side, cells);
    writeWaves(added, 1, 100);
    Bench bench(folder, model);
    bench.printRow(document, "nothing", 40, [] {});
    bench.printRow(document, "a curve", 40, [&] { bench.change(); });
    bench.printRow(document, "a mesh of 20 k", 20,
                   [&] { bench.run("_-Import \"" + added.native() + '"'); });
    bench.printRow(document, "another picture", 20, [&] { bench.turn(); });
}

} // namespace

int main() {
    const BenchFolder folder;
    std::printf("| document of 1 M triangles | added | beat ms | worst ms | save ms | ratio |\n"
                "|---|---|---|---|---|---|\n");
    measure(folder, "one object", 1, 707);
    measure(folder, "20 000 objects", 141, 5);
    return 0;
}
