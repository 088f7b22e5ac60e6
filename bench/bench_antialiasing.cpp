// How steady edges are in a slow turntable, one degree a frame, at each level of anti-aliasing:
// every edge pixel is carried along with its surface into the next frame and compared there with
// the colour between the four pixels around. "crawl" is the mean change, "error" the root of the
// mean square distance to a picture of 64 rays a pixel; both in steps of 255. The crawl of those
// pictures themselves is what remains when edges are as good as they can be.

#include "bench/Hills.h"
#include "bench/PavilionScene.h"
#include "bench/SteadyTurntable.h"
#include "bench/Timing.h"
#include "engine/display/DisplayMode.h"

#include <cstdio>
#include <memory>

namespace {

constexpr int width = 640;
constexpr int height = 360;
constexpr int frame_count = 6;

void addBar(KM_Mesh& mesh, const KM_3dPoint& from, const KM_3dPoint& to, double half_width) {
    const KM_3dVector along = to - from;
    KM_3dVector across = KM_CrossProduct(along, KM_3dVector::ZAxis); // no bar is upright
    across.Unitize();
    KM_3dVector up = KM_CrossProduct(across, along);
    up.Unitize();
    const auto first = static_cast<std::uint32_t>(mesh.m_V.size());
    for (const KM_3dPoint& end : {from, to})
        for (const auto& [a, b] : {std::pair{-1.0, -1.0}, {1.0, -1.0}, {1.0, 1.0}, {-1.0, 1.0}})
            mesh.m_V.emplace_back(end + half_width * (a * across + b * up));
    for (std::uint32_t i = 0; i < 4; ++i) {
        const std::uint32_t j = (i + 1) % 4;
        mesh.m_F.push_back({{first + i, first + j, first + 4 + j}});
        mesh.m_F.push_back({{first + i, first + 4 + j, first + 4 + i}});
    }
}

/// A square mast of thin bars, which are about a pixel wide in the turntable: what smoothing finds
/// hardest.
quarn::SceneContent mastContent() {
    constexpr double half_width = 0.011;
    constexpr int floors = 12;
    KM_Mesh mesh;
    const auto corner = [](int index, int floor) {
        const double half = 1.6 - 0.08 * floor;
        const double x = index % 4 == 0 || index % 4 == 3 ? -half : half;
        const double y = index % 4 < 2 ? -half : half;
        return KM_3dPoint(x, y, 0.9 * floor);
    };
    for (int floor = 0; floor < floors; ++floor)
        for (int i = 0; i < 4; ++i) {
            addBar(mesh, corner(i, floor), corner(i, floor + 1), half_width);
            addBar(mesh, corner(i, floor), corner(i + 1, floor + 1), half_width);
            addBar(mesh, corner(i + 1, floor), corner(i, floor + 1), half_width);
            addBar(mesh, corner(i, floor + 1), corner(i + 1, floor + 1), half_width);
        }
    mesh.PadForRayTracing();
    return bench::sunlit(std::make_shared<const KM_Mesh>(std::move(mesh)));
}

void print(const char* model, const char* mode, const bench::SteadyTurntable::Comparison& c) {
    const auto& crawl = c.residual;
    std::printf("| %s | %s | %.1f | %.1f | %.1f | %.1f | %.1f | %.1f | %.1f |\n", model, mode,
                crawl[0].mean(), crawl[1].mean(), crawl[2].mean(), crawl[3].mean(),
                c.error[0].rootMeanSquare(), c.error[1].rootMeanSquare(),
                c.error[2].rootMeanSquare());
    std::fflush(stdout);
}

void measure(const char* name, const quarn::SceneContent& content, const bench::Orbit& orbit) {
    quarn::DisplayScene scene;
    bench::require(scene.update(content));
    bench::SteadyTurntable turntable(scene, orbit, width, height);
    const auto report = [&](const char* mode_name, const KM_UUID& mode) {
        const auto comparison = turntable.compare(*quarn::findDisplayMode(mode), frame_count);
        if (!comparison)
            bench::fail(comparison.message());
        print(name, mode_name, comparison.value());
    };
    report("Shaded", quarn::shaded_mode_id);
    report("Rendered", quarn::rendered_mode_id);
}

} // namespace

int main() {
    std::printf("Edge pixels of %d frames of %dx%d, in steps of 255; by level of anti-aliasing\n\n"
                "| model | mode | crawl 0 | crawl 1 | crawl 2 | 64 rays | error 0 | error 1 | "
                "error 2 |\n|---|---|---|---|---|---|---|---|---|\n",
                frame_count, width, height);
    measure("pavilion", bench::pavilionContent(), {{0.0, 0.0, 3.0}, 42.0, 24.0, 250.0, 50.0});
    measure("hills, 100 k", bench::sunlit(bench::makeHills(224)),
            {{0.0, 0.0, 0.0}, 120.0, 22.0, 250.0, 50.0});
    measure("mast of thin bars", mastContent(), {{0.0, 0.0, 5.4}, 17.0, 8.0, 250.0, 50.0});
    return 0;
}
