#include "quarn/session/HostSession.h"

#include "quarn/session/InstalledTree.h"
#include "quarn/session/Interruption.h"
#include "quarn/terminal/ShownText.h"
#include "quarn/words/Words.h"

#include <cstdio>
#include <sstream>

namespace quarn::program {

namespace {

SessionOptions sessionOptions(const CommonOptions& common, HostSession::Use use) {
    SessionOptions options;
    options.plug_in_folders = {plugInFolder()};
    options.locale_folders = {hostLocaleFolder()};
    options.language = common.language;
    options.dialog_folders = {dialogFolder()};
    options.viewer_folder = viewerFolder();
    options.overwrites = common.overwrites;
    options.most_memory = common.most_memory;
    options.most_threads = common.most_threads;
    options.instructions = common.instructions;
    options.builds_scenes = use == HostSession::Use::pictures;
    return options;
}

/// A command that reads a model tells what is wrong with it, and in its last line what it holds.
void tellDefects(const std::string& words, const std::string& model) {
    std::istringstream stream(words);
    std::string defect;
    std::getline(stream, defect);
    for (std::string next; std::getline(stream, next); defect = next)
        std::fprintf(stderr, "quarn: %s: %s\n", shownText(model).c_str(),
                     shownText(defect).c_str());
}

} // namespace

HostSession::HostSession(ConsoleFrontEnd& front_end, const CommonOptions& common, Use use)
    : m_front_end(front_end), m_session(front_end, sessionOptions(common, use)) {}

std::optional<Outcome> HostSession::loadAnimationPlugIn() {
    const PlugInLoad load = m_session.loadPlugIn(plugInFolder() / "Zoetrix.qnp");
    if (load.ok())
        return std::nullopt;
    const bool is_missing = load.outcome == PlugInLoad::Outcome::file_missing;
    return Outcome::failure(load.message +
                            (is_missing ? " Install the program with all its files." : ""));
}

std::optional<Outcome> HostSession::run(const std::string& line) {
    if (isInterruptionRequested())
        return stopped("Stopped before anything was recorded.");
    m_front_end.forgetLastWords();
    const CQuarnCommand::result result = m_session.runCommand(KM_wString::FromUtf8(line).View());
    if (result == CQuarnCommand::success)
        return std::nullopt;
    const std::string words = m_front_end.closingWords();
    return Outcome::failure(words.empty() ? "this command failed: " + line : words);
}

std::optional<Outcome> HostSession::readModel(const std::filesystem::path& model) {
    return runReading(readingLine(model), model);
}

std::optional<Outcome> HostSession::runReading(const std::string& line,
                                               const std::filesystem::path& model) {
    m_front_end.showStep("reading " + model.filename().native());
    m_front_end.keepWords();
    const std::optional<Outcome> trouble = run(line);
    const std::string words = m_front_end.takeKeptWords();
    m_front_end.clearProgress();
    if (trouble && isInterruptionRequested())
        return stopped("Stopped while " + model.filename().native() + " was read.");
    if (trouble)
        return trouble;
    if (m_front_end.hidesWords())
        tellDefects(words, model.filename().native());
    else
        m_front_end.print(wideText(words));
    return std::nullopt;
}

ConsoleFrontEnd::Prints printsFor(const CommonOptions& common) {
    return common.is_verbose ? ConsoleFrontEnd::Prints::shown : ConsoleFrontEnd::Prints::hidden;
}

Outcome stopped(const std::string& message) {
    return {interruptionExitCode(), message};
}

} // namespace quarn::program
