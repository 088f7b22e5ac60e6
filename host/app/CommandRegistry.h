#pragma once

#include "ground/Result.h"
#include "sdk/qncore/QnCommand.h"

#include <string_view>
#include <vector>

/// Ties a command to its plug-in.
class CQuarnCommandRegistration {
public:
    static void setPlugIn(CQuarnCommand& command, const CQuarnPlugIn* plug_in) {
        command.m_plug_in = plug_in;
    }
};

namespace quarn {

/// A command with its names as they were when it was registered.
struct RegisteredCommand {
    CQuarnCommand* command;
    KM_UUID id;
    KM_wString english_name;
    KM_wString local_name;
};

/// The commands that can be run. The objects belong to those who registered them.
class CommandRegistry {
public:
    /// Registers a command. Refused, with the reason: a nil id, an English name that is empty or
    /// holds anything but letters and digits, and an id or a name, in whatever case, that another
    /// command has already, in either language.
    Result<void> add(CQuarnCommand& command);

    /// Takes a command out; one that is not there is no fault.
    void remove(const CQuarnCommand& command);

    /// The command with this name, ignoring case, or null. Valid until a command comes or goes.
    /// @param english_only  leave local names out
    const RegisteredCommand* find(std::wstring_view name, bool english_only = false) const;

    /// All commands in the order of their English names.
    std::vector<RegisteredCommand> sortedByName() const;

private:
    Result<void> check(const RegisteredCommand& candidate) const;

    std::vector<RegisteredCommand> m_commands;
};

} // namespace quarn
