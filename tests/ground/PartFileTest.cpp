#include "ground/PartFile.h"
#include "ground/AtomicFile.h"
#include "ground/ProcessIdentity.h"
#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <sys/wait.h>
#include <unistd.h>
#include <vector>

namespace quarn::test {
namespace {

namespace fs = std::filesystem;
using testing::ElementsAre;
using testing::UnorderedElementsAreArray;

std::vector<std::string> filesIn(const fs::path& folder) {
    std::vector<std::string> names;
    for (const auto& entry : fs::directory_iterator(folder))
        names.push_back(entry.path().filename().string());
    std::ranges::sort(names);
    return names;
}

std::string partOf(const std::string& host, long pid, const std::string& number = "0") {
    return ".quarn-" + host + "-" + std::to_string(pid) + "-" + number + ".part";
}

/// What a process left in the folder that was ended while it wrote a file.
pid_t killWriterIn(const fs::path& folder) {
    const pid_t child = fork();
    if (child == 0) {
        const PartFile part(folder, 0600);
        raise(SIGKILL);
    }
    int status = 0;
    EXPECT_EQ(waitpid(child, &status, 0), child);
    return child;
}

TEST(PartFile, IsNamedAfterTheMachineAndTheProcess) {
    const TempFolder folder;
    {
        const PartFile first(folder.path(), 0600);
        const PartFile second(folder.path(), 0600);
        EXPECT_THAT(filesIn(folder.path()),
                    ElementsAre(partOf(hostName(), getpid()), partOf(hostName(), getpid(), "1")));
    }
    EXPECT_THAT(filesIn(folder.path()), ElementsAre());
}

TEST(PartFile, ThatAnEndedProcessLeftGoesWithTheNextFileThatIsWrittenToDisk) {
    const TempFolder folder;
    const pid_t writer = killWriterIn(folder.path());
    ASSERT_THAT(filesIn(folder.path()), ElementsAre(partOf(hostName(), writer)));
    ASSERT_TRUE(writeFileAtomically(folder / "a", {}).ok());
    EXPECT_EQ(filesIn(folder.path()).size(), 2U) << "frames are written without a look around";
    ASSERT_TRUE(writeFileToDisk(folder / "a", {}).ok());
    EXPECT_THAT(filesIn(folder.path()), ElementsAre("a"));
}

TEST(PartFile, OfOthersAndAllElseStays) {
    const TempFolder folder;
    const pid_t ended = killWriterIn(folder / ".");
    fs::remove(folder / partOf(hostName(), ended));
    const std::vector<std::string> names = {
        partOf(hostName(), getppid()),                 // of a process at work
        partOf(hostName() + "-2", ended),              // of another machine
        ".quarn-" + std::to_string(ended) + "-0.part", // names no machine
        "quarn-" + hostName() + "-" + std::to_string(ended) + "-0.part",
        partOf(hostName(), ended, "0x"),
        partOf(hostName(), ended, ""),
        partOf(hostName(), ended) + "s",
        partOf(hostName(), -ended),
        ".quarn-.part",
        ".part",
    };
    for (const std::string& name : names)
        writeFile(folder / name, "x");
    removeLeftParts(folder.path());
    EXPECT_THAT(filesIn(folder.path()), UnorderedElementsAreArray(names));
}

TEST(PartFile, ThatIsALinkOrAFolderStays) {
    const TempFolder folder;
    const pid_t ended = killWriterIn(folder.path());
    fs::remove(folder / partOf(hostName(), ended));
    writeFile(folder / "kept", "x");
    fs::create_symlink("kept", folder / partOf(hostName(), ended, "0"));
    fs::create_directory(folder / partOf(hostName(), ended, "1"));
    removeLeftParts(folder.path());
    EXPECT_EQ(filesIn(folder.path()).size(), 3U);
}

} // namespace
} // namespace quarn::test
