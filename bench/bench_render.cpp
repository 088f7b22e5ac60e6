// The renderer on the example model: how long a picture takes, and how far it is from one of 4096
// samples, as the root of the mean squared difference of their bytes (0 to 255).
//
// usage: bench_render [WIDTHxHEIGHT] [SAMPLES,...]

#include "bench/RenderedPavilion.h"
#include "engine/render/Renderer.h"

#include <cstdio>
#include <sstream>
#include <vector>

namespace {

constexpr int reference_samples = 4096;

struct Options {
    int width = 320;
    int height = 180;
    std::vector<int> samples{1, 2, 4, 8, 16, 32, 64};
};

struct Measured {
    quarn::Image image;
    double seconds;
    double processor_seconds;
};

Measured rendered(const quarn::DisplayScene& scene, const quarn::RenderRequest& request) {
    Measured measured;
    const auto start = bench::Clock::now();
    const double processor_start = bench::processorSeconds();
    const auto end = quarn::Renderer().render(
        scene, bench::fromTheStreet(scene), request, [](double) { return true; }, measured.image);
    if (!end)
        bench::fail(end.message());
    measured.seconds = bench::millisecondsSince(start) / 1000.0;
    measured.processor_seconds = bench::processorSeconds() - processor_start;
    return measured;
}

Options readOptions(int count, char** words) {
    Options options;
    if (count > 1 && std::sscanf(words[1], "%dx%d", &options.width, &options.height) != 2)
        bench::fail("usage: bench_render [WIDTHxHEIGHT] [SAMPLES,...]");
    if (count < 3)
        return options;
    options.samples.clear();
    std::istringstream list(words[2]);
    for (std::string number; std::getline(list, number, ',');)
        options.samples.push_back(std::atoi(number.c_str()));
    return options;
}

void measureErrors(const quarn::DisplayScene& scene, const Options& options) {
    const quarn::Image reference =
        rendered(scene, {options.width, options.height, reference_samples}).image;
    std::printf("%dx%d beside %d samples\n%-10s %12s %12s %12s\n", options.width, options.height,
                reference_samples, "samples", "seconds", "processor s", "difference");
    for (const int samples : options.samples) {
        const Measured measured = rendered(scene, {options.width, options.height, samples});
        std::printf("%-10d %12.2f %12.2f %12.2f\n", samples, measured.seconds,
                    measured.processor_seconds, bench::difference(measured.image, reference));
        std::fflush(stdout);
    }
}

} // namespace

int main(int count, char** words) {
    const Options options = readOptions(count, words);
    quarn::DisplayScene scene;
    bench::require(scene.update(bench::pavilionContent()));
    std::printf("1280x720\n%-10s %12s %12s\n", "samples", "seconds", "processor s");
    for (const int samples : {1, 8, 64}) {
        const Measured measured = rendered(scene, {1280, 720, samples});
        std::printf("%-10d %12.2f %12.2f\n", samples, measured.seconds, measured.processor_seconds);
        std::fflush(stdout);
    }
    measureErrors(scene, options);
    return 0;
}
