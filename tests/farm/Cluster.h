#pragma once

#include "tests/quarn/ProgramRun.h"

#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace quarn::test {

/// The nodes of the cluster that the script `cluster` started before the tests, in FARM_CLUSTER.
const std::vector<std::string>& nodes();

/// A program with that cluster as its own: quarn, where no other is named.
Start onCluster(std::vector<std::string> arguments);

/// A command of Slurm, such as {"squeue", "-h"}. @return what it printed
std::string slurm(std::vector<std::string> words);

/// A command of the script `cluster`; a failure of it is a failure of the test.
void cluster(const std::string& command, const std::string& node = {});

/// Lines `export NAME=value` for the environment of all tasks that start on the node from now on;
/// none takes them away.
void setEnvironmentOf(const std::string& node, const std::string& lines);

/// Looks again and again. @return whether the condition held before the seconds had passed
bool waitUntil(double seconds, const std::function<bool()>& condition);

/// Waits until no job is left that could still run.
bool waitUntilAllJobsEnded(double seconds);

/// A process of quarn that draws a frame now, by its claim, and the node that it runs on.
struct Drawing {
    std::string node;
    pid_t process = -1;
};

/// Waits until one of these nodes draws a frame into the folder. @return nothing after half a
/// minute
std::optional<Drawing> waitUntilDrawing(const std::vector<std::string>& where,
                                        const std::filesystem::path& folder);

} // namespace quarn::test
