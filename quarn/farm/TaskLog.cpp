#include "quarn/farm/TaskLog.h"

#include "quarn/words/Words.h"

#include <fstream>
#include <iterator>
#include <sstream>

namespace quarn::program {

namespace {

const std::string OURS = "[quarn farm] ";
const std::string BEGAN = " began on ";
const std::string ENDED_WITH = " ended with ";
const std::string QUARN = "quarn: ";
const std::string DUE_TO = " DUE TO ";
const std::string OUT_OF_MEMORY = "oom";

/// What stands behind a mark, up to an end; empty where the mark is not there.
std::string behind(const std::string& line, const std::string& mark, const std::string& end) {
    const std::size_t found = line.find(mark);
    if (found == std::string::npos)
        return "";
    const std::string rest = line.substr(found + mark.size());
    return rest.substr(0, rest.find(end));
}

void readOurs(const std::string& line, std::vector<TaskAttempt>& attempts) {
    if (const std::string node = behind(line, BEGAN, ":"); !node.empty())
        attempts.push_back({.node = node, .exit_code = std::nullopt, .words = ""});
    else if (const auto code = wholeNumber(behind(line, ENDED_WITH, " "));
             code && !attempts.empty())
        attempts.back().exit_code = code;
}

void readWords(const std::string& line, TaskAttempt& attempt) {
    const bool is_slurms = line.starts_with("slurmstepd");
    if (line.starts_with(QUARN))
        attempt.words = line;
    else if (is_slurms && line.find(OUT_OF_MEMORY) != std::string::npos)
        attempt.words = "it took more memory than Slurm gave it";
    else if (const std::string reason = behind(line, DUE_TO, " ***"); is_slurms && !reason.empty())
        attempt.words = "ended by Slurm because of " + reason;
}

} // namespace

std::vector<TaskAttempt> readTaskLog(const std::string& text) {
    std::vector<TaskAttempt> attempts;
    std::istringstream lines(text);
    for (std::string line; std::getline(lines, line);) {
        if (line.starts_with(OURS))
            readOurs(line, attempts);
        else if (!attempts.empty())
            readWords(line, attempts.back());
    }
    return attempts;
}

std::vector<TaskAttempt> taskAttempts(const std::filesystem::path& log) {
    std::ifstream stream(log, std::ios::binary);
    return readTaskLog({std::istreambuf_iterator<char>(stream), {}});
}

} // namespace quarn::program
