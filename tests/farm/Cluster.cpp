#include "tests/farm/Cluster.h"

#include <algorithm>
#include <chrono>
#include <fstream>
#include <gtest/gtest.h>
#include <sstream>
#include <thread>

namespace quarn::test {

namespace {

namespace fs = std::filesystem;

const fs::path FOLDER = FARM_CLUSTER;
constexpr std::chrono::milliseconds BETWEEN_LOOKS{20};
constexpr double LONGEST_START_S = 30;

/// Nothing of a process that has just ended.
std::string fileOfProcess(const fs::path& file) {
    std::ostringstream bytes;
    bytes << std::ifstream(file).rdbuf();
    return bytes.str();
}

/// The variables that a process was started with, each ended by a zero.
std::string environmentOf(const fs::path& process) {
    return '\0' + fileOfProcess(process / "environ");
}

bool isTaskOf(const fs::path& process, const std::string& node) {
    const std::string environment = environmentOf(process);
    const auto holds = [&](const std::string& setting) {
        return environment.find('\0' + setting + '\0') != std::string::npos;
    };
    return holds("SLURMD_NODENAME=" + node) &&
           holds("SLURM_CONF=" + (fs::canonical(FOLDER) / "slurm.conf").string());
}

bool hasClaim(pid_t process, const fs::path& folder) {
    const std::string mark = "-" + std::to_string(process) + "-";
    std::error_code ignored;
    for (const fs::directory_entry& entry : fs::directory_iterator(folder, ignored)) {
        if (entry.path().extension() == ".claim" &&
            readFile(entry.path()).find(mark) != std::string::npos)
            return true;
    }
    return false;
}

bool isNumber(const std::string& name) {
    return std::all_of(name.begin(), name.end(), [](char c) { return c >= '0' && c <= '9'; });
}

std::optional<Drawing> drawingOn(const std::vector<std::string>& where, const fs::path& folder) {
    for (const fs::directory_entry& entry : fs::directory_iterator("/proc")) {
        const std::string name = entry.path().filename();
        if (!isNumber(name) || fileOfProcess(entry.path() / "comm") != "quarn\n" ||
            !hasClaim(std::stoi(name), folder))
            continue;
        for (const std::string& node : where) {
            if (isTaskOf(entry.path(), node))
                return Drawing{node, std::stoi(name)};
        }
    }
    return std::nullopt;
}

} // namespace

const std::vector<std::string>& nodes() {
    static const std::vector<std::string> names = {"n1", "n2", "n3", "n4"};
    return names;
}

Start onCluster(std::vector<std::string> arguments) {
    Start start;
    start.arguments = std::move(arguments);
    start.environment["SLURM_CONF"] = (FOLDER / "slurm.conf").string();
    return start;
}

std::string slurm(std::vector<std::string> words) {
    Start start = onCluster(std::move(words));
    start.program = "/usr/bin/env";
    const Ended ended = run(start);
    EXPECT_EQ(ended.exit_code, 0) << start.arguments.front() << ": " << ended.err;
    return ended.out;
}

void cluster(const std::string& command, const std::string& node) {
    Start start;
    start.arguments = {command, FOLDER.string()};
    if (!node.empty())
        start.arguments.push_back(node);
    start.program = QUARN_SOURCE_DIR "/tests/farm/cluster";
    const Ended ended = run(start);
    EXPECT_EQ(ended.exit_code, 0) << command << " " << node << ": " << ended.err;
}

void setEnvironmentOf(const std::string& node, const std::string& lines) {
    const fs::path file = FOLDER / ("env-" + node);
    if (lines.empty())
        fs::remove(file);
    else
        writeFile(file, lines);
}

bool waitUntil(double seconds, const std::function<bool()>& condition) {
    const auto end = std::chrono::steady_clock::now() + std::chrono::duration<double>(seconds);
    while (!condition()) {
        if (std::chrono::steady_clock::now() > end)
            return false;
        std::this_thread::sleep_for(BETWEEN_LOOKS);
    }
    return true;
}

bool waitUntilAllJobsEnded(double seconds) {
    return waitUntil(seconds, [] {
        std::this_thread::sleep_for(10 * BETWEEN_LOOKS);
        return slurm({"squeue", "--noheader"}).empty();
    });
}

std::optional<Drawing> waitUntilDrawing(const std::vector<std::string>& where,
                                        const fs::path& folder) {
    std::optional<Drawing> found;
    waitUntil(LONGEST_START_S, [&] { return (found = drawingOn(where, folder)).has_value(); });
    return found;
}

} // namespace quarn::test
