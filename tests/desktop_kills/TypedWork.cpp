#include "tests/desktop_kills/TypedWork.h"

#include "host/front_end/ScriptedFrontEnd.h"
#include "host/session/DocumentState.h"
#include "host/session/Recovery.h"
#include "host/session/Session.h"

#include <algorithm>
#include <functional>
#include <sstream>
#include <stdexcept>

namespace quarn::test {

TypedWork::TypedWork() {
    for (const char* const name : {"work", "state", "run"})
        std::filesystem::create_directories(m_home / name);
    std::filesystem::permissions(m_home / "run", std::filesystem::perms::owner_all);
}

Start TypedWork::start(const std::vector<std::string>& options) const {
    Start start;
    start.program = QUARN_DESKTOP_PROGRAM;
    start.arguments = options;
    start.folder = m_home.path();
    start.environment = {
        {"HOME", m_home.path()},
        {"XDG_CONFIG_HOME", m_home / "config"},
        {"XDG_DATA_HOME", m_home / "data"},
        {"XDG_STATE_HOME", m_home / "state"},
        {"XDG_RUNTIME_DIR", m_home / "run"},
        {"QT_QPA_PLATFORM", "offscreen"},
        {"QT_QPA_PLATFORMTHEME", ""},
        {"QT_QPA_GENERIC_PLUGINS", "windowtypist"},
        {"QT_PLUGIN_PATH", QUARN_TYPIST_FOLDER},
        {"QUARN_TYPIST_FOLDER", folder()},
        {"LC_ALL", "C.UTF-8"},
    };
    return start;
}

void TypedWork::begin(const std::vector<std::string>& options) {
    m_program = std::make_unique<RunningProgram>(start(options));
    if (!m_program->waitUntil([this] { return has("done"); }))
        throw std::runtime_error("nothing was typed: " + m_program->wait().err);
}

Ended TypedWork::stop(int signal) {
    m_program->sendSignal(signal);
    return m_program->wait();
}

/// What is looked at while it works may have changed when it is killed.
bool TypedWork::holdWhereUnsavedWorkIsKept() {
    return m_program->waitUntil([this] {
        m_program->sendSignal(SIGSTOP);
        if (keepsUnsavedWork())
            return true;
        m_program->sendSignal(SIGCONT);
        return false;
    });
}

bool TypedWork::keepsUnsavedWork() const {
    namespace fs = std::filesystem;
    std::error_code gone;
    const fs::file_time_type saved_at = fs::last_write_time(file(), gone);
    for (const auto& entry : fs::directory_iterator(folder()))
        if (entry.path().extension() == ".recovery")
            return entry.last_write_time(gone) > saved_at;
    return false;
}

bool TypedWork::isRecoverable() const {
    return std::ranges::any_of(recoverableDocuments({.state_folder = stateFolder()}),
                               std::not_fn(fileIsNewer));
}

Ended TypedWork::recover(const std::vector<std::string>& options) {
    Start again = start(options);
    const bool is_there = !recoverableDocuments({.state_folder = stateFolder()}).empty();
    again.environment["QUARN_TYPIST_RECOVERS"] = is_there ? "something" : "nothing";
    return run(again);
}

/// A last line that the kill cut off says nothing.
std::vector<TypedWork::Note> TypedWork::notes() const {
    std::istringstream journal(readFile(folder() / "journal"));
    std::vector<Note> notes;
    for (std::string line; std::getline(journal, line) && !journal.eof();) {
        std::istringstream words(line);
        Note note;
        long long when_ms = 0;
        words >> note.what >> note.point >> when_ms;
        note.when = Clock::time_point(std::chrono::milliseconds(when_ms));
        notes.push_back(note);
    }
    return notes;
}

bool TypedWork::has(const std::string& what) const {
    return std::ranges::any_of(notes(), [&](const Note& note) { return note.what == what; });
}

int TypedWork::last(const std::string& what) const {
    int point = 0;
    for (const Note& note : notes())
        if (note.what == what)
            point = note.point;
    return point;
}

int TypedWork::doneUntil(Clock::time_point when) const {
    int point = 0;
    for (const Note& note : notes())
        if (note.what == "done" && note.when <= when)
            point = note.point;
    return point;
}

std::optional<int> objectsIn(const std::filesystem::path& file) {
    ScriptedFrontEnd front_end;
    Session session(front_end, SessionOptions{});
    const std::wstring line = L"_-Open \"" + file.wstring() + L'"';
    if (session.runCommand(line) != CQuarnCommand::success)
        return std::nullopt;
    return objectCount(session.document());
}

} // namespace quarn::test
