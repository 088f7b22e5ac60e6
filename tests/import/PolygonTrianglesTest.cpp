#include "import/assembly/PolygonTriangles.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <numbers>
#include <random>

namespace quarn {
namespace {

using Corners = std::vector<KM_3dPoint>;

/// The areas of the triangles, of which one that turns against the polygon counts negative.
double areaOf(const Corners& corners, const KM_3dVector& normal) {
    PolygonTriangles polygon;
    double area = 0.0;
    for (const auto& [a, b, c] : polygon.cut(corners)) {
        const double part =
            0.5 * (KM_CrossProduct(corners[b] - corners[a], corners[c] - corners[a]) * normal);
        EXPECT_GE(part, -1e-12);
        area += std::abs(part);
    }
    return area;
}

TEST(PolygonTriangles, AConvexPolygonIsCutFromItsFirstCorner) {
    PolygonTriangles polygon;
    const auto triangles = polygon.cut(Corners{{0, 0, 0}, {1, 0, 0}, {1, 1, 0}, {0, 1, 0}});
    ASSERT_EQ(triangles.size(), 2U);
    EXPECT_EQ(triangles[0], (PolygonTriangles::Triangle{0, 1, 2}));
    EXPECT_EQ(triangles[1], (PolygonTriangles::Triangle{0, 2, 3}));
}

TEST(PolygonTriangles, NothingOutsideOfAConcaveOutlineIsCovered) {
    // An arrow: a square of 4 by 4 without the triangle between its upper corners and (2, 1).
    const Corners arrow{{0, 0, 0}, {4, 0, 0}, {4, 4, 0}, {2, 1, 0}, {0, 4, 0}};
    for (std::size_t first = 0; first < arrow.size(); ++first) {
        Corners turned(arrow.begin() + static_cast<std::ptrdiff_t>(first), arrow.end());
        turned.insert(turned.end(), arrow.begin(),
                      arrow.begin() + static_cast<std::ptrdiff_t>(first));
        EXPECT_DOUBLE_EQ(areaOf(turned, KM_3dVector::ZAxis), 10.0) << first;
        const Corners reversed(turned.rbegin(), turned.rend());
        EXPECT_DOUBLE_EQ(areaOf(reversed, -1.0 * KM_3dVector::ZAxis), 10.0) << first;
    }
}

TEST(PolygonTriangles, AHoleThatHangsOnItsOutlineStaysOpen) {
    // A square of 4 by 4 with a hole of 2 by 2; the edge from corner 0 to the hole is taken twice.
    const Corners ring{{0, 0, 0}, {4, 0, 0}, {4, 4, 0}, {0, 4, 0}, {0, 0, 0},
                       {1, 1, 0}, {1, 3, 0}, {3, 3, 0}, {3, 1, 0}, {1, 1, 0}};
    EXPECT_DOUBLE_EQ(areaOf(ring, KM_3dVector::ZAxis), 12.0);
}

TEST(PolygonTriangles, OutlinesOfAnyPlaneAreFilledExactly) {
    std::mt19937 random(7);
    std::uniform_real_distribution<double> radius(0.2, 2.0);
    for (int round = 0; round < 100; ++round) {
        // A star around the origin has the area of its sectors, whatever their radii.
        const int count = 4 + round % 40;
        std::vector<double> x;
        std::vector<double> y;
        double area = 0.0;
        for (int i = 0; i < count; ++i) {
            const double angle = 2.0 * std::numbers::pi * i / count;
            const double r = radius(random);
            x.push_back(r * std::cos(angle));
            y.push_back(r * std::sin(angle));
        }
        for (std::size_t i = 0; i < x.size(); ++i) {
            const std::size_t next = (i + 1) % x.size();
            area += 0.5 * (x[i] * y[next] - x[next] * y[i]);
        }
        const KM_3dVector planes[3][2] = {{KM_3dVector::XAxis, KM_3dVector::YAxis},
                                          {KM_3dVector::YAxis, KM_3dVector::ZAxis},
                                          {KM_3dVector::XAxis, KM_3dVector::ZAxis}};
        for (const auto& [u, v] : planes) {
            Corners corners;
            for (std::size_t i = 0; i < x.size(); ++i)
                corners.push_back(KM_3dPoint(1, 2, 3) + x[i] * u + y[i] * v);
            EXPECT_NEAR(areaOf(corners, KM_CrossProduct(u, v)), area, 1e-9);
        }
    }
}

/// A ribbon, wound up: its outline runs out along one side and back along the other.
Corners ribbon(int corners, double turns) {
    Corners outline;
    for (int i = 0; i < corners; ++i) {
        const bool is_back = i >= corners / 2;
        const int step = is_back ? corners - 1 - i : i;
        const double angle = 2.0 * std::numbers::pi * turns * step / (corners / 2);
        const double radius = 3.0 + angle + (is_back ? -1.5 : 0.0);
        outline.emplace_back(radius * std::cos(angle), radius * std::sin(angle), 0.0);
    }
    return outline;
}

double areaOfOutline(const Corners& outline) {
    double area = 0.0;
    for (std::size_t i = 0; i < outline.size(); ++i) {
        const KM_3dPoint& a = outline[i];
        const KM_3dPoint& b = outline[(i + 1) % outline.size()];
        area += 0.5 * (a.x * b.y - a.y * b.x);
    }
    return std::abs(area);
}

TEST(PolygonTriangles, OutlinesOfManyCornersAreFilledExactlyToo) {
    std::mt19937 random(5);
    std::uniform_real_distribution<double> radius(0.3, 1.0);
    Corners star;
    for (int i = 0; i < 20'000; ++i) {
        const double angle = 2.0 * std::numbers::pi * i / 20'000;
        const double r = radius(random);
        star.emplace_back(r * std::cos(angle), r * std::sin(angle), 0.0);
    }
    EXPECT_NEAR(areaOf(star, KM_3dVector::ZAxis), areaOfOutline(star), 1e-9);
    const Corners wound = ribbon(20'000, 2.0);
    EXPECT_NEAR(areaOf(wound, KM_3dVector::ZAxis), areaOfOutline(wound), 1e-6);
}

TEST(PolygonTriangles, AnyCornersGiveTwoTrianglesLessThanTheyAre) {
    std::mt19937 random(3);
    const double numbers[] = {0,
                              0,
                              1,
                              2,
                              -1,
                              1e300,
                              std::numeric_limits<double>::quiet_NaN(),
                              std::numeric_limits<double>::infinity()};
    std::uniform_int_distribution<std::size_t> any(0, 7);
    PolygonTriangles polygon;
    for (int round = 0; round < 2000; ++round) {
        Corners corners;
        for (int i = 0; i < round % 30; ++i)
            corners.emplace_back(numbers[any(random)], numbers[any(random)], numbers[any(random)]);
        const auto triangles = polygon.cut(corners);
        EXPECT_EQ(triangles.size(), corners.size() < 3 ? 0 : corners.size() - 2);
        for (const auto& triangle : triangles)
            for (const std::uint32_t corner : triangle)
                EXPECT_LT(corner, corners.size());
    }
}

} // namespace
} // namespace quarn
