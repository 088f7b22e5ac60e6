// Milliseconds a frame of every display mode beside a bare loop that shoots the same rays into a
// scene that holds the mesh alone and writes one number a pixel: one ray a pixel, and a second one
// to the sun for modes that cast shadows. Both use the same tiles and threads, take turns, and the
// best of many frames counts, so that the ratio holds on a busy machine too. "smoothed" is the
// picture as a recording writes it; the second ratio is that of smoothed to not smoothed.
//
// A second table compares surfaces of Rendered that mirror with matt ones: rough hills, and chrome
// balls on matt hills. It is printed where Rendered is among the modes.
//
// usage: bench_display [MODE | TRIANGLES | SIZE]...   e.g. bench_display Rendered 1M 1280x720

#include "bench/BareRayLoop.h"
#include "bench/Hills.h"
#include "bench/Timing.h"
#include "engine/display/DisplayMode.h"
#include "engine/display/DisplayPipeline.h"
#include "engine/display/DisplayScene.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace {

using bench::keepBest;

struct MeshSize {
    const char* word;
    int cells; ///< along a side; the mesh has two triangles a cell
};
constexpr MeshSize mesh_sizes[] = {{"10k", 71}, {"100k", 224}, {"1M", 707}, {"5M", 1582}};

struct PictureSize {
    const char* word;
    int width;
    int height;
};
constexpr PictureSize picture_sizes[] = {{"1280x720", 1280, 720}, {"1920x1080", 1920, 1080}};

constexpr double budget_of_row_ms = 1500.0;

std::string nameOf(const quarn::DisplayModeAttributes& mode) {
    const std::wstring_view name = mode.english_name;
    return {name.begin(), name.end()};
}

/// What the person asked for. A kind of word that none is given of leaves out nothing.
class Selection {
public:
    Selection(int count, char** words) : m_words(words, words + count) {
        for (const std::string& word : m_words)
            if (!isMode(word) && !isMesh(word) && !isPicture(word))
                bench::fail("no mode, mesh or picture size is called " + word);
    }
    bool has(const quarn::DisplayModeAttributes& mode) const { return has(nameOf(mode), isMode); }
    bool has(const MeshSize& size) const { return has(size.word, isMesh); }
    bool has(const PictureSize& size) const { return has(size.word, isPicture); }

private:
    static bool isMode(const std::string& word) {
        return std::ranges::any_of(quarn::standardDisplayModes(),
                                   [&](const auto& mode) { return nameOf(mode) == word; });
    }
    static bool isMesh(const std::string& word) {
        return std::ranges::any_of(mesh_sizes, [&](const auto& size) { return size.word == word; });
    }
    static bool isPicture(const std::string& word) {
        return std::ranges::any_of(picture_sizes,
                                   [&](const auto& size) { return size.word == word; });
    }
    bool has(const std::string& word, bool (*is_of_kind)(const std::string&)) const {
        return std::ranges::none_of(m_words, is_of_kind) ||
               std::ranges::find(m_words, word) != m_words.end();
    }

    std::vector<std::string> m_words;
};

struct Times {
    double bare = 1e9;
    double plain = 1e9;
    double smoothed = 1e9;
};

Times measure(const quarn::DisplayScene& scene, bench::BareRayLoop& bare,
              const quarn::DisplayModeAttributes& mode, const PictureSize& size) {
    auto plain = mode;
    plain.antialiasing_level = static_cast<int>(quarn::AntialiasingLevel::off);
    auto smoothed = mode;
    smoothed.antialiasing_level = static_cast<int>(quarn::AntialiasingLevel::capture);
    const KM_Viewport viewport = bench::hillsView();
    bare.look(viewport, size.width, size.height);
    quarn::DisplayPipeline pipeline;
    quarn::Image image;
    const auto draw = [&](const quarn::DisplayModeAttributes& attributes) {
        bench::require(pipeline.draw(scene, viewport, attributes, size.width, size.height, image));
    };
    draw(smoothed); // asks for the memory that later frames use again
    Times times;
    bench::repeatFor(budget_of_row_ms, [&] {
        keepBest(times.bare, [&] { bare.draw(mode.casts_shadows); });
        keepBest(times.plain, [&] { draw(plain); });
        keepBest(times.smoothed, [&] { draw(smoothed); });
    });
    return times;
}

void measureMesh(const MeshSize& mesh_size, const Selection& selection) {
    const auto mesh = bench::makeHills(mesh_size.cells);
    const quarn::SceneContent content = bench::sunlit(mesh);
    quarn::DisplayScene scene;
    bench::require(scene.update(content));
    bench::BareRayLoop bare(*mesh, content.lights.front());
    for (const PictureSize& size : picture_sizes)
        for (const quarn::DisplayModeAttributes& mode : quarn::standardDisplayModes()) {
            if (!selection.has(size) || !selection.has(mode))
                continue;
            const Times t = measure(scene, bare, mode, size);
            std::printf("| %s | %s | %s | %.1f | %.1f | %.2f | %.1f | %.2f |\n",
                        bench::inWords(mesh->TriangleCount()).c_str(), size.word,
                        nameOf(mode).c_str(), t.bare, t.plain, t.plain / t.bare, t.smoothed,
                        t.smoothed / t.plain);
            std::fflush(stdout);
        }
}

/// How a scene is drawn where nothing in it mirrors, and as it is.
struct Looks {
    const char* name;
    float hills_roughness;
    bool has_chrome;
};
constexpr Looks looks_compared[] = {{"rough hills", 0.6F, false}, {"chrome balls", 1.0F, true}};

std::shared_ptr<KM_Mesh> makeBall(const KM_3dPoint& middle, double radius) {
    auto mesh = std::make_shared<KM_Mesh>();
    constexpr std::uint32_t rings = 24;
    constexpr std::uint32_t around = 2 * rings;
    for (std::uint32_t j = 0; j <= rings; ++j)
        for (std::uint32_t i = 0; i < around; ++i) {
            const double polar = KM_PI * j / rings;
            const double turn = KM_PI * i / rings;
            const KM_3dVector n(std::sin(polar) * std::cos(turn), std::sin(polar) * std::sin(turn),
                                std::cos(polar));
            mesh->m_V.emplace_back(middle + radius * n);
        }
    for (std::uint32_t j = 0; j < rings; ++j)
        for (std::uint32_t i = 0; i < around; ++i) {
            const std::uint32_t a = j * around + i;
            const std::uint32_t b = j * around + (i + 1) % around;
            mesh->m_F.push_back({{a, a + around, b}});
            mesh->m_F.push_back({{b, a + around, b + around}});
        }
    mesh->ComputeVertexNormals();
    mesh->PadForRayTracing();
    return mesh;
}

quarn::SceneContent lookedAt(const std::shared_ptr<const KM_Mesh>& hills, const Looks& looks,
                             bool mirrors) {
    quarn::SceneContent content = bench::sunlit(hills);
    auto ground = std::make_shared<quarn::Material>();
    auto chrome = std::make_shared<quarn::Material>();
    if (mirrors) {
        ground->roughness = looks.hills_roughness;
        chrome->metalness = 1.0F;
        chrome->roughness = 0.05F;
    }
    content.meshes[0].placed.material = ground;
    for (int i = 0; looks.has_chrome && i < 8; ++i) {
        const KM_3dPoint middle(-28.0 + 8.0 * i, -18.0 + 6.0 * (i % 3), 6.0);
        content.meshes.push_back({{makeBall(middle, 3.5), chrome, {}}, KM_CreateUuid()});
    }
    return content;
}

void compareLooks(const MeshSize& mesh_size, const Looks& looks, const PictureSize& size) {
    const auto hills = bench::makeHills(mesh_size.cells);
    const auto mode = *quarn::findDisplayMode(quarn::rendered_mode_id);
    double best[2][2] = {{1e9, 1e9}, {1e9, 1e9}}; // matt or not, plain or smoothed
    quarn::DisplayScene scenes[2];
    quarn::DisplayPipeline pipelines[2];
    for (int i = 0; i < 2; ++i)
        bench::require(scenes[i].update(lookedAt(hills, looks, i == 1)));
    quarn::Image image;
    bench::repeatFor(budget_of_row_ms, [&] {
        for (int i = 0; i < 4; ++i) {
            auto attributes = mode;
            attributes.antialiasing_level = i / 2 * 2;
            keepBest(best[i % 2][i / 2], [&] {
                bench::require(pipelines[i % 2].draw(scenes[i % 2], bench::hillsView(), attributes,
                                                     size.width, size.height, image));
            });
        }
    });
    std::printf("| %s | %s | %s | %.1f | %.1f | %.2f | %.1f | %.1f | %.2f |\n",
                bench::inWords(hills->TriangleCount()).c_str(), size.word, looks.name, best[0][0],
                best[1][0], best[1][0] / best[0][0], best[0][1], best[1][1],
                best[1][1] / best[0][1]);
    std::fflush(stdout);
}

void compareAllLooks(const Selection& selection) {
    if (!selection.has(*quarn::findDisplayMode(quarn::rendered_mode_id)))
        return;
    std::printf("\nMilliseconds a frame of Rendered\n\n"
                "| triangles | picture | what mirrors | matt | mirroring | ratio "
                "| matt, smoothed | mirroring, smoothed | ratio |\n"
                "|---|---|---|---|---|---|---|---|---|\n");
    for (const MeshSize& mesh : mesh_sizes)
        for (const PictureSize& picture : picture_sizes)
            for (const Looks& looks : looks_compared)
                if (selection.has(mesh) && selection.has(picture))
                    compareLooks(mesh, looks, picture);
}

} // namespace

int main(int count, char** words) {
    const Selection selection(count - 1, words + 1);
    std::printf("Milliseconds a frame\n\n"
                "| triangles | picture | mode | bare rays | frame | ratio | smoothed | ratio |\n"
                "|---|---|---|---|---|---|---|---|\n");
    for (const MeshSize& size : mesh_sizes)
        if (selection.has(size))
            measureMesh(size, selection);
    compareAllLooks(selection);
    return 0;
}
