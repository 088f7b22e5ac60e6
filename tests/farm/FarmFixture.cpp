#include "tests/farm/FarmFixture.h"

#include <gmock/gmock.h>

namespace quarn::test {

namespace {

namespace fs = std::filesystem;

bool isLost(const std::string& node) {
    const std::string state =
        slurm({"sinfo", "--noheader", "--Node", "--nodes=" + node, "--format=%T"});
    return state.find("idle") != 0 || state.find('*') != std::string::npos;
}

} // namespace

void Farm::SetUp() {
    ASSERT_TRUE(fs::exists(fs::path(FARM_CLUSTER) / "slurm.conf"))
        << "no cluster runs; start it: tests/farm/cluster start " << FARM_CLUSTER;
}

void Farm::TearDown() {
    bringClusterBack();
    for (const std::string& node : nodes())
        setEnvironmentOf(node, "");
}

void Farm::bringClusterBack() {
    slurm({"scancel", "--me"});
    EXPECT_TRUE(waitUntilAllJobsEnded(30)) << slurm({"squeue"});
    for (const std::string& node : nodes()) {
        if (isLost(node))
            cluster("start-node", node);
    }
}

Ended Farm::submit(const fs::path& document, std::vector<std::string> options) const {
    std::vector<std::string> words = {
        "farm", "submit", document.string(), "--out", m_folder.string(), "--frame-time", "0.5"};
    words.insert(words.end(), options.begin(), options.end());
    return run(onCluster(std::move(words)));
}

Ended Farm::farm(const std::string& what) const {
    return run(onCluster({"farm", what, m_folder.string()}));
}

void Farm::expectWhatOneProcessMakes(const House& house) const {
    EXPECT_THAT(differences(m_folder, house.folder), testing::IsEmpty()) << logs();
    EXPECT_THAT(differences(house.folder, m_folder), testing::IsEmpty()) << logs();
}

std::string Farm::logs() const {
    std::string text;
    for (const fs::directory_entry& entry : fs::recursive_directory_iterator(m_place.path())) {
        if (entry.path().extension() == ".log" || entry.path().extension() == ".out")
            text += entry.path().filename().string() + ":\n" + readFile(entry.path());
    }
    return text;
}

} // namespace quarn::test
