#include "engine/render/LightFilter.h"

#include "engine/render/RenderEncoding.h"
#include "tests/engine/render/RenderFixture.h"

#include <cmath>
#include <functional>
#include <random>

namespace quarn {
namespace {

constexpr int side_px = 96;
constexpr int sample_count = 8;

/// Light of a pixel's samples, each of which is given.
using SampleLight = std::function<float(int x, int y)>;

/// The sums of a picture of a level floor of albedo 0.5 with light of one kind.
struct Floor {
    Floor() : layers(side_px, side_px) {}

    float& sum(int plane, int x, int y) {
        const RenderSums sums = layers.sums();
        const int tile = y / tile_size * sums.tile_columns + x / tile_size;
        return sums.planes[plane][tile * lane_count + y % tile_size * tile_size + x % tile_size];
    }

    void addSamples(const LightSums& kind, const SampleLight& light) {
        for (int y = 0; y < side_px; ++y)
            for (int x = 0; x < side_px; ++x)
                for (int sample = 0; sample < sample_count; ++sample)
                    addSample(kind, x, y, light(x, y));
    }

    void addSample(const LightSums& kind, int x, int y, float light) {
        sum(RenderPlane::normal_z, x, y) += 1.0F;
        sum(RenderPlane::nearness, x, y) += 0.01F;
        sum(RenderPlane::cover, x, y) += 1.0F;
        sum(RenderPlane::samples, x, y) += 1.0F;
        for (int c = 0; c < 3; ++c) {
            sum(RenderPlane::albedo_r + c, x, y) += 0.5F;
            sum(kind.first + c, x, y) += (kind.times_albedo ? 0.5F : 1.0F) * light;
        }
        sum(kind.square, x, y) += light * light;
    }

    std::vector<double> filtered(const LightSums& kind) {
        LightFilter filter(layers, 0.0F, renderKernelInForce());
        const LightImage& image = filter.filtered({&kind, 1}).front();
        std::vector<double> light;
        for (int y = 0; y < side_px; ++y)
            for (int x = 0; x < side_px; ++x)
                light.push_back(double{image.color[1].row(y)[x]});
        return light;
    }

    std::vector<double> unfiltered(const LightSums& kind) {
        std::vector<double> light;
        for (int y = 0; y < side_px; ++y)
            for (int x = 0; x < side_px; ++x)
                light.push_back((kind.times_albedo ? 2.0 : 1.0) *
                                double{sum(kind.first + 1, x, y)} / sample_count);
        return light;
    }

    RenderLayers layers;
};

double meanOf(const std::vector<double>& light) {
    double sum = 0.0;
    for (const double each : light)
        sum += each;
    return sum / static_cast<double>(light.size());
}

double scatterOf(const std::vector<double>& light) {
    const double mean = meanOf(light);
    double sum = 0.0;
    for (const double each : light)
        sum += (each - mean) * (each - mean);
    return std::sqrt(sum / static_cast<double>(light.size()));
}

/// Seen or not seen, half of all times each.
SampleLight noise() {
    return [random = std::mt19937(7)](int, int) mutable { return random() % 2 ? 2.0F : 0.0F; };
}

class FilteredLight : public testing::TestWithParam<LightSums> {};

TEST_P(FilteredLight, KeepsItsSum) {
    Floor floor;
    floor.addSamples(GetParam(), noise());
    const double before = meanOf(floor.unfiltered(GetParam()));
    EXPECT_NEAR(meanOf(floor.filtered(GetParam())), before, 0.005 * before);
}

TEST_P(FilteredLight, KeepsBordersThatEverySampleSees) {
    Floor floor;
    floor.addSamples(GetParam(), [](int x, int y) { return x + y / 2 < 70 ? 0.25F : 1.0F; });
    const std::vector<double> before = floor.unfiltered(GetParam());
    const std::vector<double> behind = floor.filtered(GetParam());
    for (std::size_t i = 0; i < before.size(); ++i)
        ASSERT_NEAR(behind[i], before[i], 1e-3) << i % side_px << ' ' << i / side_px;
}

INSTANTIATE_TEST_SUITE_P(OfEveryKind, FilteredLight,
                         testing::Values(sky_sums, sun_sums, gloss_sums));

TEST(LightFilter, SmoothsNoiseOnAFlatWall) {
    Floor sky;
    sky.addSamples(sky_sums, noise());
    EXPECT_LT(scatterOf(sky.filtered(sky_sums)), 0.35 * scatterOf(sky.unfiltered(sky_sums)));
    Floor gloss;
    gloss.addSamples(gloss_sums, noise());
    EXPECT_LT(scatterOf(gloss.filtered(gloss_sums)),
              0.45 * scatterOf(gloss.unfiltered(gloss_sums)));
}

TEST(LightFilter, OneSampleThatMetSomethingBrightLeavesNoDot) {
    Floor floor;
    floor.addSamples(sky_sums, [](int x, int y) { return x % 2 == y % 2 ? 0.9F : 1.1F; });
    floor.addSample(sky_sums, 40, 40, 9.0F);
    const auto dot = [](const std::vector<double>& light) { return light[40 * side_px + 40]; };
    ASSERT_GT(dot(floor.unfiltered(sky_sums)), 2.0);
    const std::vector<double> behind = floor.filtered(sky_sums);
    EXPECT_LT(dot(behind), 1.25);
    EXPECT_GT(meanOf(behind), 1.0) << "its light is spread, not lost";
}

TEST(LightFilter, LightOfTwoSurfacesInAPixelIsTheirMixture) {
    // Two walls meet in pixels that each show a part of both, and in whose few samples the light
    // of a surface scatters.
    Floor floor;
    SampleLight light = noise();
    const auto share = [](int x, int y) { return static_cast<float>((x * 5 + y * 3) % 8) / 8.0F; };
    const auto clear = [](int x) { return x < 44 ? 0.0F : x < 52 ? -1.0F : 1.0F; };
    const auto of_second = [&](int x, int y) { return clear(x) < 0.0F ? share(x, y) : clear(x); };
    for (int y = 0; y < side_px; ++y)
        for (int x = 0; x < side_px; ++x)
            for (int sample = 0; sample < sample_count; ++sample) {
                const bool is_second = (static_cast<float>(sample) + 0.5F) / 8.0F < of_second(x, y);
                floor.addSample(sky_sums, x, y, (is_second ? 0.3F : 1.0F) * light(x, y));
                if (!is_second)
                    continue;
                floor.sum(RenderPlane::normal_z, x, y) -= 1.0F;
                floor.sum(RenderPlane::normal_x, x, y) += 1.0F;
            }
    const auto off = [&](const std::vector<double>& seen) {
        std::vector<double> differences;
        for (int y = 8; y < side_px - 8; ++y)
            for (int x = 45; x < 51; ++x)
                differences.push_back(seen[static_cast<std::size_t>(y * side_px + x)] - 1.0 +
                                      0.7 * double{of_second(x, y)});
        return scatterOf(differences);
    };
    EXPECT_LT(off(floor.filtered(sky_sums)), 0.3 * off(floor.unfiltered(sky_sums)));
}

/// A floor of black and white squares of two pixels each in the view below.
SceneContent chessboard() {
    SceneContent content;
    KM_Mesh mesh = floorMesh(-50.0F, -50.0F, 50.0F, 50.0F, 0.0F);
    mesh.m_T.clear();
    for (const auto& vertex : mesh.m_V)
        mesh.m_T.emplace_back((vertex.x + 50.0F) / 100.0F, (vertex.y + 50.0F) / 100.0F);
    const std::size_t index = addMesh(content, std::move(mesh));
    auto squares = std::make_shared<Texture>();
    squares->width = squares->height = 64;
    for (int y = 0; y < 64; ++y)
        for (int x = 0; x < 64; ++x)
            for (const int value : {60, 60, 60, 255})
                squares->rgba.push_back(
                    static_cast<std::uint8_t>(value == 255 || (x + y) % 2 ? value + 0 : 220));
    auto material = std::make_shared<Material>();
    material->base_color_texture = squares;
    content.meshes[index].placed.material = material;
    content.lights = {sunLight({0.3, 0.2, -1.0})};
    return content;
}

std::vector<double> bytesOf(const Image& image) {
    std::vector<double> bytes;
    for (std::size_t i = 1; i < image.rgba.size(); i += 4)
        bytes.push_back(double{1.0} * image.rgba[i]);
    return bytes;
}

TEST(LightFilter, TexturesKeepTheirContrastWithFewSamples) {
    const double few = scatterOf(bytesOf(rendered(chessboard(), topView(30.0), {96, 96, 8})));
    const double many = scatterOf(bytesOf(rendered(chessboard(), topView(30.0), {96, 96, 256})));
    EXPECT_GT(many, 15.0) << "there are squares at all";
    EXPECT_NEAR(few, many, 0.02 * many);
}

} // namespace
} // namespace quarn
