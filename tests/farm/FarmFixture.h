#pragma once

#include "tests/farm/Cluster.h"
#include "tests/farm/House.h"
#include "tests/support/TempFolder.h"

#include <gtest/gtest.h>

namespace quarn::test {

/// A test with all nodes of the cluster to itself, and a folder to record into.
class Farm : public testing::Test {
protected:
    void SetUp() override;
    void TearDown() override;

    /// Ends all jobs, and starts the nodes again that take none.
    static void bringClusterBack();
    /// `quarn farm submit` of a document into the folder, with more options.
    Ended submit(const std::filesystem::path& document,
                 std::vector<std::string> options = {}) const;
    /// `quarn farm WHAT` for the folder.
    Ended farm(const std::string& what) const;
    /// Fails unless the folder holds what one process makes, byte for byte, and nothing else.
    void expectWhatOneProcessMakes(const House& house) const;
    /// What the tasks printed, for messages.
    std::string logs() const;

    TempFolder m_place;
    std::filesystem::path m_folder = m_place / "frames";
};

} // namespace quarn::test
