#include "host/app/CommandRunner.h"

#include "ground/PathText.h"
#include "ground/TextLines.h"
#include "host/app/Application.h"
#include "host/app/RecordingScope.h"
#include "host/border/Border.h"
#include "host/sun/MissingSun.h"

#include <algorithm>

namespace quarn {

namespace {

const char* wordFor(CQuarnCommand::result result) {
    if (result == CQuarnCommand::cancel)
        return "was cancelled";
    return result == CQuarnCommand::nothing ? "did nothing" : "failed";
}

std::string utf8(std::wstring_view text) {
    return KM_wString(text).ToUtf8();
}

/// The number of the first line with a control character other than a tab, from 1; 0: none has one.
std::size_t lineThatIsNoText(const std::vector<std::wstring>& lines) {
    const auto is_control = [](wchar_t c) { return (c < 0x20 && c != L'\t') || c == 0x7F; };
    for (std::size_t index = 0; index < lines.size(); ++index)
        if (std::ranges::any_of(lines[index], is_control))
            return index + 1;
    return 0;
}

bool isSkipped(std::wstring_view line) {
    const std::size_t first = line.find_first_not_of(L" \t");
    return first == line.npos || line[first] == L'#';
}

} // namespace

std::wstring RunningCommand::label() const {
    const std::wstring own_name(name.View());
    return place.empty() ? own_name : place + L": " + own_name;
}

std::wstring RunningCommand::wordsLeft() const {
    std::wstring left;
    for (const CommandWord& word : words)
        left += (left.empty() ? L"" : L" ") + word.text;
    return left;
}

CQuarnCommand::result CommandRunner::run(std::wstring_view line, const CommandOrigin& origin) {
    if (const RunningCommand* running = outermost()) {
        m_application.tell(running->name.ToUtf8() + " is running; wait until it has ended.");
        return CQuarnCommand::failure;
    }
    return start(line, origin);
}

CQuarnCommand::result CommandRunner::runNested(std::wstring_view line,
                                               const CommandOrigin& origin) {
    const RunningCommand* running = current();
    if (!running || !running->command->IsScriptCommand()) {
        reportBreach("CQuarnApp::RunScript", "only a running CQuarnScriptCommand may call it");
        return CQuarnCommand::failure;
    }
    return start(line, origin);
}

CQuarnCommand::result CommandRunner::start(std::wstring_view line, const CommandOrigin& origin) {
    Result<CommandLine> parsed = parseCommandLine(line);
    if (!parsed) {
        m_application.tell(parsed.message());
        return CQuarnCommand::failure;
    }
    CommandLine& read = parsed.value();
    if (read.isBlank())
        return CQuarnCommand::success;
    const RegisteredCommand* found = m_application.commands().find(read.name, read.english_name);
    if (!found) {
        m_application.tell("Unknown command: " + utf8(read.name) + ". Type Help for the list.");
        return CQuarnCommand::failure;
    }
    RunningCommand running{found->command, found->english_name, origin.place, std::move(read.words),
                           origin.typed};
    if (m_running.empty() && m_before_command)
        m_before_command();
    if (m_running.empty())
        (void)takeMissingSun(); // of what was computed before
    const CQuarnCommand::result result =
        execute(running, origin, origin.interactive && !read.without_dialogs);
    if (result == CQuarnCommand::success)
        tellUnusedWords(running);
    if (m_running.empty())
        tellMissingSun(running);
    if (m_running.empty())
        m_application.documents().commandEnded();
    return result;
}

CQuarnCommand::result CommandRunner::execute(RunningCommand& running, const CommandOrigin& origin,
                                             bool interactive) {
    const CQuarnCommandContext context(*origin.document, interactive);
    if (m_running.empty())
        m_application.documents().commandStarted();
    m_running.push_back(&running);
    const Result<CQuarnCommand::result> ended = acrossBorder([&] {
        const RecordingScope recording(m_application, *running.command, *origin.document);
        return running.command->RunCommand(context);
    });
    m_running.pop_back();
    if (ended && ended.value() == CQuarnCommand::failure)
        m_application.print(running.likely_mistake.View());
    if (ended)
        return ended.value();
    m_application.tell(utf8(running.label()) + " stopped with an error: " + ended.message());
    return CQuarnCommand::failure;
}

void CommandRunner::tellUnusedWords(const RunningCommand& running) {
    if (!running.words.empty())
        m_application.tell(utf8(running.label() + L" did not use: " + running.wordsLeft()));
}

/// A study asks for many suns; one line says why they are not there.
void CommandRunner::tellMissingSun(const RunningCommand& running) {
    if (const std::optional<KM_wString> why = takeMissingSun())
        m_application.print(running.label() + L": " + std::wstring(why->View()));
}

std::optional<std::string> CommandRunner::runFile(const std::filesystem::path& file) {
    const Result<std::vector<std::wstring>> lines = readTextLines(file);
    if (!lines)
        return lines.message();
    if (const std::size_t number = lineThatIsNoText(lines.value()))
        return textFromPath(file).ToUtf8() + " is no script: line " + std::to_string(number) +
               " holds control characters. A script is a text file with a command on each line.";
    return runLines(lines.value(), std::wstring(textFromPath(file.filename()).View()));
}

std::optional<std::string> CommandRunner::runLines(const std::vector<std::wstring>& lines,
                                                   const std::wstring& file_name) {
    for (std::size_t index = 0; index < lines.size(); ++index) {
        if (isSkipped(lines[index]))
            continue;
        const std::wstring place = file_name + L", line " + std::to_wstring(index + 1);
        if (m_application.frontEnd().isInterrupted())
            return "Stopped before " + utf8(place) + ".";
        CQuarnDoc& document = m_application.documents().active()->face();
        const CQuarnCommand::result result = run(lines[index], {&document, false, place});
        if (result != CQuarnCommand::success)
            return utf8(place) + ": " + utf8(lines[index]) + ": " + wordFor(result) + ".";
        if (m_application.isExitRequested())
            return std::nullopt;
    }
    return std::nullopt;
}

} // namespace quarn
