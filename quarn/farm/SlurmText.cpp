#include "quarn/farm/SlurmText.h"

#include "quarn/words/Words.h"

#include <algorithm>
#include <array>
#include <cctype>
#include <cmath>
#include <set>
#include <sstream>
#include <string_view>

namespace quarn::program {

namespace {

const std::set<std::string> DIED = {"BOOT_FAIL",     "DEADLINE",  "FAILED", "NODE_FAIL",
                                    "OUT_OF_MEMORY", "PREEMPTED", "TIMEOUT"};
const std::set<std::string> ENDED = {"CANCELLED", "COMPLETED", "REVOKED"};

constexpr int MOST_TASKS = 4'000'000; // as many as Slurm can be set to take

bool startsKey(std::string_view word) {
    const std::size_t end = word.find('=');
    return end != std::string_view::npos && end > 0 && std::isupper(word[0]) &&
           std::all_of(word.begin(), word.begin() + static_cast<long>(end), [](unsigned char c) {
               return std::isalnum(c) || c == '/' || c == ':' || c == '_';
           });
}

/// The value behind a key, up to the next key. The first one counts: paths stand behind all that is
/// asked for, whatever they hold.
std::string valueOf(const std::string& key, const std::string& line) {
    std::istringstream words(line);
    std::string value;
    bool is_inside = false;
    for (std::string word; std::getline(words, word, ' ');) {
        if (is_inside && startsKey(word))
            return value;
        if (is_inside)
            value += " " + word;
        else if (word.starts_with(key + "=")) {
            is_inside = true;
            value = word.substr(key.size() + 1);
        }
    }
    return value;
}

std::string unlessNull(const std::string& value) {
    return value == "(null)" || value == "None assigned" ? "" : value;
}

/// Reads "3", or "3-40,50%5": what waits together, and how many of them may run at a time.
std::vector<int> taskNumbers(const std::string& text) {
    std::vector<int> numbers;
    std::istringstream parts(text.substr(0, text.find('%')));
    for (std::string part; std::getline(parts, part, ',');) {
        const std::size_t hyphen = part.find('-');
        const auto first = wholeNumber(part.substr(0, hyphen));
        const auto last =
            hyphen == std::string::npos ? first : wholeNumber(part.substr(hyphen + 1));
        if (!first || !last || *last - *first > MOST_TASKS)
            continue;
        for (int number = *first; number <= *last; ++number)
            numbers.push_back(number);
    }
    return numbers;
}

SlurmJob jobOf(const std::string& line) {
    SlurmJob job;
    const std::string array = valueOf("ArrayJobId", line);
    job.id = array.empty() ? valueOf("JobId", line) : array;
    job.tasks = taskNumbers(valueOf("ArrayTaskId", line));
    job.state = valueOf("JobState", line);
    job.reason = valueOf("Reason", line);
    job.node = unlessNull(valueOf("NodeList", line));
    job.exit_code = valueOf("ExitCode", line);
    job.restarts = wholeNumber(valueOf("Restarts", line)).value_or(0);
    return job;
}

std::vector<std::string> split(const std::string& text, char mark) {
    std::vector<std::string> parts;
    std::istringstream stream(text);
    for (std::string part; std::getline(stream, part, mark);)
        parts.push_back(part);
    return parts;
}

/// @param setting  "MaxArraySize            = 1001"
void readLimit(const std::string& setting, const std::string& name, int& limit) {
    std::istringstream words(setting);
    std::string key;
    std::string equals;
    std::string value;
    words >> key >> equals >> value;
    if (key == name)
        limit = std::max(1, wholeNumber(value).value_or(limit));
}

std::string withoutStart(std::string text, const std::vector<std::string>& starts) {
    for (const std::string& start : starts)
        if (const std::size_t found = text.find(start); found != std::string::npos)
            text.erase(0, found + start.size());
    return text;
}

/// Days, hours, minutes and seconds; the parts that a text leaves out are 0.
using TimeParts = std::array<std::string, 4>;

TimeParts timeParts(const std::string& time) {
    const std::size_t hyphen = time.find('-');
    const bool has_days = hyphen != std::string::npos;
    const auto clock = split(has_days ? time.substr(hyphen + 1) : time, ':');
    const auto part = [&](std::size_t i) { return i < clock.size() ? clock[i] : "0"; };
    if (clock.size() > 3 || clock.empty() || time.ends_with(':'))
        return {};
    if (has_days)
        return {time.substr(0, hyphen), part(0), part(1), part(2)};
    if (clock.size() == 3)
        return {"0", part(0), part(1), part(2)};
    return {"0", "0", part(0), part(1)};
}

} // namespace

bool SlurmJob::isLive() const {
    return !DIED.contains(state) && !ENDED.contains(state);
}

bool SlurmJob::hasDied() const {
    return DIED.contains(state);
}

std::vector<SlurmJob> readJobs(const std::string& text) {
    std::vector<SlurmJob> jobs;
    for (const std::string& line : split(text, '\n'))
        if (line.starts_with("JobId="))
            jobs.push_back(jobOf(line));
    return jobs;
}

std::vector<SlurmJob> readAccounts(const std::string& text) {
    std::vector<SlurmJob> jobs;
    for (const std::string& line : split(text, '\n')) {
        const auto fields = split(line, '|');
        if (fields.size() < 3 || fields[0].empty() || !std::isdigit(fields[0][0]))
            continue;
        const std::size_t mark = fields[0].find('_');
        SlurmJob job;
        job.id = fields[0].substr(0, mark);
        if (mark != std::string::npos)
            job.tasks = taskNumbers(fields[0].substr(mark + 1));
        job.state = fields[1].substr(0, fields[1].find(' ')); // "CANCELLED by 1000"
        job.exit_code = fields[2];
        job.node = fields.size() > 3 ? unlessNull(fields[3]) : "";
        jobs.push_back(job);
    }
    return jobs;
}

SlurmLimits readLimits(const std::string& text) {
    SlurmLimits limits;
    for (const std::string& setting : split(text, '\n')) {
        readLimit(setting, "MaxArraySize", limits.array_size);
        readLimit(setting, "MaxJobCount", limits.jobs);
    }
    return limits;
}

std::string refusalText(const std::string& error_output) {
    std::string text;
    for (const std::string& line : split(error_output, '\n')) {
        const std::string said =
            withoutStart(line, {"fatal: ", "error: ", "Batch job submission failed: "});
        if (!said.empty() && text.find(said) == std::string::npos)
            text += (text.empty() ? "" : "; ") + said;
    }
    return text;
}

std::optional<double> limitSeconds(const std::string& time) {
    double seconds = 0.0;
    constexpr std::array<double, 4> PART_S = {86400.0, 3600.0, 60.0, 1.0};
    const TimeParts parts = timeParts(time);
    for (std::size_t i = 0; i < parts.size(); ++i) {
        const auto number = wholeNumber(parts[i]);
        if (!number || *number < 0)
            return std::nullopt;
        seconds += *number * PART_S[i];
    }
    if (seconds <= 0.0)
        return std::nullopt;
    return std::ceil(seconds / 60.0) * 60.0;
}

} // namespace quarn::program
