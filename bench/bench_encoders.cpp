// Milliseconds that a frame's picture takes to be encoded and written, as a recording does it,
// beside writing its pixels into a file as they are. The picture is the example model in Rendered.

#include "bench/PavilionScene.h"
#include "bench/SteadyTurntable.h"
#include "bench/Timing.h"
#include "engine/display/DisplayMode.h"
#include "engine/display/DisplayPipeline.h"
#include "engine/display/DisplayScene.h"
#include "engine/images/ImageFile.h"
#include "ground/AtomicFile.h"

#include <cstddef>
#include <cstdio>
#include <filesystem>
#include <span>

namespace {

namespace fs = std::filesystem;

constexpr double budget_ms = 1500.0;

quarn::Image drawn(const quarn::DisplayScene& scene, int width, int height) {
    const bench::Orbit orbit{{0.0, 0.0, 3.0}, 42.0, 24.0, 250.0, 50.0};
    auto mode = *quarn::findDisplayMode(quarn::rendered_mode_id);
    mode.antialiasing_level = static_cast<int>(quarn::AntialiasingLevel::capture);
    quarn::DisplayPipeline pipeline;
    quarn::Image image;
    bench::require(pipeline.draw(scene, orbit.at(0.0), mode, width, height, image));
    return image;
}

void print(const quarn::Image& image, const char* format, double encode_ms, double write_ms,
           double copy_ms, const fs::path& file) {
    std::printf("| %dx%d | %s | %.1f | %.1f | %.1f | %.2f |\n", image.width, image.height, format,
                encode_ms, write_ms, copy_ms, static_cast<double>(fs::file_size(file)) / 1e6);
    std::fflush(stdout);
}

void measure(const quarn::Image& image, const char* extension, const fs::path& folder) {
    const fs::path file = folder / (std::string("frame.") + extension);
    const fs::path plain = folder / "frame.pixels";
    const auto format = *quarn::imageFormatFor(extension);
    double encode_ms = 1e9;
    double write_ms = 1e9;
    double copy_ms = 1e9;
    bench::repeatFor(budget_ms, [&] {
        bench::keepBest(encode_ms, [&] {
            if (const auto encoded = quarn::encodeImage(image, format); !encoded)
                bench::fail(encoded.message());
        });
        bench::keepBest(write_ms, [&] { bench::require(quarn::writeImageFile(file, image)); });
        bench::keepBest(copy_ms, [&] {
            bench::require(quarn::writeFileAtomically(plain, std::as_bytes(std::span(image.rgba))));
        });
    });
    print(image, extension, encode_ms, write_ms, copy_ms, file);
}

} // namespace

int main() {
    quarn::DisplayScene scene;
    bench::require(scene.update(bench::pavilionContent()));
    const bench::WorkFolder folder;
    std::printf("Milliseconds a picture\n\n"
                "| picture | format | encode | encode and write | write the pixels alone | MB |\n"
                "|---|---|---|---|---|---|\n");
    for (const auto& [width, height] : {std::pair{1280, 720}, {1920, 1080}}) {
        const quarn::Image image = drawn(scene, width, height);
        for (const char* const extension : {"jpg", "png", "bmp", "tga"})
            measure(image, extension, folder.path());
    }
    return 0;
}
