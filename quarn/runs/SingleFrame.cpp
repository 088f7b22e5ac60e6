#include "quarn/runs/SingleFrame.h"

#include "quarn/session/HostSession.h"
#include "quarn/session/Interruption.h"
#include "quarn/words/Words.h"

namespace quarn::program {

namespace {

/// The first mistake of what was typed, before anything runs.
std::optional<std::string> mistakeIn(const FrameOptions& options) {
    if (auto refusal = whyPathIsRefused("the document's path", options.document))
        return refusal;
    if (!isDocument(options.document))
        return options.document + " is no document: give the .quarn file that --save wrote.";
    if (wholeNumber(options.number).value_or(-1) < 0)
        return "--number must be a whole number from 0, not \"" + options.number + "\".";
    if (!options.size.empty() && !pictureSize(options.size))
        return sizeMistake(options.size);
    return whyPathIsRefused("the path of --out", options.file);
}

/// The line that reads the document and the one that writes the frame.
/// @param options  without a mistake
std::vector<std::string> composeFrame(const FrameOptions& options) {
    std::string line = "_-SaveFrame ";
    if (const std::optional<PixelSize> size = pictureSize(options.size))
        line +=
            "_Size " + std::to_string(size->width_px) + " " + std::to_string(size->height_px) + " ";
    line += std::to_string(wholeNumber(options.number).value_or(0));
    return {readingLine(options.document), line + " " + quotedPath(options.file)};
}

Outcome runFrame(const FrameOptions& options, const std::vector<std::string>& script) {
    watchForInterruption();
    ConsoleFrontEnd front_end(printsFor(options.common));
    HostSession host(front_end, options.common);
    if (const auto trouble = host.loadAnimationPlugIn())
        return *trouble;
    if (const auto trouble = host.runReading(script.front(), options.document))
        return *trouble;
    if (const auto trouble = host.run(script.back()))
        return *trouble;
    return Outcome::success("frame " + options.number + " in " + options.file);
}

} // namespace

Outcome writeSingleFrame(const FrameOptions& options) {
    if (const auto mistake = mistakeIn(options))
        return Outcome::misuse(*mistake);
    const std::vector<std::string> script = composeFrame(options);
    if (!options.shows_script)
        return runFrame(options, script);
    std::string text;
    for (const std::string& line : script)
        text += line + "\n";
    return Outcome::success(text);
}

} // namespace quarn::program
