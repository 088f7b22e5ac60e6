#pragma once

#include "sdk/qncore/QnCommand.h"

#include <utility>

/// Tells why a command could not be finished, in which case nothing was stored: that memory lacks,
/// or what else went wrong. To be called while the exception is handled. Throws nothing.
void ReportUnfinishedCommand() noexcept;

/// Runs the body of a command, which returns how the command ended. What it throws (an animation
/// that memory cannot hold) ends here with a message, as no exception may reach the host.
template <class Body> CQuarnCommand::result RunGuarded(Body&& body) noexcept {
    try {
        return static_cast<CQuarnCommand::result>(std::forward<Body>(body)());
    } catch (...) {
        ReportUnfinishedCommand();
        return CQuarnCommand::failure;
    }
}
