#include "engine/display/DisplayPipeline.h"
#include "engine/display/DisplayScene.h"
#include "engine/display/InstructionSet.h"
#include "host/front_end/ScriptedFrontEnd.h"
#include "host/session/InstructionSets.h"
#include "host/session/Session.h"
#include "tests/engine/display/DisplayFixture.h"

#include <filesystem>
#include <fstream>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <map>
#include <thread>

namespace quarn::test {
namespace {

using testing::HasSubstr;
using testing::StartsWith;

SessionOptions withInstructions(const std::string& name) {
    SessionOptions options;
    options.instructions = name;
    return options;
}

SessionOptions withThreads(int most_threads) {
    SessionOptions options;
    options.most_threads = most_threads;
    return options;
}

/// For how many nanoseconds each thread of this process has run.
std::map<std::string, std::uint64_t> workOfThreads() {
    std::map<std::string, std::uint64_t> work;
    for (const auto& thread : std::filesystem::directory_iterator("/proc/self/task"))
        std::ifstream(thread.path() / "schedstat") >> work[thread.path().filename()];
    return work;
}

/// How many threads do something worth telling while a scene is built and drawn.
int threadsThatDraw() {
    constexpr std::uint64_t WORTH_TELLING_NS = 2'000'000;
    SceneContent content;
    addMesh(content, hillMesh(400));
    auto before = workOfThreads();
    drawn(content, perspectiveView({-30.0, -60.0, 30.0}, {0.0, 0.0, 0.0}),
          modeNamed(L"Rendered", 2), 1200, 800);
    int threads = 0;
    for (const auto& [thread, work_ns] : workOfThreads())
        threads += work_ns - before[thread] > WORTH_TELLING_NS ? 1 : 0;
    return threads;
}

} // namespace

TEST(InstructionsOfASession, AreThoseThatItsOptionsName) {
    for (const std::string& name : instructionSets()) {
        ScriptedFrontEnd front_end;
        const Session session(front_end, withInstructions(name));
        EXPECT_EQ(nameOf(instructionSetInForce()), name);
        EXPECT_EQ(front_end.printed(), L"");
    }
    EXPECT_EQ(instructionSetInForce(), setsOfProcessor().front()) << "no session runs any more";
    ScriptedFrontEnd front_end;
    const Session session(front_end, SessionOptions{});
    EXPECT_EQ(instructionSetInForce(), setsOfProcessor().front());
}

TEST(InstructionsOfASession, AreTheFastestAndThatIsToldWhereANameIsRefused) {
    ScriptedFrontEnd front_end;
    const Session session(front_end, withInstructions("avx9"));
    EXPECT_EQ(instructionSetInForce(), setsOfProcessor().front());
    EXPECT_THAT(KM_wString(front_end.printed().c_str()).ToUtf8(),
                StartsWith("\"avx9\" is no instruction set"));
}

TEST(InstructionsOfASession, AreRefusedWithThoseThatTheProcessorHas) {
    EXPECT_EQ(whyInstructionsAreRefused("avx2", {"avx2", "sse2"}), std::nullopt);
    EXPECT_EQ(whyInstructionsAreRefused("avx512", {"avx2", "sse2"}),
              "\"avx512\" is no instruction set that pictures can be drawn with on this processor, "
              "which has avx2 and sse2.");
    EXPECT_THAT(*whyInstructionsAreRefused("", {"avx512", "avx2", "sse2"}),
                HasSubstr("avx512, avx2 and sse2"));
    for (const std::string& name : instructionSets())
        EXPECT_EQ(whyInstructionsAreRefused(name), std::nullopt);
}

TEST(ThreadsOfASession, AreNoMoreThanItsOptionsAllow) {
    ScriptedFrontEnd front_end;
    {
        const Session session(front_end, withThreads(1));
        EXPECT_EQ(threadsThatDraw(), 1);
    }
    const Session session(front_end, withThreads(2));
    EXPECT_EQ(threadsThatDraw(), std::min(2U, std::thread::hardware_concurrency()));
}

} // namespace quarn::test
