// What becomes of the program when the one that reads model files for it misbehaves. The stand-in
// behaves as the name of the file asks for.
#include "tests/quarn/Studio.h"

#include <csignal>
#include <filesystem>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;
using testing::IsEmpty;
using testing::StartsWith;

class Reader : public testing::Test {
protected:
    Start start(const std::string& behaviour, std::vector<std::string> arguments) {
        const std::string model = behaviour + ".obj";
        writeFile(m_studio / model, "v 0 0 0\n");
        for (std::string& argument : arguments)
            argument = argument == "MODEL" ? model : argument;
        Start start;
        start.folder = m_studio.path();
        start.arguments = std::move(arguments);
        start.environment = {{"QUARN_READER", QUARN_STAND_IN_READER}};
        return start;
    }
    Start info(const std::string& behaviour) { return start(behaviour, {"info", "MODEL"}); }

    Studio m_studio;
};

class ReaderSignal : public Reader, public testing::WithParamInterface<int> {};

/// Whether a reader works on behalf of a program that runs, not of those of other tests.
bool hasReader(const RunningProgram& program) {
    for (const auto& entry : std::filesystem::directory_iterator("/proc")) {
        std::error_code gone;
        if (std::filesystem::read_symlink(entry.path() / "exe", gone) != QUARN_STAND_IN_READER)
            continue;
        const std::string status = readFile(entry.path() / "status");
        if (status.find("\nPPid:\t" + std::to_string(program.id()) + "\n") != std::string::npos)
            return true;
    }
    return false;
}

} // namespace

TEST_F(Reader, ThatCrashesIsToldWithTheNameOfTheFile) {
    const Ended ended = run(info("crash"));
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_EQ(ended.err, "quarn: crash.obj could not be read: the reader stopped unexpectedly. The "
                         "file may be damaged: export it again, or in another format.\n");
    EXPECT_THAT(ended.out, IsEmpty());
}

TEST_F(Reader, ThatTakesTooMuchMemoryIsToldWithTheOptionThatAllowsMore) {
    Start start = info("take_memory");
    start.arguments.insert(start.arguments.end(), {"--limit-memory", "103M"});
    const Ended ended = run(start);
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.err, HasSubstr("take_memory.obj could not be read: it needs more than the "
                                     "0.1 GB of memory that reading may take (--limit-memory)."));
}

TEST_F(Reader, LimitsOfMemoryAreSizes) {
    for (const char* const none : {"0M", "500", "-1G", "M", "1e3M", "many", "2T", "0.5M"}) {
        const Ended ended = run({"info", "house.obj", "--limit-memory", none});
        EXPECT_EQ(ended.exit_code, 2) << none;
        EXPECT_THAT(ended.err, HasSubstr("--limit-memory must be a size such as 500M or 2G"));
    }
    Start start = m_studio.turntable(1);
    start.arguments = {"info", "house.obj", "--limit-memory", "1.5g"};
    EXPECT_EQ(run(start).exit_code, 0);
}

TEST_P(ReaderSignal, EndsAReadingThatNeverEnds) {
    RunningProgram program(info("hang"));
    ASSERT_TRUE(program.waitUntil([&] { return hasReader(program); }));
    program.sendSignal(GetParam());
    const Ended ended = program.wait();
    EXPECT_EQ(ended.exit_code, 128 + GetParam());
    EXPECT_EQ(ended.err, "Stopped while hang.obj was read.\n");
    EXPECT_FALSE(hasReader(program));
}

INSTANTIATE_TEST_SUITE_P(Signals, ReaderSignal, testing::Values(SIGINT, SIGTERM, SIGHUP));

TEST_F(Reader, HowFarItIsStandsOnATerminal) {
    Start watched = info("hang");
    watched.has_terminal = true;
    RunningProgram program(watched);
    ASSERT_TRUE(program.waitUntil([&] { return hasReader(program); }));
    usleep(700'000); // it is shown after a moment
    program.sendSignal(SIGTERM);
    EXPECT_THAT(program.wait().err, HasSubstr("making the meshes of hang.obj, 25 %"));
}

TEST_F(Reader, LeavesTheConsoleAtWorkWhateverBecomesOfIt) {
    Start console = start("crash", {"console", "--no-recovery"});
    console.input = "Point 1,2,3\nImport crash.obj\nImport leave.obj\nList Objects\n";
    writeFile(m_studio / "leave.obj", "v 0 0 0\n");
    const Ended ended = run(console);
    EXPECT_THAT(ended.out, HasSubstr("crash.obj could not be read"));
    EXPECT_THAT(ended.out, HasSubstr("leave.obj could not be read"));
    EXPECT_THAT(ended.out, HasSubstr("1 point;"));
}

TEST_F(Reader, ThatIsMissingIsToldWithWhereItWasLookedFor) {
    Start start = info("crash");
    start.environment["QUARN_READER"] = "/nowhere/quarn-reader";
    EXPECT_THAT(run(start).err, HasSubstr("there is no /nowhere/quarn-reader. Install Quarn"));
}

TEST_F(Reader, IsNotNeededWhereModelsAreReadInside) {
    Start start = m_studio.turntable(1);
    start.arguments = {"info", "house.obj"};
    start.environment["QUARN_READER"] = "inside";
    EXPECT_EQ(run(start).exit_code, 0);
}

} // namespace quarn::test
