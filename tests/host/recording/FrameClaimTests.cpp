#include "host/recording/FrameClaim.h"

#include "tests/support/TempFolder.h"

#include <atomic>
#include <gtest/gtest.h>
#include <thread>

namespace quarn::test {
namespace {

class Claims : public testing::Test {
protected:
    FrameClaim::Claimer claimer(const std::string& name) {
        return {folder / (name + ".journal"),
                [this](const std::string& journal) { return journal == living + ".journal"; }};
    }

    const TempFolder folder;
    const std::filesystem::path file = folder / "house003.claim";
    std::string living;
};

TEST_F(Claims, KeepOthersOutAsLongAsTheirMakerLives) {
    living = "a";
    auto first = FrameClaim::take(file, claimer("a"));
    ASSERT_TRUE(first);
    EXPECT_FALSE(FrameClaim::take(file, claimer("b")));
    EXPECT_EQ(readFile(file), "a.journal");
    living.clear();
    const auto second = FrameClaim::take(file, claimer("b"));
    ASSERT_TRUE(second);
    EXPECT_EQ(readFile(file), "b.journal");
    first.reset();
    EXPECT_EQ(readFile(file), "b.journal") << "it is another one's now";
}

TEST_F(Claims, GoWithWhoHasThem) {
    FrameClaim::take(file, claimer("a"));
    EXPECT_TRUE(std::filesystem::is_empty(folder.path()));
}

TEST_F(Claims, OnADiskThatTakesNoneKeepNobodyOut) {
    EXPECT_TRUE(FrameClaim::take(folder / "gone" / "house003.claim", claimer("a")));
}

TEST_F(Claims, OfTheDeadAreTakenByOneOfMany) {
    constexpr int THREADS = 8;
    for (int round = 0; round < 50; ++round) {
        writeFile(file, "dead.journal");
        std::atomic<int> holders{0};
        std::atomic<int> most{0};
        std::vector<std::thread> threads;
        for (int i = 0; i < THREADS; ++i)
            threads.emplace_back([&, i] {
                const std::string own = std::to_string(i);
                const FrameClaim::Claimer all_live{
                    folder / (own + ".journal"),
                    [](const std::string& journal) { return journal != "dead.journal"; }};
                if (const auto claim = FrameClaim::take(file, all_live)) {
                    most = std::max(most.load(), ++holders);
                    std::this_thread::sleep_for(std::chrono::milliseconds(1));
                    --holders;
                }
            });
        for (std::thread& thread : threads)
            thread.join();
        EXPECT_EQ(most, 1);
    }
    EXPECT_FALSE(std::filesystem::exists(file));
}

TEST_F(Claims, ThatNameNobodyYetAreBeingMade) {
    writeFile(file, "");
    EXPECT_FALSE(FrameClaim::take(file, claimer("a")));
}

TEST_F(Claims, OfTheDeadAreTakenAfterOneWhoWasKilledWhileTakingThem) {
    writeFile(file, "dead.journal");
    writeFile(folder / "a.journal", "");
    std::filesystem::create_hard_link(file, file.string() + ".dead");
    EXPECT_FALSE(FrameClaim::take(file, claimer("a"))) << "another one is just about to";
    EXPECT_TRUE(std::filesystem::exists(file));
}

} // namespace
} // namespace quarn::test
