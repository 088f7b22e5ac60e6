#include "host/front_end/ScriptedFrontEnd.h"

#include <algorithm>
#include <chrono>
#include <thread>

namespace quarn {

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

unsigned long long ScriptedFrontEnd::waited_ms() const {
    return m_waited_ms;
}

void ScriptedFrontEnd::print(std::wstring_view text) {
    m_printed += text;
}

Answer ScriptedFrontEnd::ask(const Question& question) {
    m_questions.push_back(question);
    if (m_answers.empty())
        return {};
    Answer answer = std::move(m_answers.front());
    m_answers.pop_front();
    return answer;
}

int ScriptedFrontEnd::showMessage(std::wstring_view text, std::wstring_view title, unsigned flags) {
    m_messages.push_back({std::wstring(text), std::wstring(title), flags});
    return 1;
}

std::optional<std::filesystem::path>
ScriptedFrontEnd::chooseFolder(std::wstring_view, std::wstring_view, const std::filesystem::path&) {
    if (m_folder_choices.empty())
        return std::nullopt;
    auto choice = std::move(m_folder_choices.front());
    m_folder_choices.pop_front();
    return choice;
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

} // namespace quarn
