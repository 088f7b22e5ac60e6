#include "quarn/runs/SingleFrame.h"

#include "quarn/runs/DocumentRun.h"
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
    std::vector<std::string> lines;
    if (const std::string light = lightAnswers(request.light); !light.empty())
        lines.push_back(renderSettingsLine(light));
    lines.push_back(savingLine(request));
    return runOnDocument(request.document, lines, use, [&](HostSession& host) {
        for (const std::string& line : lines)
            if (const auto trouble = host.run(line))
                return *trouble;
        return Outcome::success("frame " + std::to_string(request.number) + " in " +
                                request.file.native());
    });
}

} // namespace quarn::program
