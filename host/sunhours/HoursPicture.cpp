#include "host/sunhours/HoursPicture.h"

#include "host/sunhours/HourColors.h"
#include "host/sunhours/TextPainter.h"

#include <cmath>

namespace quarn {

namespace {

constexpr KM_Color PAPER{255, 255, 255, 255};
constexpr double BORDER_SHARE = 0.45; ///< where another object begins
constexpr double CREASE_SHARE = 0.2;
constexpr double ISOLINE_SHARE = 0.85;
/// The cosine between faces below which there is an edge.
constexpr float EDGE_COSINE = 0.9F;
/// Lines of equal hours go by means over so many pixels to each side: the sun's steps would make
/// them jagged. Where less than this share of these pixels show the same face there are none.
constexpr int ISOLINE_REACH = 4;
constexpr double ISOLINE_SURROUNDINGS = 0.7;
/// Around a whole number of lines means of even places would flicker.
constexpr double ISOLINE_DIGITS = 0.02;

/// Four places of a pixel, no two in a row or column.
constexpr int SAMPLES = 4;
constexpr PicturePlace SAMPLE_PLACES[SAMPLES] = {
    {0.375F, 0.125F}, {0.875F, 0.375F}, {0.125F, 0.625F}, {0.625F, 0.875F}};

struct Pixel {
    int x;
    int y;
};

class Colouring {
public:
    Colouring(const SunHoursRequest& request, const SunMoments& moments, const SunHoursMap& map)
        : m_request(request), m_map(map), m_end(endOfScale(moments.hours)) {}

    Image plain() const {
        Image image;
        image.resize(m_map.width_px, m_map.height_px);
        std::ranges::fill(image.rgba, std::uint8_t{255});
        for (int y = 0; y < image.height; ++y)
            for (int x = 0; x < image.width; ++x)
                cover(image, x, y, colorOf(m_map.object(x, y), m_map.hours(x, y)), 1.0);
        return image;
    }

    /// Pixels that a border goes through: they or a neighbour show something else.
    std::vector<Pixel> borders() const {
        std::vector<Pixel> found;
        for (int y = 0; y < m_map.height_px; ++y)
            for (int x = 0; x < m_map.width_px; ++x)
                if (isBorder(x, y, x + 1, y) || isBorder(x, y, x, y + 1) ||
                    isBorder(x, y, x - 1, y) || isBorder(x, y, x, y - 1))
                    found.push_back({x, y});
        return found;
    }

    void smooth(Image& image, const std::vector<Pixel>& pixels, const PicturePoints& seen,
                const SunLight& light) const {
        for (std::size_t p = 0; p < pixels.size(); ++p) {
            double sums[3] = {0, 0, 0};
            for (std::size_t i = SAMPLES * p; i < SAMPLES * (p + 1); ++i) {
                const KM_Color color = colorOf(seen.object[i], light.hours[i]);
                sums[0] += color.r;
                sums[1] += color.g;
                sums[2] += color.b;
            }
            const auto mean = [&](int c) {
                return static_cast<unsigned char>(std::lround(sums[c] / SAMPLES));
            };
            cover(image, pixels[p].x, pixels[p].y, {mean(0), mean(1), mean(2), 255}, 1.0);
        }
    }

    void drawLines(Image& image) const {
        const std::vector<double> bands = isolineBands();
        for (int y = 0; y < image.height; ++y)
            for (int x = 0; x < image.width; ++x) {
                if (isBorder(x, y, x + 1, y) || isBorder(x, y, x, y + 1))
                    cover(image, x, y, SHEET_INK, isCrease(x, y) ? CREASE_SHARE : BORDER_SHARE);
                else if (!bands.empty() &&
                         (isIsoline(bands, x, y, x + 1, y) || isIsoline(bands, x, y, x, y + 1)))
                    cover(image, x, y, PAPER, ISOLINE_SHARE);
            }
    }

private:
    KM_Color colorOf(std::uint32_t object, float hours) const {
        return object == 0 ? PAPER : viridis(double{hours} / m_end);
    }

    bool isInside(int x, int y) const {
        return x >= 0 && y >= 0 && x < m_map.width_px && y < m_map.height_px;
    }

    float cosineOfFaces(std::size_t a, std::size_t b) const {
        const auto& packets = m_map.seen.points.packets();
        float cosine = 0.0F;
        for (int axis = 0; axis < 3; ++axis)
            cosine += packets[a / points_at_once].face[axis][a % points_at_once] *
                      packets[b / points_at_once].face[axis][b % points_at_once];
        return cosine;
    }

    bool isBorder(int ax, int ay, int bx, int by) const {
        if (!isInside(bx, by))
            return false;
        const std::size_t a = m_map.tiles.indexOf(ax, ay);
        const std::size_t b = m_map.tiles.indexOf(bx, by);
        if (m_map.seen.object[a] != m_map.seen.object[b])
            return true;
        return m_map.seen.object[a] != 0 && cosineOfFaces(a, b) < EDGE_COSINE;
    }

    /// Whether the border beside a pixel lies within one object.
    bool isCrease(int x, int y) const {
        return m_map.object(x, y) == m_map.object(std::min(x + 1, m_map.width_px - 1), y) &&
               m_map.object(x, y) == m_map.object(x, std::min(y + 1, m_map.height_px - 1));
    }

    /// Between which lines of equal hours each pixel lies; negative where there are to be none.
    std::vector<double> isolineBands() const {
        std::vector<double> bands;
        if (m_request.isoline_hours <= 0.0)
            return bands;
        for (int y = 0; y < m_map.height_px; ++y)
            for (int x = 0; x < m_map.width_px; ++x)
                bands.push_back(bandOf(x, y));
        return bands;
    }

    double bandOf(int x, int y) const {
        constexpr int ALL = (2 * ISOLINE_REACH + 1) * (2 * ISOLINE_REACH + 1);
        double sum = 0.0;
        int same = 0;
        for (int j = y - ISOLINE_REACH; j <= y + ISOLINE_REACH; ++j)
            for (int i = x - ISOLINE_REACH; i <= x + ISOLINE_REACH; ++i)
                if (isInside(i, j) && m_map.object(i, j) != 0 && !isBorder(x, y, i, j)) {
                    sum += double{m_map.hours(i, j)};
                    ++same;
                }
        if (m_map.object(x, y) == 0 || same < ISOLINE_SURROUNDINGS * ALL)
            return -1.0;
        return std::floor((sum / same + ISOLINE_DIGITS) / m_request.isoline_hours);
    }

    bool isIsoline(const std::vector<double>& bands, int ax, int ay, int bx, int by) const {
        if (!isInside(bx, by))
            return false;
        const auto band = [&](int x, int y) {
            return bands[static_cast<std::size_t>(y) * static_cast<std::size_t>(m_map.width_px) +
                         static_cast<std::size_t>(x)];
        };
        return band(ax, ay) >= 0.0 && band(bx, by) >= 0.0 && band(ax, ay) != band(bx, by);
    }

    const SunHoursRequest& m_request;
    const SunHoursMap& m_map;
    double m_end;
};

} // namespace

std::optional<Image> colouredMap(const DisplayScene& scene, const KM_Viewport& viewport,
                                 const SunHoursRequest& request, const SunMoments& moments,
                                 const SunHoursMap& map, const SunWatch& watch) {
    const Colouring colouring(request, moments, map);
    const std::vector<Pixel> borders = colouring.borders();
    std::vector<PicturePlace> places;
    for (const Pixel& pixel : borders)
        for (const PicturePlace& place : SAMPLE_PLACES)
            places.push_back(
                {static_cast<float>(pixel.x) + place.x, static_cast<float>(pixel.y) + place.y});
    const PicturePoints seen =
        pointsSeen(scene, viewport, request.width_px, request.height_px, places);
    SunLight light;
    if (!findSun(scene, seen.points, stepsOf(moments), false, watch, light))
        return std::nullopt;
    Image image = colouring.plain();
    colouring.smooth(image, borders, seen, light);
    colouring.drawLines(image);
    return image;
}

} // namespace quarn
