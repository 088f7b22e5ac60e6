// The commands that have a cluster record.
#include "quarn/arguments/FilmArguments.h"
#include "quarn/arguments/HelpTexts.h"
#include "quarn/arguments/Readings.h"
#include "quarn/arguments/RecordingArguments.h"
#include "quarn/arguments/Subcommands.h"
#include "quarn/farm/FarmStatus.h"
#include "quarn/farm/SlurmText.h"
#include "quarn/farm/Submission.h"

namespace quarn::program {

namespace {

using Path = std::filesystem::path;

constexpr int MOST_TASKS = 1'000'000;
constexpr int MOST_CPUS = 4096;
constexpr double LONGEST_FRAME_S = 1e6;

struct AskedFarm {
    FarmRequest request;
    CommonOptions common;
};

Reading<std::string> timeLimit() {
    return [](const std::string& option,
              const std::string& word) -> std::variant<std::string, Refusal> {
        if (!limitSeconds(word))
            return mustBe(
                option, "a time as Slurm takes it, such as 90 (minutes), 1:30:00 or 2-12:00", word);
        return word;
    };
}

/// What stands in the job script and on Slurm's command line as one word.
Reading<std::string> plainWord() {
    return [](const std::string& option,
              const std::string& word) -> std::variant<std::string, Refusal> {
        if (word.empty() || hasControlCharacter(word))
            return mustBe(option, "a word without control characters", word);
        return word;
    };
}

Reading<Path> folderOfNodes() {
    return [](const std::string& option, const std::string& word) -> std::variant<Path, Refusal> {
        if (const auto refusal = whyPathIsRefused("the path of " + option, word))
            return Refusal{*refusal};
        if (!Path(word).is_absolute())
            return mustBe(option, "a path from the root, as it is on every node", word);
        return Path(word);
    };
}

void addSharing(const OptionAdder& add, FarmRequest& request) {
    CLI::Option* const tasks =
        add("--tasks", request.chunks.tasks, "N", wholeNumberFrom(1, MOST_TASKS),
            "Share the frames out to so many tasks (default: tasks of about 5 minutes)");
    CLI::Option* const chunk = add("--chunk", request.chunks.chunk_frames, "N", wholeNumberFrom(1),
                                   "Or: so many frames for each task");
    tasks->excludes(chunk);
    add("--frame-time", request.frame_s, "SECONDS", numberFrom(0.001, LONGEST_FRAME_S, "seconds"),
        "What a frame takes (default: one is drawn here, to measure it)");
}

void addJobOptions(const OptionAdder& add, FarmRequest& request) {
    add("--partition", request.partition, "NAME", plainWord(),
        "Partition of the cluster (default: its own)");
    add("--time", request.time, "TIME", timeLimit(),
        "How long a task may run, as Slurm takes it: minutes, or 1:30:00 (default: the "
        "partition's)");
    add("--cpus", request.cpus, "N", wholeNumberFrom(1, MOST_CPUS),
        "Processors and threads of a task", "1");
    add("--retries", request.retries, "N", numberOfRetries(),
        "How often the last job tries frames again that are missing", "2");
    add("--stage", request.stage, "DIR", folderOfNodes(),
        "Copy the document once a node into this folder of the node's own disk, such as /tmp");
    add("--instructions", request.instructions, "NAME", oneOf({"avx512", "avx2", "sse2"}),
        "Draw with this instruction set on all nodes: avx512, avx2 or sse2 (default: that of the "
        "task that begins first)");
}

std::optional<std::string> settle(FarmRequest& request) {
    if (auto mistake = whyFilmIsMisused(request.film))
        return mistake;
    request.chunks.limit_s = limitSeconds(request.time).value_or(0.0);
    const auto settlePath = [](Path& path) {
        if (!path.empty())
            path = std::filesystem::absolute(path).lexically_normal();
        if (!path.has_filename())
            path = path.parent_path(); // what a slash at the end leaves
    };
    settlePath(request.document);
    settlePath(request.folder);
    settlePath(request.film.file);
    return std::nullopt;
}

Outcome submitAsked(AskedFarm& asked) {
    asked.request.overwrites = asked.common.overwrites;
    if (const auto mistake = settle(asked.request))
        return Outcome::misuse(*mistake);
    return submitToFarm(asked.request, asked.common);
}

Action addSubmit(CLI::App& command) {
    const auto asked = std::make_shared<AskedFarm>();
    FarmRequest& request = asked->request;
    const OptionAdder add(command);
    add("DOC", request.document, "", savedDocument(),
        "The document with its animation, a .quarn file that all nodes can read")
        ->required();
    add("--out", request.folder, "DIR", scriptWord("the path of --out"),
        "Folder for the pictures and the page, which all nodes can write")
        ->required();
    addSharing(add, request);
    addJobOptions(add, request);
    addViewer(command, request.viewer);
    addRecordingFilm(command, request.film, FilmTimes::perhaps);
    command.add_flag("--overwrite", asked->common.overwrites,
                     "Make all frames anew, whatever is there; the first one is made here");
    command.add_flag("--dry-run", request.is_only_shown,
                     "Print the job script and the commands that would submit it, and do nothing");
    return [asked] { return submitAsked(*asked); };
}

Action addStatus(CLI::App& command) {
    const auto folder = std::make_shared<Path>();
    const auto is_json = std::make_shared<bool>(false);
    const OptionAdder add(command);
    add("DIR", *folder, "", scriptWord("the folder's path"),
        "The folder of --out, or the file NAME.farm.json in it")
        ->required();
    command.add_flag("--json", *is_json, "Tell it to a program, as JSON");
    return [=] { return tellFarmStatus(*folder, *is_json ? StatusForm::json : StatusForm::text); };
}

Action addCancel(CLI::App& command) {
    const auto folder = std::make_shared<Path>();
    const OptionAdder add(command);
    add("DIR", *folder, "", scriptWord("the folder's path"),
        "The folder of --out, or the file NAME.farm.json in it")
        ->required();
    return [=] { return cancelFarm(*folder); };
}

struct FarmSubcommand {
    const char* name;
    const char* summary;
    const char* footer;
    Action (*add)(CLI::App& command);
};

constexpr FarmSubcommand FARM_SUBCOMMANDS[] = {
    {"submit", "Share out the frames of a document's animation, and submit them", SUBMIT_FOOTER,
     addSubmit},
    {"status", "Tell how far the frames of a folder are", STATUS_FOOTER, addStatus},
    {"cancel", "Cancel the jobs of a folder; its frames stay", CANCEL_FOOTER, addCancel},
};

} // namespace

Action addFarm(CLI::App& command) {
    command.require_subcommand(0, 1);
    std::vector<std::pair<const CLI::App*, Action>> actions;
    for (const FarmSubcommand& subcommand : FARM_SUBCOMMANDS) {
        CLI::App& added = *command.add_subcommand(subcommand.name, subcommand.summary);
        added.footer(subcommand.footer);
        added.allow_extras();
        actions.emplace_back(&added, subcommand.add(added));
    }
    return [actions] {
        for (const auto& [subcommand, action] : actions)
            if (subcommand->parsed())
                return action();
        return Outcome::misuse("say what to do: quarn farm submit, quarn farm status or quarn farm "
                               "cancel (quarn farm --help tells more)");
    };
}

} // namespace quarn::program
