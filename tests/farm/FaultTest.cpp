#include "tests/farm/FarmFixture.h"

#include <csignal>
#include <gmock/gmock.h>
#include <regex>
#include <set>

namespace quarn::test {

namespace {

namespace fs = std::filesystem;

using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

// The sanitizer's library wants to be the first.
#ifdef __SANITIZE_ADDRESS__
const std::string SANITIZER_SETTING = "export ASAN_OPTIONS=verify_asan_link_order=0\n";
#else
const std::string SANITIZER_SETTING;
#endif

/// What makes programs believe that it is an hour later; of files they are told the truth.
std::string clockAnHourAhead() {
    for (const fs::directory_entry& entry : fs::directory_iterator("/usr/lib")) {
        const fs::path library = entry.path() / "faketime/libfaketimeMT.so.1";
        if (fs::exists(library))
            return "export LD_PRELOAD=" + library.string() +
                   "\nexport FAKETIME=+3600\nexport NO_FAKE_STAT=1\n" + SANITIZER_SETTING;
    }
    ADD_FAILURE() << "the package faketime is not installed";
    return {};
}

/// What ends all writing after the first four kilobytes of a file, as a disk without room does: the
/// shells of jobs read the file first.
std::string fullDisk(const fs::path& file) {
    writeFile(file, "ulimit -f 4\n");
    return "export BASH_ENV=" + file.string() + "\n";
}

void cutInHalf(const fs::path& file) {
    fs::resize_file(file, fs::file_size(file) / 2);
}

std::vector<std::string> nodesBut(const std::string& lost) {
    std::vector<std::string> others = nodes();
    std::erase(others, lost);
    return others;
}

/// The same document with a line more.
void writeChanged(const fs::path& document, const fs::path& changed) {
    const fs::path script = changed.parent_path() / "change.txt";
    writeFile(script, "_-Line 0,0,0 30,0,30 _Enter\n_-SaveAs \"" + changed.string() + "\"\n");
    const Ended ended = run({"run", script.string(), document.string()});
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
}

bool usesAnotherClock(pid_t process) {
    return readFile("/proc/" + std::to_string(process) + "/maps").find("libfaketime") !=
           std::string::npos;
}

/// The pictures that a journal notes.
std::vector<std::string> picturesIn(const fs::path& journal) {
    static const std::regex picture(R"re("file":"([^"]*)")re");
    const std::string text = readFile(journal);
    std::vector<std::string> names;
    for (std::sregex_iterator at(text.begin(), text.end(), picture), end; at != end; ++at)
        names.push_back((*at)[1]);
    return names;
}

std::vector<fs::path> journalsOf(const fs::path& folder, const std::string& mark) {
    std::vector<fs::path> journals;
    for (const fs::directory_entry& entry : fs::directory_iterator(folder)) {
        const std::string name = entry.path().filename();
        if (name.ends_with(".journal") && name.find(mark) != std::string::npos)
            journals.push_back(entry.path());
    }
    return journals;
}

/// How many frames the writer with this process has noted.
std::size_t framesOf(pid_t writer, const fs::path& folder) {
    std::size_t frames = 0;
    for (const fs::path& journal : journalsOf(folder, "-" + std::to_string(writer) + "-"))
        frames += picturesIn(journal).size();
    return frames;
}

/// Pictures that were made more than once, as far as there are journals yet.
std::set<std::string> madeTwice(const fs::path& folder) {
    std::set<std::string> once;
    std::set<std::string> twice;
    for (const fs::path& journal : journalsOf(folder, "")) {
        for (const std::string& name : picturesIn(journal)) {
            if (!once.insert(name).second)
                twice.insert(name);
        }
    }
    return twice;
}

} // namespace

TEST_F(Farm, MakesWhatOneProcessMakesThoughANodeATaskADiskAndTheControllerFailAndAClockIsWrong) {
    const House& house = renderedHouse();
    setEnvironmentOf("n3", fullDisk(m_place / "full-disk"));
    setEnvironmentOf("n4", clockAnHourAhead());
    const Ended submitted =
        submit(house.document, {"--tasks", "6", "--stage", (m_place / "disk").string()});
    ASSERT_EQ(submitted.exit_code, 0) << submitted.err;

    const auto killed = waitUntilDrawing({"n2"}, m_folder);
    ASSERT_TRUE(killed) << logs();
    EXPECT_EQ(kill(killed->process, SIGKILL), 0);
    ASSERT_TRUE(waitUntilDrawing({"n1"}, m_folder)) << logs();
    cluster("kill-node", "n1");
    const auto ahead = waitUntilDrawing({"n4"}, m_folder);
    ASSERT_TRUE(ahead) << logs();
    EXPECT_TRUE(usesAnotherClock(ahead->process));
    cluster("restart-controller");
    EXPECT_TRUE(waitUntil(10, [&] {
        const std::string said = farm("status").out;
        return said.find("on n2: FAILED") != said.npos && said.find("on n3: FAILED") != said.npos;
    })) << farm("status").out;

    ASSERT_TRUE(waitUntilAllJobsEnded(120)) << slurm({"squeue"}) << logs();
    EXPECT_THAT(logs(), HasSubstr("larger than is allowed")) << "the disk of n3 was not full";
    expectWhatOneProcessMakes(house);
    const Ended status = farm("status");
    EXPECT_EQ(status.exit_code, 0) << status.err;
    EXPECT_THAT(status.out, HasSubstr("18"));
}

TEST_F(Farm, LetsATaskThatOutlivedItsNodeAndItsSuccessorWriteSideBySide) {
    const House& house = renderedHouse();
    const Ended submitted = submit(house.document, {"--tasks", "1"});
    ASSERT_EQ(submitted.exit_code, 0) << submitted.err;
    const auto orphan = waitUntilDrawing(nodes(), m_folder);
    ASSERT_TRUE(orphan) << slurm({"squeue"}) << logs();
    cluster("orphan-node", orphan->node);
    EXPECT_EQ(kill(orphan->process, SIGSTOP), 0); // it is still at it when the other begins
    slurm({"scontrol", "update", "nodename=" + orphan->node, "state=down", "reason=lost"});

    const auto successor = waitUntilDrawing(nodesBut(orphan->node), m_folder);
    EXPECT_EQ(kill(orphan->process, SIGCONT), 0);
    ASSERT_TRUE(successor) << slurm({"squeue"}) << logs();
    const std::size_t before = framesOf(orphan->process, m_folder);
    EXPECT_TRUE(waitUntil(20, [&] { return framesOf(orphan->process, m_folder) > before; }))
        << logs();
    EXPECT_TRUE(waitUntil(20, [&] { return framesOf(successor->process, m_folder) > 0; }))
        << logs();

    std::set<std::string> twice;
    ASSERT_TRUE(waitUntil(60,
                          [&] {
                              twice.merge(madeTwice(m_folder));
                              return slurm({"squeue", "--noheader"}).empty();
                          }))
        << slurm({"squeue"}) << logs();
    EXPECT_THAT(twice, IsEmpty());
    expectWhatOneProcessMakes(house);
}

TEST_F(Farm, GoesOnWhereItWasCancelledAndMakesFramesAgainThatWereCutOrEmptied) {
    const House& house = renderedHouse();
    ASSERT_EQ(submit(house.document, {"--tasks", "4"}).exit_code, 0);
    ASSERT_TRUE(waitUntil(60, [&] { return framesIn(m_folder).size() >= 4; })) << logs();
    const Ended cancelled = farm("cancel");
    EXPECT_EQ(cancelled.exit_code, 0) << cancelled.err;
    ASSERT_TRUE(waitUntilAllJobsEnded(20)) << slurm({"squeue"});
    const std::vector<std::string> first = framesIn(m_folder);
    ASSERT_LT(static_cast<int>(first.size()), house.frames) << "nothing was left to cancel";
    cutInHalf(m_folder / first[0]);
    fs::resize_file(m_folder / first[1], 0);
    const auto kept = fs::last_write_time(m_folder / first[2]);

    const Ended again = submit(house.document, {"--tasks", "4"});
    ASSERT_EQ(again.exit_code, 0) << again.err;
    ASSERT_TRUE(waitUntilAllJobsEnded(60)) << slurm({"squeue"}) << logs();
    expectWhatOneProcessMakes(house);
    EXPECT_EQ(fs::last_write_time(m_folder / first[2]), kept) << "a whole frame was made again";
}

TEST_F(Farm, RefusesADocumentThatWasChangedBetweenTasksAndMixesNothing) {
    const House& house = renderedHouse();
    const fs::path document = m_place / "house.quarn";
    fs::copy_file(house.document, document);
    writeChanged(house.document, m_place / "changed.quarn");
    ASSERT_EQ(submit(document, {"--tasks", "8"}).exit_code, 0);
    ASSERT_TRUE(waitUntilDrawing(nodes(), m_folder)) << logs();
    fs::rename(m_place / "changed.quarn", document);
    ASSERT_TRUE(waitUntilAllJobsEnded(60)) << slurm({"squeue"}) << logs();

    EXPECT_THAT(framesIn(m_folder), Not(IsEmpty()));
    EXPECT_LT(static_cast<int>(framesIn(m_folder).size()), house.frames);
    EXPECT_THAT(differences(m_folder, house.folder), IsEmpty());
    EXPECT_THAT(logs() + farm("status").out, HasSubstr("another state of the document"));

    fs::copy_file(house.document, document, fs::copy_options::overwrite_existing);
    const Ended again = submit(document, {"--tasks", "4"});
    ASSERT_EQ(again.exit_code, 0) << again.err;
    ASSERT_TRUE(waitUntilAllJobsEnded(60)) << slurm({"squeue"}) << logs();
    expectWhatOneProcessMakes(house);
}

TEST_F(Farm, ATaskThatIsAskedToEndStopsBetweenFramesAndGoesOnLater) {
    const House& house = renderedHouse();
    ASSERT_EQ(submit(house.document, {"--tasks", "2"}).exit_code, 0);
    const auto task = waitUntilDrawing(nodes(), m_folder);
    ASSERT_TRUE(task) << logs();
    ASSERT_TRUE(waitUntil(30, [&] { return framesOf(task->process, m_folder) > 0; }));
    const std::string job =
        slurm({"squeue", "--noheader", "--nodelist=" + task->node, "--format=%A"});
    slurm({"scancel", "--batch", "--signal=TERM", linesOf(job).front()});
    ASSERT_TRUE(waitUntil(60, [&] { return kill(task->process, 0) != 0; })) << "it does not end";
    EXPECT_TRUE(waitUntil(20, [] {
        return slurm({"squeue", "--noheader", "--states=PENDING", "--format=%r"})
                   .find("BeginTime") != std::string::npos;
    })) << slurm({"squeue"});

    ASSERT_TRUE(waitUntilAllJobsEnded(60)) << slurm({"squeue"}) << logs();
    expectWhatOneProcessMakes(house);
}

} // namespace quarn::test
