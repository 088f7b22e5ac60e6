#include "tests/desktop_kills/TypedWork.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdlib>
#include <random>
#include <thread>

namespace quarn::test {
namespace {

using namespace std::chrono_literals;

const std::vector<std::string> OPTIONS = {"--recovery-every", "0.5"};
/// At most the last beats are lost: three of half a second.
constexpr auto LONGEST_LOSS = 1500ms;
/// Windows at a time; they mostly wait for what is typed next.
constexpr int AT_A_TIME = 10;

/// As many as the environment says in QUARN_KILLS, for a night; else few.
int kills() {
    const char* const wanted = std::getenv("QUARN_KILLS");
    return wanted ? std::atoi(wanted) : 10;
}

/// The file is as it was saved last; where the program was killed as it saved, it may be that one.
void expectFileIsWhole(const TypedWork& work) {
    if (readFile(work.file()) == readFile(work.savedCopy()))
        return;
    EXPECT_TRUE(work.isSaving()) << "the document's own file was touched";
    EXPECT_EQ(objectsIn(work.file()), work.begun());
}

/// Everything that was done before the last beats is in the file or in what is offered.
void expectNothingIsLost(TypedWork& work, TypedWork::Clock::time_point killed_at) {
    const int kept = work.doneUntil(killed_at - LONGEST_LOSS);
    const int in_file = objectsIn(work.file()).value_or(0);
    const std::string bytes = readFile(work.file());
    const bool is_recoverable = work.isRecoverable();
    const Ended again = work.recover(OPTIONS);
    EXPECT_EQ(again.exit_code, 0) << again.err;
    EXPECT_EQ(work.wasOffered(), is_recoverable);
    EXPECT_EQ(readFile(work.file()), bytes);
    const int offered = work.wasOffered() ? objectsIn(work.recovered()).value_or(-1) : in_file;
    EXPECT_GE(offered, kept);
    EXPECT_GE(offered, in_file) << "what is offered is older than the file and does not say so";
    EXPECT_LE(offered, work.begun());
}

/// A window, and when it is killed: at that moment, or at the next when unsaved work is kept. Each
/// save lets go what was kept, so that at a random moment there often is nothing.
struct Life {
    std::unique_ptr<TypedWork> work = std::make_unique<TypedWork>();
    TypedWork::Clock::time_point end;
    bool ends_at_once = true;
};

std::vector<Life> begin(int count, std::mt19937& random) {
    std::uniform_int_distribution<int> life_ms(100, 2500);
    std::vector<Life> lives(static_cast<std::size_t>(count));
    for (Life& life : lives) {
        life.work->begin(OPTIONS);
        life.end = TypedWork::Clock::now() + std::chrono::milliseconds(life_ms(random));
    }
    for (std::size_t i = 0; i < lives.size(); i += 2)
        lives[i].ends_at_once = false;
    std::ranges::sort(lives, {}, &Life::end);
    return lives;
}

void kill(std::vector<Life>& lives) {
    for (Life& life : lives) {
        std::this_thread::sleep_until(life.end);
        EXPECT_TRUE(life.ends_at_once || life.work->holdWhereUnsavedWorkIsKept());
        life.end = TypedWork::Clock::now();
        life.work->kill();
    }
}

TEST(KilledWindow, LosesAtMostTheLastBeatsAndNeverTheFile) {
    std::mt19937 random(20260621);
    int times_offered = 0;
    for (int left = kills(); left > 0; left -= AT_A_TIME) {
        std::vector<Life> lives = begin(std::min(left, AT_A_TIME), random);
        kill(lives);
        for (Life& life : lives) {
            expectFileIsWhole(*life.work);
            expectNothingIsLost(*life.work, life.end);
            times_offered += life.work->wasOffered();
        }
    }
    EXPECT_GE(times_offered, kills() / 2) << "hardly anything was unsaved when it was killed";
}

} // namespace
} // namespace quarn::test
