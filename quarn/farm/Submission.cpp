#include "quarn/farm/Submission.h"

#include "ground/AtomicFile.h"
#include "host/session/FilmCheck.h"
#include "quarn/farm/FarmPlan.h"
#include "quarn/farm/FarmRecord.h"
#include "quarn/farm/FrameMeasure.h"
#include "quarn/farm/JobScript.h"
#include "quarn/farm/SlurmCommands.h"
#include "quarn/runs/OutputFolder.h"
#include "quarn/session/Interruption.h"
#include "quarn/words/Words.h"

#include <algorithm>
#include <cstdio>
#include <ctime>
#include <span>
#include <sstream>

namespace quarn::program {

namespace {

using Words = std::vector<std::string>;

/// The commands that submit a plan; the last one needs the ids of the others.
class Commands {
public:
    Commands(const FarmPlan& plan, const FarmRequest& request, const FarmFiles& files,
             const SlurmLimits& limits)
        : m_files(files), m_options{plan.name,         request.folder.native(),
                                    request.partition, request.time,
                                    request.cpus,      warningSeconds(plan.cost)} {
        const int tasks = static_cast<int>(plan.chunks.size());
        for (int first = 0; first < tasks; first += limits.array_size)
            m_arrays.push_back({"", first, std::min(limits.array_size, tasks - first)});
    }

    const std::vector<SubmittedArray>& arrays() const { return m_arrays; }
    Words array(const SubmittedArray& array) const {
        return arrayWords(m_options, array.tasks, logPattern(m_files.logs.native(), "%A_%a.log"),
                          {m_files.script.native(), "frames", std::to_string(array.first)});
    }
    Words last(const Words& ids) const {
        return followingWords(m_options, ids, logPattern(m_files.logs.native(), "%j.log"),
                              {m_files.script.native(), "finish"});
    }

private:
    FarmFiles m_files;
    JobOptions m_options;
    std::vector<SubmittedArray> m_arrays;
};

std::string now() {
    const std::time_t time = std::time(nullptr);
    char text[32] = "";
    std::tm parts{};
    std::strftime(text, sizeof text, "%Y-%m-%dT%H:%M:%SZ", gmtime_r(&time, &parts));
    return text;
}

std::string asComment(const std::string& text) {
    std::string comment;
    std::istringstream lines(text);
    for (std::string line; std::getline(lines, line);)
        comment += "# " + line + "\n";
    return comment;
}

/// The commands as they can be pasted: the ids of the arrays are asked for on the way.
std::string dryRunText(const Commands& commands, const FarmFiles& files, const std::string& plan,
                       const std::string& script) {
    std::string text = script + "\n# ---- This script would be " +
                       shellWord(files.script.native()) + ".\n" + asComment(plan) +
                       "# It would be submitted with:\n" +
                       shellCommand({"mkdir", "-p", files.logs.native()}) + "\n";
    Words names;
    std::string variables;
    for (const SubmittedArray& array : commands.arrays()) {
        names.push_back("array" + std::to_string(names.size() + 1));
        variables += ":\"$" + names.back() + "\"";
        text += names.back() + "=$(" + shellCommand(commands.array(array)) + ")\n";
    }
    Words last = commands.last(names);
    last.erase(last.begin() + 1); // its dependency, which shells put together
    std::string command = shellCommand(last);
    command.insert(command.find(' '), " --dependency=afterany" + variables);
    return text + command + "\n";
}

Result<void> writeScript(const FarmFiles& files, const std::string& text) {
    std::error_code error;
    std::filesystem::create_directories(files.logs, error);
    if (error)
        return Error{"cannot make the folder " + files.logs.native() + ": " + error.message() +
                     "."};
    if (auto written = writeFileAtomically(files.script, std::as_bytes(std::span(text))); !written)
        return written;
    using enum std::filesystem::perms;
    std::filesystem::permissions(files.script, owner_exec, std::filesystem::perm_options::add,
                                 error);
    return {};
}

/// Submits all jobs of a plan, or none: what was submitted before one was refused is cancelled.
Result<void> submitAll(const Commands& commands, const FarmFiles& files, FarmRecord& record) {
    const auto take = [&](const Words& words, auto keep) -> Result<void> {
        const auto id = submitJob(words);
        if (!id)
            return id.error();
        keep(id.value());
        return writeFarmRecord(files.record, record);
    };
    Result<void> taken;
    for (SubmittedArray array : commands.arrays()) {
        taken = take(commands.array(array), [&](const std::string& id) {
            array.id = id;
            record.arrays.push_back(array);
        });
        if (!taken)
            break;
    }
    if (taken)
        taken = take(commands.last(record.ids()),
                     [&](const std::string& id) { record.finish_id = id; });
    if (!taken)
        for (const std::string& id : record.ids())
            (void)cancelJob(id); // what counts is why it is cancelled
    return taken;
}

std::optional<std::string> whyRefused(const FarmRequest& request) {
    std::error_code error;
    if (!std::filesystem::is_regular_file(request.document, error))
        return "there is no document " + request.document.native() + ".";
    const FilmRequest& film = request.film;
    if (!film.file.empty())
        if (const auto refusal =
                whyFilmIsRefused({film.file, film.frame_rate, film.quality, film.has_caption,
                                  request.overwrites, request.folder}))
            return refusal;
    if (request.is_only_shown)
        return std::nullopt;
    if (const auto missing = whySlurmIsMissing())
        return missing;
    return whyFolderCannotBeUsed(request.folder);
}

Outcome submit(const FarmPlan& plan, const FarmRequest& request, const Commands& commands,
               const FarmFiles& files, const std::string& script) {
    if (isInterruptionRequested())
        return stopped("Stopped before anything was submitted.");
    FarmRecord record{.name = plan.name,
                      .document = request.document.native(),
                      .submitted = now(),
                      .frames = plan.frames,
                      .cost = plan.cost,
                      .command = commands.array(commands.arrays().front())};
    for (const std::vector<int>& frames : plan.chunks)
        record.chunks.push_back(rangesText(frames));
    if (request.overwrites)
        if (const auto trouble = beginAnew(request))
            return *trouble;
    if (const auto written = writeScript(files, script); !written)
        return Outcome::failure(written.message());
    if (const auto submitted = submitAll(commands, files, record); !submitted)
        return Outcome::failure(submitted.message());
    std::string ids;
    for (const SubmittedArray& array : record.arrays)
        ids += (ids.empty() ? "" : ", ") + array.id;
    return Outcome::success("Submitted as " + ids + ", and " + record.finish_id +
                            ", which writes the page in the end.\nquarn farm status " +
                            shellWord(request.folder.native()) + " tells how far it is.");
}

/// The script can be looked at where there is no cluster.
Result<SlurmLimits> limitsFor(const FarmRequest& request) {
    auto limits = request.is_only_shown && whySlurmIsMissing() ? SlurmLimits{} : slurmLimits();
    return request.is_only_shown && !limits ? SlurmLimits{} : limits;
}

} // namespace

Outcome submitToFarm(const FarmRequest& request, const CommonOptions& common) {
    watchForInterruption();
    if (const auto refusal = whyRefused(request))
        return Outcome::failure(*refusal);
    const auto limits = limitsFor(request);
    if (!limits)
        return Outcome::failure(limits.message());
    const auto planned = planFarm(request, common, limits.value());
    if (const Outcome* const end = std::get_if<Outcome>(&planned))
        return *end;
    const auto& plan = std::get<FarmPlan>(planned);
    const FarmFiles files(request.folder, plan.name);
    const Commands commands(plan, request, files, limits.value());
    const std::string script = jobScriptText(request, {programFile(), plan.name, plan.chunks});
    const std::string told = planText(plan, request);
    if (request.is_only_shown)
        return Outcome::success(dryRunText(commands, files, told, script));
    std::fputs(told.c_str(), stdout);
    return submit(plan, request, commands, files, script);
}

} // namespace quarn::program
