#pragma once

#include "host/session/Recovery.h"
#include "quarn/console/TerminalFrontEnd.h"

#include <optional>
#include <string>

namespace quarn::program {

/// Keeps the unsaved work of a person at the console for recovery, and offers that of earlier runs.
class UnsavedWork {
public:
    /// Looks after the work while lines are waited for.
    /// @param lines    where the lines come from, as long as this lives
    /// @param options  nothing: nothing is kept and nothing offered
    UnsavedWork(Session& session, TerminalFrontEnd& front_end, LineSource& lines,
                const std::optional<RecoveryOptions>& options);
    ~UnsavedWork();
    UnsavedWork(const UnsavedWork&) = delete;
    UnsavedWork& operator=(const UnsavedWork&) = delete;

    /// Tells what earlier runs have left, and how to get it back.
    void offer() const;
    /// To be called between commands: keeps what is due, and tells what hinders that.
    void look();
    /// Keeps all, for a program that was told to end.
    /// @return what the person has to know of it; empty: there was no unsaved work
    std::string keepForNextStart();

private:
    Session& m_session;
    TerminalFrontEnd& m_front_end;
    LineSource& m_lines;
    std::optional<RecoveryOptions> m_options;
    std::optional<RecoveryKeeper> m_keeper;
};

} // namespace quarn::program
