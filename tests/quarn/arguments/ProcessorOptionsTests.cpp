#include "host/session/InstructionSets.h"
#include "tests/quarn/Pictures.h"
#include "tests/quarn/Studio.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::IsEmpty;
using testing::StartsWith;

class ProcessorOptions : public testing::Test {
protected:
    /// The pictures of a turntable with further options.
    std::vector<std::string> picturesWith(std::vector<std::string> options,
                                          const std::string& out) const {
        options.insert(options.end(), {"--out", out, "--format", "png"});
        const Ended ended = run(m_studio.turntable(2, options));
        EXPECT_EQ(ended.exit_code, 0) << ended.err;
        return {readFile(m_studio / out / "house000.png"),
                readFile(m_studio / out / "house001.png")};
    }
    std::string refusalOf(const std::vector<std::string>& options) const {
        const Ended ended = run(m_studio.turntable(2, options));
        EXPECT_EQ(ended.exit_code, 2) << options.back();
        EXPECT_FALSE(std::filesystem::exists(m_studio / "out"));
        return ended.err;
    }

    const Studio m_studio;
};

} // namespace

TEST_F(ProcessorOptions, NumbersOfThreadsAreFrom1To1024) {
    for (const char* const none : {"0", "-1", "1025", "1.5", "all", ""})
        EXPECT_THAT(refusalOf({"--threads", none}),
                    StartsWith("quarn: --threads must be a whole number of threads from 1 to 1024"))
            << none;
}

TEST_F(ProcessorOptions, PicturesAreTheSameByAnyNumberOfThreads) {
    const auto pictures = picturesWith({}, "all");
    EXPECT_THAT(pictures[0], testing::Not(IsEmpty()));
    EXPECT_EQ(pictures, picturesWith({"--threads", "1"}, "one"));
    EXPECT_EQ(pictures, picturesWith({"--threads", "1024"}, "many"));
}

TEST_F(ProcessorOptions, InstructionsThatTheProcessorLacksAreRefusedWithThoseThatItHas) {
    std::string sets;
    for (const std::string& set : instructionSets())
        sets += (sets.empty() ? "" : set == "sse2" ? " and " : ", ") + set;
    EXPECT_EQ(
        refusalOf({"--instructions", "mmx"}),
        "quarn: --instructions: \"mmx\" is no instruction set that pictures can be drawn with "
        "on this processor, which has " +
            sets + ".\n");
}

TEST_F(ProcessorOptions, EveryInstructionSetOfTheProcessorDraws) {
    for (const std::string& set : instructionSets()) {
        const auto pictures = picturesWith({"--instructions", set}, set);
        EXPECT_EQ(pictures, picturesWith({"--instructions", set}, set + " again"));
    }
    EXPECT_EQ(picturesWith({}, "fastest"),
              picturesWith({"--instructions", instructionSets().front()}, "named"));
}

} // namespace quarn::test
