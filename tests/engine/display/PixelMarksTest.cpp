#include "engine/display/PixelMarks.h"
#include "engine/display/SurfaceLook.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <vector>

namespace quarn {
namespace {

constexpr std::uint32_t grey = 0xFF808080U;
constexpr int block_height = 32;

/// A picture of one grey object, in blocks.
class PixelMarksTest : public testing::TestWithParam<const RayKernel*> {
protected:
    void paint(int width, int height) {
        m_pixels.assign(static_cast<std::size_t>(width) * static_cast<std::size_t>(height), grey);
        m_objects.assign(m_pixels.size(), 1);
        m_frame.width = width;
        m_frame.height = height;
        m_frame.pixels = m_pixels.data();
        m_frame.objects = m_objects.data();
    }
    std::uint32_t& pixel(int x, int y) { return m_pixels[at(x, y)]; }
    std::uint32_t& object(int x, int y) { return m_objects[at(x, y)]; }
    /// Object 1 becomes a mirror, object 2 not.
    void makeMirror() {
        m_mirror.shows_scene = true;
        m_surfaces[0].look = &m_mirror;
        m_frame.surfaces = m_surfaces.data();
        m_frame.mirrors_scene = true;
    }

    /// What is marked, row by row.
    std::vector<std::pair<int, int>> marked() {
        PixelMarks marks;
        marks.resize(m_frame.width, m_frame.height);
        forEachBlock([&](const PixelBlock& b) { marks.markInside(m_frame, *GetParam(), b); });
        forEachBlock([&](const PixelBlock& b) { marks.markAcross(m_frame, *GetParam(), b); });
        std::vector<std::pair<int, int>> found;
        forEachBlock([&](const PixelBlock& b) {
            marks.forEach(b, [&](int x, int y) { found.emplace_back(y, x); });
        });
        std::ranges::sort(found);
        for (auto& [first, second] : found)
            std::swap(first, second);
        return found;
    }
    using Places = std::vector<std::pair<int, int>>;

private:
    std::size_t at(int x, int y) const {
        return static_cast<std::size_t>(y) * static_cast<std::size_t>(m_frame.width) +
               static_cast<std::size_t>(x);
    }
    template <class Function> void forEachBlock(const Function& function) const {
        for (int y = 0; y < m_frame.height; y += block_height)
            for (int x = 0; x < m_frame.width; x += PixelMarks::block_width)
                function(PixelBlock{x, y, std::min(m_frame.width, x + PixelMarks::block_width),
                                    std::min(m_frame.height, y + block_height)});
    }

    std::vector<std::uint32_t> m_pixels;
    std::vector<std::uint32_t> m_objects;
    SurfaceLook m_mirror;
    std::array<RaySurface, 2> m_surfaces{};
    FrameSetup m_frame;
};

TEST_P(PixelMarksTest, APixelOfAnotherColourIsMarkedWithItsFourNeighbours) {
    paint(100, 50);
    pixel(20, 10) = 0xFF8080A0U;
    EXPECT_EQ(marked(), (Places{{20, 9}, {19, 10}, {20, 10}, {21, 10}, {20, 11}}));
}

TEST_P(PixelMarksTest, AStepOfColourCountsFromFifteenOn) {
    paint(100, 50);
    pixel(20, 10) = grey + 14;
    pixel(40, 10) = grey - (14U << 16);
    EXPECT_EQ(marked(), Places{});
    pixel(20, 10) = grey + 15;
    pixel(40, 10) = grey - (15U << 16);
    EXPECT_EQ(marked().size(), 10U);
}

TEST_P(PixelMarksTest, WithinAMirrorAStepCountsFromTwentyFiveOn) {
    paint(99, 50);
    makeMirror();
    pixel(20, 10) = grey + 24;
    pixel(97, 10) = grey - (24U << 16);
    EXPECT_EQ(marked(), Places{});
    pixel(20, 10) = grey + 25;
    pixel(97, 10) = grey - (25U << 16);
    EXPECT_EQ(marked().size(), 10U);
}

TEST_P(PixelMarksTest, BesideAMirrorStepsCountAsEverywhere) {
    paint(100, 50);
    makeMirror();
    object(20, 10) = 2;
    object(40, 10) = 0;
    EXPECT_EQ(marked().size(), 10U);
    paint(100, 50);
    for (int y = 0; y < 50; ++y)
        for (int x = 0; x < 100; ++x)
            object(x, y) = x < 60 ? 2 : 0;
    pixel(20, 10) = grey + 15;
    pixel(80, 10) = grey + 15;
    EXPECT_EQ(marked().size(), 10U + 100U);
}

TEST_P(PixelMarksTest, AnotherObjectOfTheSameColourIsAnEdge) {
    paint(100, 50);
    object(70, 20) = 2;
    EXPECT_EQ(marked(), (Places{{70, 19}, {69, 20}, {70, 20}, {71, 20}, {70, 21}}));
}

TEST_P(PixelMarksTest, AnEdgeBetweenTwoBlocksIsMarkedOnBothSides) {
    paint(130, 64);
    pixel(63, 31) = 0xFF000000U; // the last of its block both ways
    EXPECT_EQ(marked(), (Places{{63, 30}, {62, 31}, {63, 31}, {64, 31}, {63, 32}}));
    paint(130, 64);
    pixel(64, 32) = 0xFF000000U;
    EXPECT_EQ(marked(), (Places{{64, 31}, {63, 32}, {64, 32}, {65, 32}, {64, 33}}));
}

TEST_P(PixelMarksTest, TheEndsOfOneRowAndTheNextAreNoNeighbours) {
    paint(67, 3);
    pixel(66, 0) = 0xFF000000U;
    EXPECT_EQ(marked(), (Places{{65, 0}, {66, 0}, {66, 1}}));
    pixel(66, 0) = grey;
    pixel(0, 1) = 0xFF000000U;
    EXPECT_EQ(marked(), (Places{{0, 0}, {0, 1}, {1, 1}, {0, 2}}));
}

TEST_P(PixelMarksTest, APictureOfOnePixelHasNoEdge) {
    paint(1, 1);
    EXPECT_EQ(marked(), Places{});
}

TEST_P(PixelMarksTest, PicturesOfAnyWidthAreLookedAtWhole) {
    for (int width = 1; width < 140; ++width) {
        paint(width, 2);
        for (int x = 0; x < width; ++x)
            pixel(x, 1) = 0xFF000000U;
        EXPECT_EQ(marked().size(), 2U * static_cast<unsigned>(width)) << width;
    }
}

std::vector<const RayKernel*> kernelsOfThisProcessor() {
    std::vector<const RayKernel*> kernels{&baseline_ray_kernel};
    for (const RayKernel* kernel : {&avx2_ray_kernel, &avx512_ray_kernel}) {
        if (kernels.back() == &rayKernelInForce())
            break;
        kernels.push_back(kernel);
    }
    return kernels;
}

INSTANTIATE_TEST_SUITE_P(Kernels, PixelMarksTest, testing::ValuesIn(kernelsOfThisProcessor()),
                         [](const auto& kernel) { return std::string(kernel.param->name); });

} // namespace
} // namespace quarn
