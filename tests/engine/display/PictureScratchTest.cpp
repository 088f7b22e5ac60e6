#include "engine/display/PictureScratch.h"

#include "tests/support/AllocationCount.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdint>
#include <vector>

namespace quarn {
namespace {

constexpr std::size_t megabyte = 1 << 20;

TEST(PictureScratch, GivesRoomThatNoOtherHas) {
    PictureScratch scratch;
    scratch.reset();
    std::vector<std::span<std::uint32_t>> taken;
    for (std::uint32_t i = 0; i < 300; ++i) {
        taken.push_back(scratch.take<std::uint32_t>(1000 + i));
        std::fill(taken.back().begin(), taken.back().end(), i);
    }
    for (std::uint32_t i = 0; i < 300; ++i) {
        EXPECT_EQ(taken[i].size(), 1000 + i);
        EXPECT_TRUE(std::ranges::all_of(taken[i], [&](std::uint32_t v) { return v == i; }));
    }
}

TEST(PictureScratch, ZeroedRoomIsZeroAlsoWhereItWasUsedBefore) {
    PictureScratch scratch;
    for (int picture = 0; picture < 3; ++picture) {
        scratch.reset();
        const auto room = scratch.takeZeroed<float>(5000);
        EXPECT_TRUE(std::ranges::all_of(room, [](float v) { return v == 0.0F; }));
        std::ranges::fill(room, 1.0F);
    }
}

TEST(PictureScratch, HasATenthToSpareForTheNextPicture) {
    PictureScratch scratch;
    scratch.reset();
    for (int i = 0; i < 100; ++i)
        scratch.take<std::byte>(megabyte / 10);
    scratch.reset();
    const AllocationCount before = AllocationCount::now();
    for (int i = 0; i < 110; ++i)
        scratch.take<std::byte>(megabyte / 10);
    const AllocationCount after = AllocationCount::now();
    EXPECT_EQ(0U, requestsBetween(before, after));
}

TEST(PictureScratch, LetsGoOfWhatManyPicturesDidNotNeed) {
    PictureScratch scratch;
    scratch.reset();
    scratch.take<std::byte>(100 * megabyte);
    for (int i = 0; i < 40; ++i) {
        scratch.reset();
        scratch.take<std::byte>(megabyte);
    }
    EXPECT_GE(scratch.capacity(), 100 * megabyte); // it may be needed again soon
    for (int i = 0; i < 140; ++i) {
        scratch.reset();
        scratch.take<std::byte>(megabyte);
    }
    EXPECT_LE(scratch.capacity(), 3 * megabyte);
}

} // namespace
} // namespace quarn
