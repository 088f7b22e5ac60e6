// One frame of an animation, asked for by itself, of animations of a hundred and of a million
// frames. Of a turntable or a sun study it costs the same; a path is looked up anew from its curves
// and costs as much as its number of frames. Stepping to the next frame by its command copies the
// record out and back, and draws; beside it stands a plain copy of the record. Playing copies it
// once, so that each of many frames takes as long as each of a few.

#include "host/front_end/ScriptedFrontEnd.h"
#include "host/session/Session.h"
#include "sdk/qncore/qncore.h"
#include "tests/support/TempFolder.h"

#include <benchmark/benchmark.h>

#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <string>

namespace {

constexpr int few_frames = 100;
constexpr int many_frames = 1'000'000;
constexpr int frames_to_play = 20'000;

/// The host with the plug-in, as they are shipped, and a document with two curves.
class Host {
public:
    Host() : m_session(m_front_end, options()) {
        require(m_session.loadPlugIn(ZOETRIX_PLUGIN_PATH).ok(), "load the plug-in");
        m_front_end.setKeyDown(VK_ESCAPE, true); // no pause after a frame
        run(L"_-ViewportSize 64 36");
        importCurves();
    }

    CQuarnDoc& document() { return m_session.document(); }
    static IQnZoetrixDynamicAccess& access() { return *Zoetrix_QuarnDynamicAccess(); }
    const KM_3dmAnimationProperties& record() { return access().AnimationProperties(document()); }

    /// A camera on a circle about the origin, or a sun above it.
    void setUp(KM_3dmAnimationProperties::CaptureTypes type, int frames) {
        KM_3dmAnimationProperties props;
        props.SetCaptureType(type);
        props.SetViewportName(L"Perspective");
        props.SetFrameCount(frames);
        props.SetCurrentFrame(0);
        props.CameraPoints().Reserve(frames);
        props.TargetPoints().Reserve(frames);
        for (int k = 0; k < frames; ++k) {
            const double angle = 2.0 * KM_PI * k / frames;
            props.CameraPoints().Append(
                KM_3dPoint(20.0 * std::cos(angle), 20.0 * std::sin(angle), 8.0));
            props.TargetPoints().Append(KM_3dPoint::Origin);
        }
        access().SetAnimationProperties(document(), props);
    }
    /// A camera on one of the document's curves that looks at the other.
    void setUpPath(int frames) {
        setUp(KM_3dmAnimationProperties::path, frames);
        KM_3dmAnimationProperties props = record();
        props.SetCameraPathId(curve(L"rail"));
        props.SetTargetPathId(curve(L"gaze"));
        access().SetAnimationProperties(document(), props);
    }

    void run(const std::wstring& line) {
        m_front_end.clearPrinted();
        if (m_session.runCommand(line) == CQuarnCommand::success)
            return;
        std::fprintf(stderr, "%ls\n", m_front_end.printed().c_str());
        require(false, "run a command");
    }

private:
    static quarn::SessionOptions options() {
        quarn::SessionOptions options;
        options.language = "en";
        return options;
    }
    static void require(bool condition, const char* what) {
        if (condition)
            return;
        std::fprintf(stderr, "The benchmark cannot %s.\n", what);
        std::exit(1);
    }
    void importCurves() {
        const quarn::test::TempFolder folder;
        const std::filesystem::path model = folder.path() / "curves.obj";
        quarn::test::writeFile(model, "v 0 0 0\nv 10 0 0\nv 10 10 0\nv 0 0 5\nv 0 4 5\n"
                                      "o rail\nl 1 2 3\no gaze\nl 4 5\n");
        std::wstring line = L"_-Import ";
        line.append(L"\"").append(model.wstring()).append(L"\"");
        run(line);
    }
    KM_UUID curve(const wchar_t* name) {
        const CQuarnObject* object = document().FindObjectByName(name);
        require(object, "find its curve");
        return object->Id();
    }

    quarn::ScriptedFrontEnd m_front_end;
    quarn::Session m_session;
};

Host& host() {
    static Host the_host;
    return the_host;
}

int framesOf(const benchmark::State& state) {
    return static_cast<int>(state.range(0));
}

/// Asks for one frame after the other, all over the animation.
template <class Ask> void askForFrames(benchmark::State& state, Ask&& ask) {
    const int frames = framesOf(state);
    const int step = frames / 7 + 1;
    int frame = 0;
    for (auto _ : state) {
        if (!ask(frame + 1))
            state.SkipWithError("there is no such frame");
        frame = (frame + step) % frames;
    }
}

void askForCameras(benchmark::State& state) {
    CQuarnDoc& document = host().document();
    KM_Viewport camera;
    askForFrames(state, [&](int frame) {
        return Host::access().AnimatedViewAtFrame(document, host().record(), frame, camera);
    });
}

void frameOfTurntable(benchmark::State& state) {
    host().setUp(KM_3dmAnimationProperties::turntable, framesOf(state));
    askForCameras(state);
}

void frameOfSunStudy(benchmark::State& state) {
    host().setUp(KM_3dmAnimationProperties::one_day_sun, framesOf(state));
    CQuarnDoc& document = host().document();
    KM_Light sun;
    askForFrames(state, [&](int frame) {
        return Host::access().AnimatedSunAtFrame(document, host().record(), frame, sun);
    });
}

void frameOfPath(benchmark::State& state) {
    host().setUpPath(framesOf(state));
    askForCameras(state);
}

void copyRecord(benchmark::State& state) {
    host().setUp(KM_3dmAnimationProperties::turntable, framesOf(state));
    for (auto _ : state) {
        const KM_3dmAnimationProperties copy = host().record();
        benchmark::DoNotOptimize(&copy);
    }
}

void viewNextFrame(benchmark::State& state) {
    host().setUp(KM_3dmAnimationProperties::turntable, framesOf(state));
    for (auto _ : state)
        host().run(L"_-ViewNextFrame");
}

/// All frames in turn; items are frames.
void play(benchmark::State& state, KM_3dmAnimationProperties::CaptureTypes type) {
    host().setUp(type, framesOf(state));
    for (auto _ : state)
        host().run(L"_-PlayAnimation");
    state.SetItemsProcessed(state.iterations() * framesOf(state));
}

void playTurntable(benchmark::State& state) {
    play(state, KM_3dmAnimationProperties::turntable);
}

void playSunStudy(benchmark::State& state) {
    play(state, KM_3dmAnimationProperties::one_day_sun);
}

} // namespace

BENCHMARK(frameOfTurntable)->Arg(few_frames)->Arg(many_frames)->Unit(benchmark::kMicrosecond);
BENCHMARK(frameOfSunStudy)->Arg(few_frames)->Arg(many_frames)->Unit(benchmark::kMicrosecond);
BENCHMARK(frameOfPath)->Arg(few_frames)->Arg(many_frames)->Unit(benchmark::kMicrosecond);
BENCHMARK(copyRecord)->Arg(few_frames)->Arg(many_frames)->Unit(benchmark::kMicrosecond);
BENCHMARK(viewNextFrame)->Arg(few_frames)->Arg(many_frames)->Unit(benchmark::kMicrosecond);
BENCHMARK(playTurntable)->Arg(few_frames)->Arg(frames_to_play)->Unit(benchmark::kMillisecond);
BENCHMARK(playSunStudy)->Arg(few_frames)->Arg(frames_to_play)->Unit(benchmark::kMillisecond);

BENCHMARK_MAIN();
