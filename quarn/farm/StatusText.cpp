#include "quarn/farm/FarmStatus.h"

#include "quarn/session/RecordingText.h"
#include "quarn/terminal/FramePace.h"

#include <algorithm>
#include <map>
#include <nlohmann/json.hpp>

namespace quarn::program {

namespace {

using Json = nlohmann::ordered_json;
using Stage = FarmTask::Stage;

constexpr std::size_t MOST_LINES = 20; // of one kind: thousands of tasks die of one reason

/// What the writers of a node have done together.
struct NodeWork {
    int frames = 0;
    double seconds = 0.0;
};

std::map<std::string, NodeWork> workOfNodes(const FarmStatus& status) {
    std::map<std::string, NodeWork> nodes;
    for (const RecordingWriter& writer : status.recorded.progress.writers) {
        nodes[writer.host].frames += writer.frames;
        nodes[writer.host].seconds += writer.seconds;
    }
    return nodes;
}

std::string framesText(const FarmStatus& status) {
    const int missing = static_cast<int>(status.recorded.progress.missing.size());
    if (!status.recorded.trouble.empty())
        return status.record.name + ": " + status.recorded.trouble + "\n";
    const int frames = status.recorded.progress.frames;
    std::string text = status.record.name + ": " + std::to_string(frames - missing) + " of " +
                       frameCountText(frames) + " are there";
    if (missing > 0)
        text += ", " + std::to_string(missing) + (missing == 1 ? " is" : " are") + " missing";
    return text + (status.isFinished() ? ", and the page.\n" : ".\n");
}

std::string tasksText(const FarmStatus& status) {
    const int running = status.count(Stage::running);
    std::string text = std::to_string(running) + (running == 1 ? " task runs, " : " tasks run, ") +
                       std::to_string(status.count(Stage::waiting)) + " wait, " +
                       std::to_string(status.count(Stage::done)) + " are done, " +
                       std::to_string(status.count(Stage::died)) + " ended early";
    if (const double left = status.secondsLeft(); left > 0.0)
        text += "; about " + timeText(left) + " left";
    return text + ".\n";
}

std::string nodesText(const FarmStatus& status) {
    std::string text;
    for (const auto& [host, work] : workOfNodes(status)) {
        text += "  " + host + ": " + frameCountText(work.frames);
        if (work.frames > 0)
            text += ", " + timeText(work.seconds / work.frames) + " a frame";
        text += "\n";
    }
    return text.empty() ? "" : "On the nodes:\n" + text;
}

std::string taskText(const FarmTask& task) {
    return "  " + task.id + (task.frames.empty() ? " (the last job)" : " (" + task.frames + ")");
}

/// @param lines  as many as there are, of which the first are told
std::string told(const std::string& title, const std::vector<std::string>& lines) {
    std::string text = lines.empty() ? "" : title + ":\n";
    for (std::size_t i = 0; i < std::min(lines.size(), MOST_LINES); ++i)
        text += lines[i] + "\n";
    if (lines.size() > MOST_LINES)
        text += "  and " + std::to_string(lines.size() - MOST_LINES) + " more\n";
    return text;
}

std::string deathsText(const FarmStatus& status) {
    std::vector<std::string> died;
    std::vector<std::string> former;
    for (const FarmTask& task : status.tasks) {
        if (task.stage == Stage::died)
            died.push_back(taskText(task) + (task.node.empty() ? "" : " on " + task.node) + ": " +
                           task.reason);
        for (const std::string& end : task.former)
            former.push_back(taskText(task) + " " + end);
    }
    return told("Ended early", died) + told("Ended early and were started again", former);
}

std::string waitingText(const FarmStatus& status) {
    std::map<std::string, int> reasons;
    for (const FarmTask& task : status.tasks)
        if (task.stage == Stage::waiting && !task.reason.empty() && task.reason != "None")
            ++reasons[task.reason];
    std::vector<std::string> lines;
    for (const auto& [reason, count] : reasons)
        lines.push_back("  " + reason + ": " + std::to_string(count));
    return told("Wait for", lines);
}

std::string endText(const FarmStatus& status) {
    if (status.isDone() || status.goesOn())
        return "";
    if (!status.slurm_trouble.empty())
        return "Whether anything goes on is not known.\n";
    return status.isFinished() ? "Not all that was to be made of the frames is there.\n"
                               : "Nothing goes on: quarn farm submit records what is missing.\n";
}

const char* stageName(Stage stage) {
    switch (stage) {
    case Stage::waiting:
        return "waiting";
    case Stage::running:
        return "running";
    case Stage::done:
        return "done";
    case Stage::died:
        return "died";
    }
    return "";
}

Json tasksJson(const FarmStatus& status) {
    Json tasks = Json::array();
    for (const FarmTask& task : status.tasks)
        tasks.push_back({{"id", task.id},
                         {"frames", task.frames},
                         {"stage", stageName(task.stage)},
                         {"node", task.node},
                         {"reason", task.reason},
                         {"former", task.former}});
    return tasks;
}

Json nodesJson(const FarmStatus& status) {
    Json nodes = Json::array();
    for (const auto& [host, work] : workOfNodes(status))
        nodes.push_back({{"name", host}, {"frames", work.frames}, {"seconds", work.seconds}});
    return nodes;
}

} // namespace

std::string statusText(const FarmStatus& status) {
    std::string text = framesText(status);
    if (!status.slurm_trouble.empty())
        text +=
            "Slurm does not answer: " + status.slurm_trouble + " This is what the folder tells.\n";
    text += tasksText(status) + nodesText(status) + deathsText(status) + waitingText(status);
    if (const int lost = status.framesLost(); lost > 0)
        text += frameCountText(lost) + " of tasks that ended early " + (lost == 1 ? "is" : "are") +
                " missing.\n";
    return text + endText(status);
}

std::string statusJson(const FarmStatus& status) {
    const RecordingProgress& progress = status.recorded.progress;
    const Json json = {
        {"name", status.record.name},
        {"frames", status.record.frames},
        {"missing", status.recorded.trouble.empty() ? Json(progress.missing) : Json()},
        {"is_finished", status.isFinished()},
        {"goes_on", status.goesOn()},
        {"seconds_left", status.secondsLeft()},
        {"slurm_trouble", status.slurm_trouble},
        {"nodes", nodesJson(status)},
        {"tasks", tasksJson(status)}};
    return json.dump(1, ' ', false, Json::error_handler_t::replace) + "\n";
}

} // namespace quarn::program
