#include "quarn/runs/SunHoursRun.h"

#include "host/session/ViewFrame.h"
#include "quarn/runs/OutputFolder.h"
#include "quarn/session/Interruption.h"
#include "quarn/words/Words.h"

#include <chrono>
#include <cmath>

namespace quarn::program {

namespace {

using Clock = std::chrono::steady_clock;

/// Shows how much is done and how long the rest will take.
class SunProgress {
public:
    explicit SunProgress(ConsoleFrontEnd& front_end) : m_front_end(front_end) {}

    bool operator()(double share) {
        const double seconds = std::chrono::duration<double>(Clock::now() - m_start).count();
        std::string text = "hours of sun " + std::to_string(static_cast<int>(100.0 * share)) + " %";
        constexpr double TELLING_SHARE = 0.02;
        if (share > TELLING_SHARE)
            text += ", " +
                    std::to_string(static_cast<long>(std::ceil(seconds / share * (1.0 - share)))) +
                    " s left";
        m_front_end.showStep(text);
        return !isInterruptionRequested();
    }

private:
    ConsoleFrontEnd& m_front_end;
    Clock::time_point m_start = Clock::now();
};

/// Views are fitted to the size that the picture will have.
std::optional<Outcome> aim(const SunHoursWish& wish, HostSession& host) {
    if (wish.hours.is_plan)
        return std::nullopt;
    const auto setSize = [&] {
        setFrameSize(activeView(host.session().document()), wish.hours.width_px,
                     wish.hours.height_px);
    };
    setSize();
    for (const std::string& line : linesFor(wish.view, isDocument(wish.model))) {
        if (auto trouble = host.run(line))
            return trouble;
        setSize();
    }
    return std::nullopt;
}

std::string toldText(const SunHoursWish& wish, const SunHoursFiles& made) {
    std::string text;
    for (const std::filesystem::path& file : made.files)
        text += file.native() + "\n";
    for (const std::string& note : wish.notes)
        text += note + ".\n";
    if (made.steps == 0)
        return text + "The sun does not rise there in this time: all hours are 0.\n";
    const int minutes = static_cast<int>(std::lround(60.0 * made.most_hours));
    return text + std::to_string(made.steps) + " steps with the sun above the horizon, at most " +
           std::to_string(minutes / 60) + " h " + std::to_string(minutes % 60) +
           " min of sun a day; each begin and end of sun is known to " +
           std::to_string((wish.hours.every_minutes + 1) / 2) + " min.\n";
}

} // namespace

Outcome writeSunHours(const SunHoursWish& wish) {
    if (const auto why = whyFolderCannotBeUsed(wish.hours.folder))
        return Outcome::failure(*why);
    for (const std::filesystem::path& file : sunHoursFiles(wish.hours))
        if (const auto refusal = whyNotReplaced(file, wish.common.overwrites))
            return Outcome::failure(*refusal);
    watchForInterruption();
    ConsoleFrontEnd front_end(printsFor(wish.common));
    HostSession host(front_end, wish.common);
    if (const auto trouble = host.runReading(readingLine(wish.model, wish.up_axis), wish.model))
        return *trouble;
    if (const auto trouble = aim(wish, host))
        return *trouble;
    const auto made = makeSunHours(host.session().document(), wish.hours, SunProgress(front_end));
    front_end.clearProgress();
    if (!made)
        return Outcome::failure(made.message());
    if (made.value().is_given_up)
        return stopped("Stopped before anything was written.");
    return Outcome::success(toldText(wish, made.value()));
}

} // namespace quarn::program
