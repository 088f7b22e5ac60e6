#include "quarn/farm/FarmPlan.h"

#include "host/session/AnimationState.h"
#include "host/session/RecordingProgress.h"
#include "quarn/farm/FarmRecord.h"
#include "quarn/farm/FrameMeasure.h"
#include "quarn/farm/SlurmCommands.h"
#include "quarn/session/RecordingText.h"
#include "quarn/terminal/FramePace.h"

#include <algorithm>
#include <numeric>

namespace quarn::program {

namespace {

/// What submitting needs to know of a document.
struct StoredAnimation {
    std::string name;
    int frames = 0;
};

std::variant<StoredAnimation, Outcome> readAnimation(const FarmRequest& request,
                                                     const CommonOptions& common) {
    ConsoleFrontEnd front_end(printsFor(common));
    HostSession host(front_end, common, HostSession::Use::numbers);
    if (const auto trouble = host.loadAnimationPlugIn())
        return *trouble;
    if (const auto trouble = host.readModel(request.document))
        return *trouble;
    const AnimationState state = animationState(host.session().document());
    if (!state.can_play)
        return Outcome::failure(request.document.native() +
                                " has no animation to record: make it with --save of a recording, "
                                "such as quarn turntable.");
    return StoredAnimation{state.name.ToUtf8(), state.frame_count};
}

/// What the folder holds of the animation.
struct FoundFrames {
    RecordingProgress recorded; ///< where there is one
    bool are_there = false;     ///< there is a recording, whole or not
    std::vector<int> missing;
};

bool isOther(const RecordingProgress& recorded, const RecordingProgress& wanted) {
    return recorded.document_mark != wanted.document_mark ||
           recorded.settings_mark != wanted.settings_mark;
}

/// Two arrays that record the same frames would only wait for each other.
std::optional<std::string> whyStillAtWork(const FarmRequest& request, const std::string& name) {
    const FarmFiles files(request.folder, name);
    if (!std::filesystem::exists(files.record))
        return std::nullopt;
    const auto record = readFarmRecord(files.record);
    if (!record)
        return record.message();
    const auto jobs = slurmJobs(record.value().ids());
    if (!jobs)
        return jobs.message();
    for (const SlurmJob& job : jobs.value())
        if (job.isLive())
            return "job " + job.id + " still records " + record.value().name + " into " +
                   request.folder.native() +
                   "; quarn farm status with this folder tells how far it is, and quarn farm "
                   "cancel ends it.";
    return std::nullopt;
}

std::vector<int> allFrames(int count) {
    std::vector<int> frames(static_cast<std::size_t>(count));
    std::iota(frames.begin(), frames.end(), 0);
    return frames;
}

FoundFrames foundFrames(const FarmRequest& request, const StoredAnimation& animation) {
    const auto file = request.folder / (animation.name + ".recording");
    const auto none = FoundFrames{{}, false, allFrames(animation.frames)};
    if (!std::filesystem::exists(file))
        return none;
    const RecordingProgressResult recorded = recordingProgress(file);
    if (!recorded.trouble.empty())
        return none; // the tasks will see what is wrong with it
    return {recorded.progress, true, recorded.progress.missing};
}

/// Draws a frame, which tells its cost and whether the folder's frames are of the same recording.
/// @return how the program ends where nothing can be submitted
std::optional<Outcome> measure(const FarmRequest& request, const StoredAnimation& animation,
                               const FoundFrames& found, FrameCost& cost) {
    const auto measured = measureFrame(request, animation.frames / 2);
    if (const Outcome* const trouble = std::get_if<Outcome>(&measured))
        return *trouble;
    const auto& frame = std::get<MeasuredFrame>(measured);
    cost = frame.cost;
    if (request.overwrites || !found.are_there || !isOther(found.recorded, frame.recording))
        return std::nullopt;
    return Outcome::failure(request.folder.native() + " holds " + animation.name +
                            " as the document or a setting was before it changed; give "
                            "--overwrite to record it anew, or another --out.");
}

Outcome nothingMissing(const RecordingProgress& recorded, const FarmRequest& request) {
    const std::string folder = request.folder.native();
    if (recorded.is_finished)
        return Outcome::success("All " + frameCountText(recorded.frames) + " are in " + folder +
                                ", and nothing was submitted.");
    return Outcome::success("All " + frameCountText(recorded.frames) + " are in " + folder +
                            ", and nothing was submitted; quarn finish with this folder writes "
                            "the page.");
}

bool isMeasured(const FarmRequest& request) {
    return !request.frame_s && request.chunks.tasks == 0 && request.chunks.chunk_frames == 0;
}

std::variant<FarmPlan, Outcome> shared(FarmPlan plan, const std::vector<int>& missing,
                                       const FarmRequest& request, const SlurmLimits& limits) {
    const int most = limits.jobs - 1; // the last job is one more
    if (most < 1)
        return Outcome::failure("the cluster takes no more jobs now; submit later.");
    auto chunks = shareOut(missing, request.chunks, plan.cost, most);
    if (!chunks)
        return Outcome::failure(chunks.message());
    plan.missing = static_cast<int>(missing.size());
    plan.chunks = std::move(chunks.value());
    return plan;
}

std::string costText(const FarmPlan& plan, const FarmRequest& request) {
    if (plan.cost.frame_s <= 0.0)
        return "How long a frame takes was not measured.";
    const std::string frame = "A frame takes " + timeText(plan.cost.frame_s);
    if (request.frame_s)
        return frame + ", as --frame-time says.";
    return frame + " with " + std::to_string(request.cpus) +
           (request.cpus == 1 ? " thread" : " threads") + ", after " +
           timeText(plan.cost.loading_s) + " of loading; measured here.";
}

} // namespace

std::variant<FarmPlan, Outcome> planFarm(const FarmRequest& request, const CommonOptions& common,
                                         const SlurmLimits& limits) {
    const auto read = readAnimation(request, common);
    if (const Outcome* const trouble = std::get_if<Outcome>(&read))
        return *trouble;
    const auto& animation = std::get<StoredAnimation>(read);
    if (!request.is_only_shown)
        if (const auto refusal = whyStillAtWork(request, animation.name))
            return Outcome::failure(*refusal);
    const FoundFrames found = foundFrames(request, animation);
    if (found.missing.empty() && !request.overwrites)
        return nothingMissing(found.recorded, request);
    FarmPlan plan{.name = animation.name, .frames = animation.frames};
    plan.cost.frame_s = request.frame_s.value_or(0.0);
    if (isMeasured(request))
        if (const auto trouble = measure(request, animation, found, plan.cost))
            return *trouble;
    return shared(plan, request.overwrites ? allFrames(animation.frames) : found.missing, request,
                  limits);
}

std::string planText(const FarmPlan& plan, const FarmRequest& request) {
    const std::size_t tasks = plan.chunks.size();
    const std::size_t most =
        std::ranges::max_element(plan.chunks, {}, &std::vector<int>::size)->size();
    std::string text = costText(plan, request) + "\n" + frameCountText(plan.missing) + " of " +
                       std::to_string(plan.frames) + (plan.missing == 1 ? " is" : " are") +
                       " missing: " + std::to_string(tasks) + (tasks == 1 ? " task" : " tasks") +
                       " of up to " + frameCountText(static_cast<int>(most));
    if (plan.cost.frame_s > 0.0)
        text += ", " +
                timeText(plan.cost.loading_s + plan.cost.frame_s * static_cast<double>(most)) +
                " each";
    return text + ".\n";
}

} // namespace quarn::program
