// Each attempt is made by a process of its own, which fences itself first.
#include "reader/Fence.h"
#include "tests/support/TempFolder.h"

#include <gtest/gtest.h>

#include <atomic>
#include <cerrno>
#include <csignal>
#include <cstdlib>
#include <dlfcn.h>
#include <fcntl.h>
#include <fstream>
#include <functional>
#include <linux/landlock.h>
#include <sys/prctl.h>
#include <sys/ptrace.h>
#include <sys/resource.h>
#include <sys/socket.h>
#include <sys/syscall.h>
#include <tbb/parallel_for.h>
#include <thread>
#include <unistd.h>
#include <vector>

namespace quarn::test {
namespace {

namespace fs = std::filesystem;

/// A folder with a model and what lies beside, below and around it.
class Fenced : public ::testing::Test {
protected:
    Fenced() {
        fs::create_directories(m_folder / "model/below");
        for (const char* const name :
             {"model/house.obj", "model/house.mtl", "model/below/a.png", "secret.txt"})
            std::ofstream(m_folder / name) << "v 0 0 0\n";
        fs::create_symlink(m_folder / "secret.txt", m_folder / "model/link.png");
    }

    /// How a process ends that raises the fence and then returns what the attempt does.
    void expectBehindFence(const std::function<int()>& attempt, int exit_code) const {
        EXPECT_EXIT(
            {
                raiseFence(model());
                _exit(attempt());
            },
            ::testing::ExitedWithCode(exit_code), "");
    }
    void expectDeathBehindFence(const std::function<void()>& attempt) const {
        EXPECT_EXIT(
            {
                raiseFence(model());
                attempt();
                _exit(0);
            },
            ::testing::KilledBySignal(SIGSYS), "");
    }

    /// The error of opening a file; 0 for none.
    int opening(const fs::path& name, int flags = O_RDONLY) const {
        return open((m_folder / name).c_str(), flags, 0600) >= 0 ? 0 : errno;
    }

    fs::path model() const { return m_folder / "model/house.obj"; }

private:
    TempFolder m_folder;
};

/// The error of a call; 0 for none.
int errorOf(long result) {
    return result >= 0 ? 0 : errno;
}

bool hasFileRules() {
    return syscall(SYS_landlock_create_ruleset, nullptr, 0, LANDLOCK_CREATE_RULESET_VERSION) > 0;
}

} // namespace

TEST_F(Fenced, StandsWholeOnThisKernel) {
    const bool has_file_rules = hasFileRules();
    EXPECT_EXIT(
        {
            const Fence fence = raiseFence(model());
            _exit(fence.has_call_filter && fence.has_file_rules == has_file_rules ? 0 : 1);
        },
        ::testing::ExitedWithCode(0), "");
}

TEST_F(Fenced, FilesOfTheModelsFolderAndBelowItAreOpened) {
    for (const char* const name : {"model/house.obj", "model/house.mtl", "model/below/a.png"})
        expectBehindFence([&] { return opening(name); }, 0);
}

TEST_F(Fenced, FilesElsewhereAreRefusedAlsoThroughLinks) {
    if (!hasFileRules())
        GTEST_SKIP() << "this kernel has no rules for files";
    for (const char* const name : {"secret.txt", "model/../secret.txt", "model/link.png"})
        expectBehindFence([&] { return opening(name); }, EACCES);
    expectBehindFence([&] { return opening("/etc/passwd"); }, EACCES);
    expectBehindFence([&] { return opening("/proc/self/environ"); }, EACCES);
}

TEST_F(Fenced, NothingIsWritten) {
    expectBehindFence([&] { return opening("model/house.obj", O_RDWR); }, EPERM);
    expectBehindFence([&] { return opening("model/new.txt", O_WRONLY | O_CREAT); }, EPERM);
    expectBehindFence([&] { return opening("model/house.mtl", O_RDONLY | O_TRUNC); }, EPERM);
    expectBehindFence([&] { return errorOf(unlink(model().c_str())); }, EPERM);
    expectBehindFence([&] { return errorOf(truncate(model().c_str(), 0)); }, EPERM);
}

TEST_F(Fenced, NoConnectionIsOpened) {
    for (const int family : {AF_INET, AF_INET6, AF_UNIX, AF_NETLINK})
        expectBehindFence([=] { return errorOf(socket(family, SOCK_DGRAM, 0)); }, EPERM);
}

TEST_F(Fenced, NoProgramIsStarted) {
    expectDeathBehindFence([] { execl("/bin/true", "true", nullptr); });
    expectDeathBehindFence([] { execl("/nowhere/true", "true", nullptr); });
    expectBehindFence([] { return errorOf(fork()); }, EPERM);
}

TEST_F(Fenced, OtherProcessesAreOutOfReach) {
    expectDeathBehindFence([] { ptrace(PTRACE_ATTACH, getppid(), nullptr, nullptr); });
    expectBehindFence([] { return errorOf(kill(getppid(), SIGTERM)); }, EPERM);
}

TEST_F(Fenced, LimitsAndTheFenceItselfStay) {
    expectBehindFence(
        [] {
            const rlimit limits{1 << 30, 1 << 30};
            return errorOf(setrlimit(RLIMIT_DATA, &limits));
        },
        EPERM);
    expectBehindFence([] { return errorOf(prctl(PR_SET_DUMPABLE, 1, 0, 0, 0)); }, EPERM);
}

TEST_F(Fenced, ThreadsAndMemoryWorkOn) {
    expectBehindFence(
        [] {
            std::atomic<int> sum = 0;
            tbb::parallel_for(0, 10'000, [&](int) {
                const std::vector<char> large(100'000, 1);
                sum += large[99'999];
            });
            std::thread([&] { ++sum; }).join();
            return sum == 10'001 ? 0 : 1;
        },
        0);
}

TEST_F(Fenced, LibrariesOfTheSystemAreOpened) {
    expectBehindFence([] { return dlopen("libz.so.1", RTLD_NOW) ? 0 : 1; }, 0);
}

TEST_F(Fenced, AnAbortIsAnAbort) {
    EXPECT_EXIT(
        {
            raiseFence(model());
            std::abort();
        },
        ::testing::KilledBySignal(SIGABRT), "");
}

TEST_F(Fenced, AModelThatIsALinkIsReadWhereItLies) {
    const fs::path link = model().parent_path().parent_path() / "elsewhere";
    fs::create_directory(link);
    fs::create_symlink(model(), link / "linked.obj");
    EXPECT_EXIT(
        {
            raiseFence(link / "linked.obj");
            _exit(opening("elsewhere/linked.obj"));
        },
        ::testing::ExitedWithCode(0), "");
}

} // namespace quarn::test
