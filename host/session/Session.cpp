#include "host/session/Session.h"

#include "host/app/Application.h"
#include "host/commands/HostCommands.h"
#include "host/session/InstructionSets.h"
#include "host/share/ShareCommands.h"

namespace quarn {

struct Session::State {
    State(FrontEnd& front_end, SessionOptions options)
        : application(front_end, std::move(options)) {
        tellOfInstructions();
        application.addHostCommands(makeHostCommands());
        application.addHostCommands(makeShareCommands());
    }

    void tellOfInstructions() {
        const std::string& name = application.options().instructions;
        if (const auto refusal = name.empty() ? std::nullopt : whyInstructionsAreRefused(name))
            application.tell(*refusal + " They are drawn with the fastest.");
    }

    Application application;
};

Session::Session(FrontEnd& front_end, SessionOptions options)
    : m_state(std::make_unique<State>(front_end, std::move(options))) {}

Session::~Session() = default;

PlugInLoad Session::loadPlugIn(const std::filesystem::path& file) {
    return m_state->application.plugIns().load(file);
}

PlugInLoad Session::adoptProgramPlugIn() {
    return m_state->application.plugIns().adoptProgram();
}

CQuarnCommand::result Session::runCommand(std::wstring_view line, bool interactive) {
    return m_state->application.runner().run(line, {&document(), interactive, {}, false});
}

CQuarnCommand::result Session::runTypedCommand(std::wstring_view line) {
    return m_state->application.runner().run(line, {&document(), false, {}, true});
}

std::vector<CommandName> Session::commandNames(bool hidden_too) const {
    std::vector<CommandName> names;
    for (const RegisteredCommand& entry : m_state->application.commands().sortedByName()) {
        if (hidden_too || !entry.command->IsHidden())
            names.push_back(
                {entry.english_name, entry.local_name, entry.command->CommandDescription()});
    }
    return names;
}

std::optional<std::string> Session::runScriptFile(const std::filesystem::path& file) {
    return m_state->application.runner().runFile(file);
}

CQuarnDoc& Session::document() {
    return m_state->application.documents().active()->face();
}

bool Session::closeView(std::wstring_view name) {
    Application& application = m_state->application;
    const Result<void> closed = application.documents().active()->closeView(name);
    if (!closed)
        application.tell(closed.message());
    return closed.ok();
}

bool Session::isCommandRunning() const {
    return m_state->application.runner().current() != nullptr;
}

bool Session::isExitRequested() const {
    return m_state->application.isExitRequested();
}

void Session::takeBackExit() {
    m_state->application.takeBackExit();
}

} // namespace quarn
