#include "quarn/farm/SlurmCommands.h"

#include "quarn/farm/ProgramRunner.h"
#include "quarn/words/Words.h"

#include <algorithm>

namespace quarn::program {

namespace {

using Words = std::vector<std::string>;

constexpr std::chrono::seconds LONGEST_ANSWER{100}; // Slurm's own commands try for that long

const char* const UNKNOWN_JOB = "Invalid job id specified";

Result<std::string> answer(const Words& words) {
    const ProgramEnd end = runProgram(words, LONGEST_ANSWER);
    if (!end.is_here)
        return Error{words[0] + " is not here; install slurm-client on this machine, or see "
                                "docs/farm.md for other ways."};
    if (end.is_late)
        return Error{words[0] + " did not answer for " + std::to_string(LONGEST_ANSWER.count()) +
                     " s; is the cluster's controller up?"};
    if (end.ok())
        return end.out;
    const std::string refusal = refusalText(end.err);
    return Error{refusal.empty() ? words[0] + " failed and did not say why" : refusal};
}

/// In the names of jobs there is nothing that could be taken for something else where they are
/// listed.
std::string jobName(const std::string& animation) {
    std::string name = "quarn-" + animation;
    std::ranges::replace_if(
        name,
        [](unsigned char c) {
            return !std::isalnum(c) &&
                   std::string_view("-_.").find(static_cast<char>(c)) == std::string_view::npos;
        },
        '_');
    return name;
}

Words withOptions(const JobOptions& options, const std::string& log_pattern) {
    Words words = {"--parsable", "--job-name=" + jobName(options.name), "--chdir=" + options.folder,
                   "--output=" + log_pattern, "--open-mode=append",
                   // Nodes are lost and preempted: frames that are there are not made again.
                   "--requeue", "--signal=B:TERM@" + std::to_string(options.warning_s),
                   "--cpus-per-task=" + std::to_string(options.cpus)};
    if (!options.partition.empty())
        words.push_back("--partition=" + options.partition);
    if (!options.time.empty())
        words.push_back("--time=" + options.time);
    return words;
}

Words operator+(Words words, const Words& more) {
    words.insert(words.end(), more.begin(), more.end());
    return words;
}

std::string joined(const Words& words, const char* mark) {
    std::string text;
    for (const std::string& word : words)
        text += (text.empty() ? "" : mark) + word;
    return text;
}

} // namespace

std::optional<std::string> whySlurmIsMissing() {
    for (const char* const program : {"sbatch", "squeue", "scontrol", "scancel"})
        if (!isProgramHere(program))
            return std::string(program) + " is not here; install slurm-client on this machine, or "
                                          "see docs/farm.md for other ways.";
    return std::nullopt;
}

Result<SlurmLimits> slurmLimits() {
    const auto config = answer({"scontrol", "show", "config"});
    if (!config)
        return Error{"Slurm does not tell what it takes: " + config.message()};
    const auto jobs = answer({"squeue", "--noheader", "--array", "--format=%A"});
    if (!jobs)
        return Error{"Slurm does not tell its jobs: " + jobs.message()};
    SlurmLimits limits = readLimits(config.value());
    limits.jobs -= static_cast<int>(std::ranges::count(jobs.value(), '\n'));
    return limits;
}

Words arrayWords(const JobOptions& options, int tasks, const std::string& log_pattern,
                 const Words& rest) {
    const std::string last = std::to_string(tasks - 1);
    return Words{"sbatch", "--array=0-" + last} + withOptions(options, log_pattern) + rest;
}

Words followingWords(const JobOptions& options, const Words& ids, const std::string& log_pattern,
                     const Words& rest) {
    return Words{"sbatch", "--dependency=afterany:" + joined(ids, ":")} +
           withOptions(options, log_pattern) + rest;
}

std::string logPattern(const std::string& folder, const std::string& file) {
    if (folder.find('\\') != std::string::npos)
        return "/dev/null"; // Slurm takes it for an escape, and replaces nothing any more
    std::string pattern;
    for (const char c : folder)
        pattern += c == '%' ? std::string("%%") : std::string(1, c);
    return pattern + "/" + file;
}

Result<std::string> submitJob(const Words& words) {
    const auto said = answer(words);
    if (!said)
        return Error{"sbatch refused the job: " + said.message()};
    const std::string id = said.value().substr(0, said.value().find_first_of(";\n"));
    if (!wholeNumber(id))
        return Error{"sbatch took the job, but did not tell its number: " + said.value()};
    return id;
}

Result<std::vector<SlurmJob>> slurmJobs(const Words& ids) {
    std::vector<SlurmJob> jobs;
    for (const std::string& id : ids) {
        const auto said = answer({"scontrol", "show", "job", "--oneliner", id});
        if (!said && said.message().find(UNKNOWN_JOB) == std::string::npos)
            return said.error();
        if (!said)
            continue;
        const auto found = readJobs(said.value());
        jobs.insert(jobs.end(), found.begin(), found.end());
    }
    return jobs;
}

std::vector<SlurmJob> accountedJobs(const Words& ids) {
    const auto said =
        answer({"sacct", "--noheader", "--allocations", "--parsable2",
                "--format=JobID,State,ExitCode,NodeList", "--jobs=" + joined(ids, ",")});
    return said ? readAccounts(said.value()) : std::vector<SlurmJob>{};
}

Result<void> cancelJob(const std::string& id) {
    const auto said = answer({"scancel", id});
    if (!said && said.message().find(UNKNOWN_JOB) == std::string::npos)
        return Error{"scancel refused job " + id + ": " + said.message()};
    return {};
}

} // namespace quarn::program
