#include "host/app/CommandRegistry.h"

#include "host/border/Border.h"

#include <algorithm>

namespace quarn {

namespace {

bool isLetterOrDigit(wchar_t character) {
    return (character >= L'a' && character <= L'z') || (character >= L'A' && character <= L'Z') ||
           (character >= L'0' && character <= L'9');
}

bool isCommandName(const KM_wString& name) {
    return !name.IsEmpty() && std::ranges::all_of(name.View(), isLetterOrDigit);
}

bool answersTo(const RegisteredCommand& command, const KM_wString& name) {
    return command.english_name.CompareNoCase(name) == 0 ||
           command.local_name.CompareNoCase(name) == 0;
}

RegisteredCommand describe(CQuarnCommand& command) {
    RegisteredCommand described{&command, command.CommandUUID(), command.EnglishCommandName(),
                                command.LocalCommandName()};
    if (described.local_name.IsEmpty())
        described.local_name = described.english_name;
    return described;
}

} // namespace

Result<void> CommandRegistry::add(CQuarnCommand& command) {
    Result<RegisteredCommand> described = acrossBorder([&] { return describe(command); });
    if (!described)
        return Error{"A command could not be asked for its name: " + described.message()};
    if (Result<void> checked = check(described.value()); !checked)
        return checked;
    m_commands.push_back(std::move(described.value()));
    return {};
}

Result<void> CommandRegistry::check(const RegisteredCommand& candidate) const {
    const std::string name = candidate.english_name.ToUtf8();
    if (!isCommandName(candidate.english_name))
        return Error{"\"" + name + "\" is no command name: it may hold letters and digits only"};
    if (KM_UuidIsNil(candidate.id))
        return Error{"The command " + name + " has no id"};
    for (const RegisteredCommand& other : m_commands) {
        if (other.id == candidate.id)
            return Error{"The id of the command " + name + " belongs to the command " +
                         other.english_name.ToUtf8() + " already"};
        if (answersTo(other, candidate.english_name) || answersTo(other, candidate.local_name))
            return Error{"There is a command " + name + " already"};
    }
    return {};
}

void CommandRegistry::remove(const CQuarnCommand& command) {
    std::erase_if(m_commands,
                  [&](const RegisteredCommand& entry) { return entry.command == &command; });
}

const RegisteredCommand* CommandRegistry::find(std::wstring_view name, bool english_only) const {
    const KM_wString wanted(name);
    for (const RegisteredCommand& entry : m_commands) {
        if (english_only ? entry.english_name.CompareNoCase(wanted) == 0 : answersTo(entry, wanted))
            return &entry;
    }
    return nullptr;
}

std::vector<RegisteredCommand> CommandRegistry::sortedByName() const {
    std::vector<RegisteredCommand> sorted = m_commands;
    std::ranges::sort(sorted, [](const RegisteredCommand& a, const RegisteredCommand& b) {
        return a.english_name.CompareNoCase(b.english_name) < 0;
    });
    return sorted;
}

} // namespace quarn
