#include "engine/display/PictureLight.h"

#include "engine/display/EnvironmentMap.h"
#include "engine/images/ColorSpace.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <numbers>

namespace quarn {

namespace {

using Direction = std::array<double, 3>;

/// A texel of the square: its direction and the solid angle that it takes.
struct TexelView {
    Direction direction;
    double solid_angle;
};

/// Unfolds a square map. Texels of the border, counted from 0, repeat what lies across the edge.
template <class Map> TexelView viewOf(int column, int row) {
    double u = (column - 0.5) * 2.0 / Map::side - 1.0;
    double v = (row - 0.5) * 2.0 / Map::side - 1.0;
    if (std::abs(u) > 1.0) {
        u = std::copysign(2.0 - std::abs(u), u);
        v = -v;
    }
    if (std::abs(v) > 1.0) {
        v = std::copysign(2.0 - std::abs(v), v);
        u = -u;
    }
    const double z = 1.0 - std::abs(u) - std::abs(v);
    Direction d{u, v, z};
    if (z < 0.0)
        d = {std::copysign(1.0 - std::abs(v), u), std::copysign(1.0 - std::abs(u), v), z};
    const double length = std::hypot(d[0], d[1], d[2]);
    const double side = 2.0 / Map::side;
    return {{d[0] / length, d[1] / length, d[2] / length},
            side * side / (length * length * length)};
}

/// Calls function(index, view) for each texel that is none of the border.
template <class Map, class Function> void forEachInnerTexel(const Function& function) {
    for (int row = 1; row <= Map::side; ++row)
        for (int column = 1; column <= Map::side; ++column)
            function(static_cast<std::size_t>(row * Map::stride + column),
                     viewOf<Map>(column, row));
}

/// Pictures with more pixels than maps can show are halved first, so that each pixel counts.
constexpr int MOST_WIDTH = 4096;

float kept(float light) {
    return light < PictureLight::MOST_LIGHT ? std::max(light, 0.0F) : PictureLight::MOST_LIGHT;
}

EnvironmentPicture halved(const EnvironmentPicture& from) {
    EnvironmentPicture to;
    to.width = from.width / 2;
    to.height = std::max(from.height / 2, 1);
    to.rgb.resize(std::size_t{3} * static_cast<std::size_t>(to.width) *
                  static_cast<std::size_t>(to.height));
    const auto at = [](int width, int x, int y) {
        return 3 * (static_cast<std::size_t>(y) * static_cast<std::size_t>(width) +
                    static_cast<std::size_t>(x));
    };
    for (int y = 0; y < to.height; ++y)
        for (int x = 0; x < to.width; ++x)
            for (std::size_t c = 0; c < 3; ++c) {
                const int below = std::min(2 * y + 1, from.height - 1);
                to.rgb[at(to.width, x, y) + c] =
                    0.25F * (kept(from.rgb[at(from.width, 2 * x, 2 * y) + c]) +
                             kept(from.rgb[at(from.width, 2 * x + 1, 2 * y) + c]) +
                             kept(from.rgb[at(from.width, 2 * x, below) + c]) +
                             kept(from.rgb[at(from.width, 2 * x + 1, below) + c]));
            }
    return to;
}

/// Looks up directions in a picture, between its pixels.
class PictureView {
public:
    explicit PictureView(const EnvironmentPicture& picture) : m_picture(picture) {}

    LinearColor toward(const Direction& d) const {
        const double turn = std::atan2(d[0], d[1]) / (2.0 * std::numbers::pi) + 0.5;
        const double drop = std::acos(std::clamp(d[2], -1.0, 1.0)) / std::numbers::pi;
        const double x = turn * m_picture.width - 0.5;
        const double y = std::clamp(drop * m_picture.height - 0.5, 0.0, m_picture.height - 1.0);
        const double left = std::floor(x);
        const auto row = static_cast<int>(y);
        const auto across = static_cast<float>(x - left);
        const auto down = static_cast<float>(y - row);
        const int below = std::min(row + 1, m_picture.height - 1);
        const auto column = static_cast<int>(left);
        return mixed(mixed(pixel(column, row), pixel(column + 1, row), across),
                     mixed(pixel(column, below), pixel(column + 1, below), across), down);
    }

private:
    static LinearColor mixed(const LinearColor& a, const LinearColor& b, float t) {
        return {a.r + t * (b.r - a.r), a.g + t * (b.g - a.g), a.b + t * (b.b - a.b)};
    }
    /// @param column  goes around
    LinearColor pixel(int column, int row) const {
        const int x = (column % m_picture.width + m_picture.width) % m_picture.width;
        const float* const rgb =
            m_picture.rgb.data() +
            3 * (static_cast<std::size_t>(row) * static_cast<std::size_t>(m_picture.width) +
                 static_cast<std::size_t>(x));
        return {kept(rgb[0]), kept(rgb[1]), kept(rgb[2])};
    }

    const EnvironmentPicture& m_picture;
};

/// The mean of two by two places of a texel.
template <class Map> LinearColor texelOf(const PictureView& view, int column, int row) {
    LinearColor sum;
    using Finer = SquareMap<2 * Map::side>;
    for (int part = 0; part < 4; ++part) {
        // The border of the finer map is half as wide.
        const TexelView at = viewOf<Finer>(2 * column - 1 + part % 2, 2 * row - 1 + part / 2);
        const LinearColor color = view.toward(at.direction);
        sum = {sum.r + color.r, sum.g + color.g, sum.b + color.b};
    }
    return {0.25F * sum.r, 0.25F * sum.g, 0.25F * sum.b};
}

std::vector<float> sharpMapOf(const EnvironmentPicture& picture) {
    using Map = PictureMap;
    std::vector<float> map(Map::floats);
    const PictureView view(picture);
    tbb::parallel_for(0, Map::stride, [&](int row) {
        for (int column = 0; column < Map::stride; ++column) {
            const LinearColor color = texelOf<Map>(view, column, row);
            float* const to = map.data() + row * Map::stride + column;
            to[0] = color.r;
            to[Map::texels] = color.g;
            to[2 * Map::texels] = color.b;
        }
    });
    return map;
}

/// The texel inside a map that a texel of its border repeats.
template <class Map> std::size_t repeated(int column, int row) {
    const auto is_beside = [](int i) { return i == 0 || i == Map::side + 1; };
    if (is_beside(column)) {
        column = std::clamp(column, 1, Map::side);
        row = Map::side + 1 - row;
    }
    if (is_beside(row)) {
        row = std::clamp(row, 1, Map::side);
        column = Map::side + 1 - column;
    }
    return static_cast<std::size_t>(std::clamp(row, 1, Map::side) * Map::stride +
                                    std::clamp(column, 1, Map::side));
}

std::vector<float> broadMapOf(const std::vector<float>& sharp) {
    constexpr int STEP = PictureMap::side / BroadMap::side;
    std::vector<float> map(BroadMap::floats);
    for (int c = 0; c < environment_map::channels; ++c) {
        float* const to = map.data() + c * BroadMap::texels;
        const float* const from = sharp.data() + c * PictureMap::texels;
        for (int row = 0; row < PictureMap::side; ++row)
            for (int column = 0; column < PictureMap::side; ++column)
                to[(row / STEP + 1) * BroadMap::stride + column / STEP + 1] +=
                    from[(row + 1) * PictureMap::stride + column + 1] / (STEP * STEP);
        for (int row = 0; row < BroadMap::stride; ++row)
            for (int column = 0; column < BroadMap::stride; ++column)
                to[row * BroadMap::stride + column] = to[repeated<BroadMap>(column, row)];
    }
    return map;
}

/// Light that is so much brighter than the rest, by the mean of logarithms, may be a sun.
constexpr double SUN_BESIDE_REST = 12.0;
/// A sun's directions differ by a few degrees: the mean of unit vectors is this long at least.
constexpr double SUN_CONCENTRATION = 0.995;
/// A sun that sheds less than this part of all the light is left in the maps.
constexpr double LEAST_PART_OF_SUN = 0.15;

} // namespace

PictureLight::PictureLight(std::shared_ptr<const EnvironmentPicture> picture)
    : m_picture(std::move(picture)) {
    if (m_picture->width > MOST_WIDTH) {
        EnvironmentPicture smaller = halved(*m_picture);
        while (smaller.width > MOST_WIDTH)
            smaller = halved(smaller);
        m_sharp = sharpMapOf(smaller);
    } else {
        m_sharp = sharpMapOf(*m_picture);
    }
    findSun();
    m_broad = broadMapOf(m_sharp);
    findMean();
}

void PictureLight::findSun() {
    const float* const map = m_sharp.data();
    const auto color_at = [&](std::size_t i) {
        return LinearColor{map[i], map[i + PictureMap::texels], map[i + 2 * PictureMap::texels]};
    };
    double logarithms = 0.0;
    double all = 0.0;
    forEachInnerTexel<PictureMap>([&](std::size_t i, const TexelView& view) {
        const double light = brightnessOf(color_at(i));
        logarithms += view.solid_angle * std::log(light + 1e-6);
        all += view.solid_angle * light;
    });
    const double most = SUN_BESIDE_REST * std::exp(logarithms / (4.0 * std::numbers::pi));
    Direction toward{};
    double sun[3] = {};
    double brightness = 0.0;
    forEachInnerTexel<PictureMap>([&](std::size_t i, const TexelView& view) {
        const LinearColor color = color_at(i);
        const double light = brightnessOf(color);
        if (light <= most)
            return;
        const double part = view.solid_angle * (1.0 - most / light);
        sun[0] += part * color.r;
        sun[1] += part * color.g;
        sun[2] += part * color.b;
        brightness += part * light;
        for (std::size_t axis = 0; axis < 3; ++axis)
            toward[axis] += part * light * view.direction[axis];
    });
    const double length = std::hypot(toward[0], toward[1], toward[2]);
    if (brightness <= LEAST_PART_OF_SUN * all || length < SUN_CONCENTRATION * brightness)
        return;
    m_has_sun = true;
    for (std::size_t i = 0; i < 3; ++i) {
        m_toward_sun[i] = static_cast<float>(toward[i] / length);
        m_sun_color[i] = static_cast<float>(sun[i] / std::numbers::pi);
    }
    for (std::size_t i = 0; i < static_cast<std::size_t>(PictureMap::texels); ++i) {
        const double light = brightnessOf(color_at(i));
        if (light > most)
            for (std::size_t c = 0; c < 3; ++c)
                m_sharp[i + c * PictureMap::texels] *= static_cast<float>(most / light);
    }
}

void PictureLight::findMean() {
    double sum = 0.0;
    forEachInnerTexel<BroadMap>([&](std::size_t i, const TexelView& view) {
        sum += view.solid_angle * brightnessOf({m_broad[i], m_broad[i + BroadMap::texels],
                                                m_broad[i + 2 * BroadMap::texels]});
    });
    m_mean = static_cast<float>(sum / (4.0 * std::numbers::pi));
}

} // namespace quarn
