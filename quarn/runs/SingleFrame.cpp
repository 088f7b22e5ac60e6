#include "quarn/runs/SingleFrame.h"

#include "quarn/session/Interruption.h"
#include "quarn/words/Words.h"

namespace quarn::program {

namespace {

std::string savingLine(const FrameRequest& request) {
    std::string line = "_-SaveFrame ";
    if (const auto& size = request.size)
        line +=
            "_Size " + std::to_string(size->width_px) + " " + std::to_string(size->height_px) + " ";
    return line + std::to_string(request.number) + " " + quotedPath(request.file);
}

} // namespace

Outcome writeSingleFrame(const FrameRequest& request, const ScriptUse& use) {
    const std::string reading = readingLine(request.document);
    const std::string saving = savingLine(request);
    if (use.is_only_shown)
        return Outcome::success(reading + "\n" + saving + "\n");
    watchForInterruption();
    ConsoleFrontEnd front_end(printsFor(use.common));
    HostSession host(front_end, use.common);
    if (const auto trouble = host.loadAnimationPlugIn())
        return *trouble;
    if (const auto trouble = host.runReading(reading, request.document))
        return *trouble;
    if (const auto trouble = host.run(saving))
        return *trouble;
    return Outcome::success("frame " + std::to_string(request.number) + " in " +
                            request.file.native());
}

} // namespace quarn::program
