#include "engine/display/InstructionSet.h"

#include "engine/display/RayLibrary.h"
#include "tests/engine/render/RenderFixture.h"

#include <tbb/global_control.h>
#include <tbb/task_arena.h>

#include <algorithm>
#include <functional>

namespace quarn {
namespace {

/// Each set that this processor has, in force while the test runs.
class ChosenInstructions : public testing::TestWithParam<InstructionSet> {
protected:
    ChosenInstructions() { chooseInstructionSet(GetParam()); }
    ~ChosenInstructions() override { chooseInstructionSet(std::nullopt); }

    /// Whether the ray library follows so many rays at once with single instructions.
    static bool followsAtOnce(RTCDeviceProperty native_rays) {
        std::string why;
        const std::shared_ptr<RayLibrary> library = RayLibrary::start(why);
        EXPECT_TRUE(library) << why;
        return library && rtcGetDeviceProperty(library->device(), native_rays) != 0;
    }
};

/// Hills with curved, see-through and textured neighbours: what differs between sets shows there.
SceneContent garden() {
    SceneContent content;
    addMesh(content, hillMesh(40), {150, 170, 120, 255});
    addMesh(content, sphereMesh({0.0, 0.0, 8.0}, 6.0F, 20), {200, 60, 40, 255});
    addPane(content, boxMesh({10.0, 10.0, 0.0}, {14.0, 14.0, 12.0}), {90, 170, 120, 110});
    content.lights.push_back(sunLight({0.5, 0.6, -0.7}));
    return content;
}

KM_Viewport fromTheHills() {
    return perspectiveView({-30.0, -60.0, 30.0}, {0.0, 0.0, 0.0});
}

/// A drawn and a rendered picture of a scene that is built for them.
std::vector<std::uint8_t> picturesBy(int threads) {
    const tbb::global_control limit(tbb::global_control::max_allowed_parallelism,
                                    static_cast<std::size_t>(std::max(threads, 2)));
    tbb::task_arena arena(threads);
    std::vector<std::uint8_t> bytes;
    arena.execute([&] {
        const Image image = drawn(garden(), fromTheHills(), modeNamed(L"Rendered", 2), 203, 117);
        bytes = image.rgba;
        const Image render = rendered(garden(), fromTheHills(), {120, 70, 8});
        bytes.insert(bytes.end(), render.rgba.begin(), render.rgba.end());
    });
    return bytes;
}

} // namespace

TEST(InstructionSets, AreThoseOfTheProcessorTheFastestFirst) {
    const std::vector<InstructionSet> sets = setsOfProcessor();
    ASSERT_FALSE(sets.empty());
    EXPECT_EQ(sets.back(), InstructionSet::sse2) << "every processor that runs this has it";
    EXPECT_TRUE(std::ranges::is_sorted(sets, std::greater()));
}

TEST(InstructionSets, TheFastestIsInForceWhereNoneWasChosen) {
    EXPECT_EQ(instructionSetInForce(), setsOfProcessor().front());
    chooseInstructionSet(InstructionSet::sse2);
    EXPECT_EQ(instructionSetInForce(), InstructionSet::sse2);
    chooseInstructionSet(std::nullopt);
    EXPECT_EQ(instructionSetInForce(), setsOfProcessor().front());
}

TEST_P(ChosenInstructions, DrawAndRender) {
    EXPECT_EQ(instructionSetInForce(), GetParam());
    const bool is_wide = GetParam() == InstructionSet::avx512;
    const bool is_narrow = GetParam() == InstructionSet::sse2;
    const RayKernel& ray_kernel = is_wide     ? avx512_ray_kernel
                                  : is_narrow ? baseline_ray_kernel
                                              : avx2_ray_kernel;
    const RenderKernel& render_kernel = is_wide     ? avx512_render_kernel
                                        : is_narrow ? baseline_render_kernel
                                                    : avx2_render_kernel;
    EXPECT_EQ(&rayKernelInForce(), &ray_kernel);
    EXPECT_EQ(&renderKernelInForce(), &render_kernel);
}

TEST_P(ChosenInstructions, FollowTheRays) {
    EXPECT_TRUE(followsAtOnce(RTC_DEVICE_PROPERTY_NATIVE_RAY4_SUPPORTED));
    EXPECT_EQ(followsAtOnce(RTC_DEVICE_PROPERTY_NATIVE_RAY8_SUPPORTED),
              GetParam() != InstructionSet::sse2);
    EXPECT_EQ(followsAtOnce(RTC_DEVICE_PROPERTY_NATIVE_RAY16_SUPPORTED),
              GetParam() == InstructionSet::avx512);
}

TEST_P(ChosenInstructions, MakeTheSamePicturesEveryTimeAndWithAnyNumberOfThreads) {
    const std::vector<std::uint8_t> once = picturesBy(1);
    EXPECT_TRUE(once == picturesBy(1));
    EXPECT_TRUE(once == picturesBy(2));
    EXPECT_TRUE(once == picturesBy(7));
}

TEST_P(ChosenInstructions, DifferFromTheFastestInFewPixels) {
    const std::vector<std::uint8_t> own = picturesBy(2);
    chooseInstructionSet(std::nullopt);
    const std::vector<std::uint8_t> fastest = picturesBy(2);
    ASSERT_EQ(own.size(), fastest.size());
    std::size_t differing = 0;
    for (std::size_t i = 0; i < own.size(); ++i)
        differing += own[i] != fastest[i] ? 1 : 0;
    EXPECT_LT(static_cast<double>(differing), 0.001 * static_cast<double>(own.size()));
}

INSTANTIATE_TEST_SUITE_P(OfThisProcessor, ChosenInstructions, testing::ValuesIn(setsOfProcessor()),
                         [](const auto& set) { return std::string(nameOf(set.param)); });

} // namespace quarn
