#include "quarn/runs/SunPathRun.h"

#include "host/sunpath/SunPathFile.h"
#include "quarn/runs/OutputFolder.h"
#include "quarn/session/Interruption.h"

namespace quarn::program {

namespace {

std::string doneText(const SunPathOrder& order, const SunPathDrawn& drawn) {
    const SunPathRequest& diagram = order.diagram;
    std::string text = diagram.file.native() + ": sun path of " +
                       (diagram.place.empty() ? "the place" : diagram.place) + " in " +
                       std::to_string(diagram.year) + ", hours of " + drawn.clock_name + ".\n";
    return order.zone_note.empty() ? text : text + order.zone_note + ".\n";
}

} // namespace

Outcome drawSunPath(const SunPathOrder& order) {
    const std::filesystem::path& file = order.diagram.file;
    if (const auto refusal = whyDiagramIsRefused(file))
        return Outcome::misuse(*refusal);
    if (const auto refusal = whyNotReplaced(file, order.common.overwrites))
        return Outcome::failure(*refusal);
    watchForInterruption();
    ConsoleFrontEnd front_end(printsFor(order.common));
    HostSession host(front_end, order.common, HostSession::Use::numbers);
    if (!order.model.empty())
        if (const auto trouble = host.readModel(order.model))
            return *trouble;
    if (isInterruptionRequested())
        return stopped("Stopped before anything was written.");
    const auto drawn = makeSunPath(host.session().document(), order.diagram);
    if (!drawn)
        return Outcome::failure(drawn.message());
    return Outcome::success(doneText(order, drawn.value()));
}

} // namespace quarn::program
