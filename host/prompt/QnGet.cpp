#include "sdk/qncore/QnGet.h"

#include "host/prompt/NumberText.h"
#include "host/prompt/PromptAsking.h"
#include "host/prompt/PromptState.h"

#include <algorithm>
#include <cmath>

namespace {

using quarn::Question;

/// A limit that is no number limits nothing.
double limitOf(double limit) {
    return std::isnan(limit) ? KM_UNSET_VALUE : limit;
}

} // namespace

// ---- CQuarnGet

CQuarnGet::CQuarnGet() : m_state(std::make_unique<quarn::PromptState>()) {}

CQuarnGet::~CQuarnGet() = default;

void CQuarnGet::SetCommandPrompt(const wchar_t* prompt) {
    m_state->prompt = prompt;
}

void CQuarnGet::AcceptNothing(bool accept) {
    m_state->accepts_nothing = accept;
}

void CQuarnGet::SetDefaultString(const wchar_t* text) {
    m_state->default_answer = text;
}

int CQuarnGet::AddCommandOption(const CQuarnCommandOptionName& name) {
    return m_state->addOption({name, std::nullopt, std::nullopt});
}

int CQuarnGet::AddCommandOption(const CQuarnCommandOptionName& name,
                                const CQuarnCommandOptionValue& value) {
    return m_state->addOption({name, value, std::nullopt});
}

int CQuarnGet::AddCommandOptionToggle(const CQuarnCommandOptionName& name,
                                      const CQuarnCommandOptionValue& off_value,
                                      const CQuarnCommandOptionValue& on_value, bool current,
                                      bool* variable) {
    const quarn::PromptOption::Toggle toggle{off_value, on_value, current, variable};
    const int index = m_state->addOption({name, std::nullopt, toggle});
    if (index != 0 && variable)
        *variable = current;
    return index;
}

void CQuarnGet::ClearCommandOptions() {
    m_state->options.clear();
}

CQuarnGet::result CQuarnGet::Result() const {
    return m_state->result;
}

CQuarnCommand::result CQuarnGet::CommandResult() const {
    return m_state->command_result;
}

const CQuarnCommandOption* CQuarnGet::Option() const {
    return m_state->result == option ? &m_state->picked : nullptr;
}

// ---- CQuarnGetOption

CQuarnGetOption::CQuarnGetOption() {
    m_state->kind = Question::Kind::option;
}

CQuarnGetOption::~CQuarnGetOption() = default;

void CQuarnGetOption::AcceptString(bool accept) {
    m_state->accepts_text = accept;
}

CQuarnGet::result CQuarnGetOption::GetOption() {
    return quarn::askQuestion(*m_state, "CQuarnGetOption::GetOption");
}

const wchar_t* CQuarnGetOption::String() const {
    return m_state->text;
}

// ---- CQuarnGetString

CQuarnGetString::CQuarnGetString() {
    m_state->kind = Question::Kind::string;
}

CQuarnGetString::~CQuarnGetString() = default;

CQuarnGet::result CQuarnGetString::GetString() {
    return quarn::askQuestion(*m_state, "CQuarnGetString::GetString");
}

const wchar_t* CQuarnGetString::String() const {
    return m_state->text;
}

// ---- CQuarnGetNumber

CQuarnGetNumber::CQuarnGetNumber() {
    m_state->kind = Question::Kind::number;
}

CQuarnGetNumber::~CQuarnGetNumber() = default;

void CQuarnGetNumber::SetDefaultNumber(double value) {
    m_state->default_answer = quarn::numberText(value);
    m_state->number = value;
}

void CQuarnGetNumber::SetLowerLimit(double limit, bool) {
    m_state->lower_limit = limitOf(limit);
}

void CQuarnGetNumber::SetUpperLimit(double limit, bool) {
    m_state->upper_limit = limitOf(limit);
}

CQuarnGet::result CQuarnGetNumber::GetNumber() {
    return quarn::askQuestion(*m_state, "CQuarnGetNumber::GetNumber");
}

double CQuarnGetNumber::Number() const {
    return m_state->number;
}

// ---- CQuarnGetInteger

CQuarnGetInteger::CQuarnGetInteger() {
    m_state->kind = Question::Kind::integer;
}

CQuarnGetInteger::~CQuarnGetInteger() = default;

void CQuarnGetInteger::SetDefaultInteger(int value) {
    m_state->default_answer = KM_wString::FormatToString(L"%d", value);
    m_state->whole_number = value;
}

void CQuarnGetInteger::SetLowerLimit(double limit, bool) {
    m_state->lower_limit = limitOf(limit);
}

void CQuarnGetInteger::SetUpperLimit(double limit, bool) {
    m_state->upper_limit = limitOf(limit);
}

CQuarnGet::result CQuarnGetInteger::GetNumber() {
    return quarn::askQuestion(*m_state, "CQuarnGetInteger::GetNumber");
}

int CQuarnGetInteger::Number() const {
    return m_state->whole_number;
}

// ---- CQuarnGetObject

CQuarnGetObject::CQuarnGetObject() {
    m_state->kind = Question::Kind::object;
}

CQuarnGetObject::~CQuarnGetObject() = default;

void CQuarnGetObject::EnablePreSelect(bool enable, bool ignore_unacceptable) {
    m_state->objects.takes_selection = enable;
    m_state->objects.ignores_unacceptable = ignore_unacceptable;
}

void CQuarnGetObject::SetGeometryFilter(unsigned filter) {
    m_state->objects.filter = filter;
}

CQuarnGet::result CQuarnGetObject::GetObjects(int minimum, int maximum) {
    quarn::ObjectPick& pick = m_state->objects;
    pick.minimum = static_cast<std::size_t>(std::max(minimum, 1));
    pick.maximum = maximum <= 0 ? 0 : std::max(static_cast<std::size_t>(maximum), pick.minimum);
    return quarn::askQuestion(*m_state, "CQuarnGetObject::GetObjects");
}

int CQuarnGetObject::ObjectCount() const {
    return static_cast<int>(m_state->objects.ids.size());
}

CQuarnObjRef CQuarnGetObject::Object(int index) const {
    if (index < 0 || index >= ObjectCount())
        return {};
    return CQuarnObjRef(m_state->objects.ids[static_cast<std::size_t>(index)]);
}
