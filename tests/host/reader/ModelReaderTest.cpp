#include "tests/host/reader/ReaderFixture.h"
#include "tests/support/OtherUser.h"

#include <csignal>
#include <fstream>
#include <sys/resource.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>

namespace quarn::test {

using std::chrono::milliseconds;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::StartsWith;

namespace {

std::string messageOf(const Result<ImportedModel>& model) {
    return model ? "" : model.message();
}

/// A line of /proc/PID/status.
std::string statusLine(pid_t process, const std::string& name) {
    std::ifstream status("/proc/" + std::to_string(process) + "/status");
    for (std::string line; std::getline(status, line);)
        if (line.starts_with(name + ":"))
            return line;
    return {};
}

std::size_t threadsOf(pid_t process) {
    std::error_code ended;
    const std::filesystem::directory_iterator threads("/proc/" + std::to_string(process) + "/task",
                                                      ended);
    return static_cast<std::size_t>(std::distance(begin(threads), {}));
}

/// Ended, with nobody there who waited for it.
bool isZombie(pid_t process) {
    return statusLine(process, "State").find('Z') != std::string::npos;
}

} // namespace

TEST_F(ModelReaderTest, AModelIsTheSameAsWhenItIsReadInside) {
    const auto outside = readModel(triangle);
    const SetVariable inside(READER_VARIABLE, "inside");
    const auto own = readModel(triangle);
    ASSERT_TRUE(outside && own) << messageOf(outside);
    ASSERT_EQ(outside.value().meshes.size(), 1U);
    EXPECT_EQ(outside.value().meshes[0].name, L"Roof");
    EXPECT_EQ(outside.value().meshes[0].placed.mesh->m_V, own.value().meshes[0].placed.mesh->m_V);
    EXPECT_EQ(outside.value().meshes[0].placed.mesh->m_N, own.value().meshes[0].placed.mesh->m_N);
    EXPECT_EQ(outside.value().up.axis, own.value().up.axis);
}

TEST_F(ModelReaderTest, TheAxisThatWasAskedForArrives) {
    const auto turned = readModel(triangle, {.up = UpAxis::y});
    ASSERT_TRUE(turned) << messageOf(turned);
    EXPECT_EQ(turned.value().meshes[0].placed.box().m_max, KM_3dPoint(1, 0, 1));
}

TEST_F(ModelReaderTest, AFileThatCannotBeReadIsRefusedInTheSameWordsAsInside) {
    const std::filesystem::path bad =
        folder.write("bad.ply", "ply\nformat ascii 1.0\nend_header\n");
    for (const std::filesystem::path& file :
         {bad, folder.path() / "missing.obj", folder.path(), std::filesystem::path("/dev/null"),
          folder.write("empty.obj", ""), folder.write("a.unknown", "some words")}) {
        const std::string outside = messageOf(readModel(file));
        const SetVariable inside(READER_VARIABLE, "inside");
        EXPECT_FALSE(outside.empty()) << file;
        EXPECT_EQ(outside, messageOf(readModel(file)));
    }
}

TEST_F(ModelReaderTest, APipeIsRefusedAndNotWaitedFor) {
    const std::filesystem::path pipe = folder.path() / "pipe.obj";
    ASSERT_EQ(mkfifo(pipe.c_str(), 0600), 0);
    EXPECT_THAT(messageOf(readModel(pipe)), HasSubstr("it is not an ordinary file"));
}

TEST_F(ModelReaderTest, AFolderWithoutPermissionIsTold) {
    std::filesystem::permissions(folder.path(), std::filesystem::perms::none);
    EXPECT_TRUE(runAsOrdinaryUser(
        [&] { return messageOf(readModel(triangle)).find("Cannot read '") == 0; }));
    std::filesystem::permissions(folder.path(), std::filesystem::perms::owner_all);
}

TEST_F(ModelReaderTest, ManyFilesInARowLeaveNoProcessAndNoOpenFile) {
    ASSERT_TRUE(readModel(triangle));
    const int open = openDescriptors();
    for (int i = 0; i < 20; ++i) {
        EXPECT_TRUE(readModel(triangle));
        EXPECT_FALSE(readModel(folder.path() / "missing.obj"));
    }
    EXPECT_EQ(openDescriptors(), open);
    EXPECT_THAT(childProcesses(), IsEmpty());
}

TEST_F(ModelReaderTest, TheReaderWorksBehindItsFence) {
    bool was_seen = false;
    CallingWatch watch([&](ReadingStep, double) {
        for (const pid_t reader : childProcesses()) {
            was_seen = true;
            EXPECT_EQ(statusLine(reader, "Seccomp"), "Seccomp:\t2");
            EXPECT_EQ(statusLine(reader, "NoNewPrivs"), "NoNewPrivs:\t1");
        }
        return true;
    });
    ASSERT_TRUE(readModel(largeModel(), {.watch = &watch}));
    EXPECT_TRUE(was_seen);
}

TEST_F(ModelReaderTest, TheReaderHasNoMoreThreadsThanItMayUse) {
    const std::filesystem::path model = largeModel();
    const auto threadsWith = [&](int most_threads) {
        std::size_t most = 0;
        CallingWatch watch([&](ReadingStep, double) {
            for (const pid_t reader : childProcesses())
                most = std::max(most, threadsOf(reader));
            return true;
        });
        EXPECT_TRUE(readModel(model, {.most_threads = most_threads, .watch = &watch}));
        return most;
    };
    EXPECT_EQ(threadsWith(1), 1U);
    EXPECT_GE(threadsWith(0), std::min(2U, std::thread::hardware_concurrency()))
        << "as many as there are processors";
}

TEST_F(ModelReaderTest, AReaderThatIsKilledFromOutsideIsTold) {
    CallingWatch watch([](ReadingStep, double) {
        for (const pid_t reader : childProcesses())
            kill(reader, SIGKILL);
        return true;
    });
    EXPECT_THAT(messageOf(readModel(largeModel(), {.watch = &watch})),
                StartsWith("large.obj could not be read: the reader stopped unexpectedly."));
    EXPECT_TRUE(readModel(triangle)) << "the next one is read";
}

TEST_F(ModelReaderTest, TheReaderEndsWithAHostThatIsKilled) {
    const std::filesystem::path model = largeModel();
    const pid_t host = fork();
    ASSERT_GE(host, 0);
    if (host == 0)
        _exit(readModel(model) ? 0 : 1);
    std::vector<pid_t> readers;
    while (readers.empty() && !isZombie(host))
        readers = childProcesses(std::to_string(host));
    std::this_thread::sleep_for(milliseconds(30)); // it works by now
    kill(host, SIGKILL);
    waitpid(host, nullptr, 0);
    ASSERT_FALSE(readers.empty());
    const auto begin = std::chrono::steady_clock::now();
    while (kill(readers[0], 0) == 0 && !isZombie(readers[0]) &&
           std::chrono::steady_clock::now() - begin < std::chrono::seconds(10))
        std::this_thread::sleep_for(milliseconds(1));
    EXPECT_LT(std::chrono::steady_clock::now() - begin, milliseconds(200))
        << "the reading alone would have gone on";
}

TEST_F(ModelReaderTest, AFileThatGrowsWhileItIsReadIsReadOrTold) {
    const std::filesystem::path model = largeModel();
    CallingWatch watch([&](ReadingStep, double) {
        std::ofstream(model, std::ios::app) << "v 1 2 3\n";
        return true;
    });
    const auto read = readModel(model, {.watch = &watch});
    EXPECT_TRUE(read || read.message().find("large.obj") != std::string::npos);
}

TEST_F(ModelReaderTest, AFileThatShrinksWhileItIsReadIsReadOrTold) {
    const std::filesystem::path model = largeModel();
    CallingWatch watch([&](ReadingStep, double) {
        std::filesystem::resize_file(model, 0);
        return true;
    });
    const auto read = readModel(model, {.watch = &watch});
    EXPECT_TRUE(read || read.message().find("large.obj") != std::string::npos);
}

TEST_F(ModelReaderTest, AModelBeyondTheMemoryThatItMayTakeIsRefused) {
    const auto read = readModel(largeModel(), {.most_memory = std::uint64_t{4} << 20});
    ASSERT_FALSE(read);
    EXPECT_THAT(read.message(), HasSubstr("large.obj"));
    EXPECT_THAT(read.message(), HasSubstr("memory"));
}

TEST_F(ModelReaderTest, WhereNoMemoryCanBeSharedTheModelIsRefused) {
    const Limited files(RLIMIT_FSIZE, 4096); // the block is a file to the system
    const auto read = readModel(folder.path() / "triangle.obj");
    EXPECT_TRUE(read) << messageOf(read);
    const std::filesystem::path large = [&] {
        const Limited no_limit(RLIMIT_FSIZE, RLIM_INFINITY);
        return largeModel();
    }();
    EXPECT_THAT(messageOf(readModel(large)), HasSubstr("too little shared memory"));
}

TEST_F(ModelReaderTest, WhereNoFileCanBeOpenedTheReaderIsNotStarted) {
    const Limited files(RLIMIT_NOFILE, static_cast<unsigned long>(openDescriptors()));
    EXPECT_THAT(messageOf(readModel(triangle)),
                StartsWith("triangle.obj could not be read: the program that reads model files "
                           "cannot be started ("));
}

TEST_F(ModelReaderTest, AMissingProgramIsNamed) {
    const SetVariable missing(READER_VARIABLE, "/nowhere/quarn-reader");
    EXPECT_EQ(messageOf(readModel(triangle)),
              "The program that reads model files is missing: there is no /nowhere/quarn-reader. "
              "Install Quarn with all its files.");
}

TEST_F(ModelReaderTest, AProgramOfAnotherKindIsTold) {
    const SetVariable wrong(READER_VARIABLE, "/bin/true");
    EXPECT_THAT(messageOf(readModel(triangle)), HasSubstr("the reader stopped unexpectedly"));
}

TEST(ReaderTime, FollowsTheSizeOfTheFile) {
    EXPECT_EQ(longestReading(0), milliseconds(60'000));
    EXPECT_NEAR(static_cast<double>(longestReading(100'000'000).count()), 360'000.0, 1000.0);
}

TEST_F(StandInReaderTest, ACrashIsTold) {
    EXPECT_EQ(whyNot("crash"),
              "crash.obj could not be read: the reader stopped unexpectedly. The file may be "
              "damaged: export it again, or in another format.");
    EXPECT_THAT(whyNot("leave"), HasSubstr("the reader stopped unexpectedly"));
}

TEST_F(StandInReaderTest, AReadingWithoutAnEndIsEnded) {
    EXPECT_EQ(whyNot("hang", {.longest = milliseconds(300)}),
              "hang.obj could not be read: it took longer than 1 s. The file may be damaged: "
              "export it again, or in another format.");
    EXPECT_THAT(whyNot("tell_for_ever", {.longest = milliseconds(300)}),
                HasSubstr("it took longer than 1 s"));
    EXPECT_THAT(childProcesses(), IsEmpty());
}

TEST_F(StandInReaderTest, AReadingIsGivenUpWhenItsWatchSaysSo) {
    int looks = 0;
    CallingWatch watch([&](ReadingStep, double) { return ++looks < 5; });
    EXPECT_EQ(whyNot("hang", {.watch = &watch}), "hang.obj was not read: it was given up.");
    EXPECT_EQ(looks, 5);
    EXPECT_THAT(childProcesses(), IsEmpty());
}

TEST_F(StandInReaderTest, TheWatchLearnsHowFarTheReaderIs) {
    ReadingStep last_step = ReadingStep::read;
    double last_share = 0.0;
    CallingWatch watch([&](ReadingStep step, double share) {
        last_step = step;
        last_share = share;
        return share == 0.0;
    });
    whyNot("hang", {.watch = &watch});
    EXPECT_EQ(last_step, ReadingStep::made);
    EXPECT_EQ(last_share, 0.25);
}

TEST_F(StandInReaderTest, MemoryBeyondTheBudgetIsTold) {
    for (const char* const behaviour : {"take_memory", "fill_block"})
        EXPECT_THAT(whyNot(behaviour, {.most_memory = std::uint64_t{200} << 20}),
                    HasSubstr("it needs more than the 0.2 GB of memory that reading may take "
                              "(--limit-memory)"));
}

TEST_F(StandInReaderTest, AFileThatIsCutWhileItIsReadIsTold) {
    CallingWatch watch([&](ReadingStep, double) {
        std::filesystem::resize_file(folder.path() / "read_mapped.obj", 0);
        return true;
    });
    EXPECT_EQ(whyNot("read_mapped", {.watch = &watch}),
              "read_mapped.obj could not be read: the file changed while it was read. Try again "
              "when it is complete.");
}

TEST_F(StandInReaderTest, NonsenseIsNotTaken) {
    for (const char* const behaviour : {"hand_over_nothing", "hand_over_nonsense"})
        EXPECT_THAT(whyNot(behaviour), HasSubstr("is no whole model"));
    EXPECT_THAT(whyNot("talk_nonsense"), HasSubstr("the reader stopped unexpectedly"));
}

TEST_F(StandInReaderTest, ARefusalWithoutWordsHasSome) {
    EXPECT_THAT(whyNot("say_nothing"), HasSubstr("say_nothing.obj could not be read"));
}

TEST_F(StandInReaderTest, TheReaderKnowsWhereItIsAndSoItsModules) {
    EXPECT_EQ(whyNot("say_name"), QUARN_STAND_IN_READER);
}

TEST_F(StandInReaderTest, TheReaderInheritsNothingButItsOwnDescriptors) {
    const std::ofstream other(folder.path() / "other.txt");
    const int kept = dup(STDOUT_FILENO); // stays open in programs that are started
    EXPECT_EQ(whyNot("list_descriptors"), "0 1 2 3 4 ");
    close(kept);
}

TEST_F(StandInReaderTest, TheReaderLearnsNothingOfTheEnvironment) {
    const SetVariable secret("QUARN_TEST_SECRET", "hidden");
    const SetVariable locale("LC_TEST", "shown");
    const std::string variables = whyNot("list_environment");
    EXPECT_THAT(variables, testing::Not(HasSubstr("hidden")));
    EXPECT_THAT(variables, testing::Not(HasSubstr("HOME=")));
    EXPECT_THAT(variables, HasSubstr("LC_TEST=shown"));
}

} // namespace quarn::test
