#include "host/front_end/ScriptedFrontEnd.h"

#include <algorithm>
#include <chrono>
#include <thread>

namespace quarn {

namespace {

/// Takes the front of a queue; nothing when it is empty.
template <class Choice> std::optional<Choice> next(std::deque<Choice>& queue) {
    if (queue.empty())
        return std::nullopt;
    std::optional<Choice> front = std::move(queue.front());
    queue.pop_front();
    return front;
}

} // namespace

ScriptedFrontEnd::ScriptedFrontEnd() = default;

ScriptedFrontEnd::~ScriptedFrontEnd() = default;

void ScriptedFrontEnd::addAnswer(std::wstring_view answer) {
    Answer::Kind kind = Answer::Kind::text;
    if (answer == L"_Enter")
        kind = Answer::Kind::enter;
    else if (answer == L"_Cancel")
        kind = Answer::Kind::cancel;
    m_answers.push_back({kind, kind == Answer::Kind::text ? answer : std::wstring_view()});
}

void ScriptedFrontEnd::addFolderChoice(std::optional<std::filesystem::path> folder) {
    m_folder_choices.push_back(std::move(folder));
}

void ScriptedFrontEnd::addDialog(HeadlessDialogWindow::Script script) {
    m_dialog_scripts.push_back(std::move(script));
}

void ScriptedFrontEnd::addLocationChoice(std::optional<Place> place) {
    m_location_choices.push_back(place);
}

void ScriptedFrontEnd::addFileChoice(FileChoice choice) {
    m_file_choices.push_back(std::move(choice));
}

void ScriptedFrontEnd::setKeyDown(int virtual_key, bool down) {
    std::erase(m_keys_down, virtual_key);
    if (down)
        m_keys_down.push_back(virtual_key);
}

void ScriptedFrontEnd::interrupt() {
    m_interrupted = true;
}

const std::wstring& ScriptedFrontEnd::printed() const {
    return m_printed;
}

void ScriptedFrontEnd::clearPrinted() {
    m_printed.clear();
}

const std::vector<Question>& ScriptedFrontEnd::questions() const {
    return m_questions;
}

const std::vector<ScriptedFrontEnd::Message>& ScriptedFrontEnd::messages() const {
    return m_messages;
}

const std::vector<DialogTemplate>& ScriptedFrontEnd::dialogs() const {
    return m_dialogs;
}

const std::vector<ScriptedFrontEnd::FolderQuestion>& ScriptedFrontEnd::folderQuestions() const {
    return m_folder_questions;
}

const std::vector<ScriptedFrontEnd::LocationQuestion>& ScriptedFrontEnd::locationQuestions() const {
    return m_location_questions;
}

const std::vector<FileQuestion>& ScriptedFrontEnd::fileQuestions() const {
    return m_file_questions;
}

const std::vector<RecordingReport>& ScriptedFrontEnd::recordings() const {
    return m_recordings;
}

unsigned long long ScriptedFrontEnd::waited_ms() const {
    return m_waited_ms;
}

void ScriptedFrontEnd::print(std::wstring_view text) {
    m_printed += text;
}

Answer ScriptedFrontEnd::ask(const Question& question) {
    m_questions.push_back(question);
    return next(m_answers).value_or(Answer{});
}

int ScriptedFrontEnd::showMessage(std::wstring_view text, std::wstring_view title, unsigned flags) {
    m_messages.push_back({std::wstring(text), std::wstring(title), flags});
    return 1;
}

std::optional<std::filesystem::path>
ScriptedFrontEnd::chooseFolder(std::wstring_view title, std::wstring_view message,
                               const std::filesystem::path& start_folder) {
    m_folder_questions.push_back({std::wstring(title), std::wstring(message), start_folder});
    return next(m_folder_choices).value_or(std::nullopt);
}

void ScriptedFrontEnd::pumpEvents(unsigned milliseconds) {
    m_waited_ms += milliseconds;
    std::this_thread::sleep_for(std::chrono::milliseconds(milliseconds));
}

bool ScriptedFrontEnd::isKeyDown(int virtual_key) {
    return std::ranges::find(m_keys_down, virtual_key) != m_keys_down.end();
}

bool ScriptedFrontEnd::isInterrupted() const {
    return m_interrupted;
}

HWND ScriptedFrontEnd::mainWindow() {
    return nullptr;
}

void ScriptedFrontEnd::frameWritten(const std::filesystem::path&, int, int) {}

void ScriptedFrontEnd::recordingEnded(const RecordingReport& report) {
    m_recordings.push_back(report);
}

std::unique_ptr<DialogWindow> ScriptedFrontEnd::makeDialog(const DialogTemplate& form, HWND) {
    m_dialogs.push_back(form);
    auto script = next(m_dialog_scripts);
    return script ? std::make_unique<HeadlessDialogWindow>(form, std::move(*script)) : nullptr;
}

std::optional<Place> ScriptedFrontEnd::chooseLocation(std::wstring_view title, const Place& start) {
    m_location_questions.push_back({std::wstring(title), start});
    return next(m_location_choices).value_or(std::nullopt);
}

FileChoice ScriptedFrontEnd::chooseFile(const FileQuestion& question) {
    m_file_questions.push_back(question);
    return next(m_file_choices).value_or(FileChoice{});
}

} // namespace quarn
