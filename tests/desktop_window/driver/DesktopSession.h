#pragma once

#include <memory>
#include <string>

namespace quarn::test {

/// A desktop session that programs take part in, by the protocol for it on X ("XSMP", version 1.0):
/// what logging out does to one of them.
class DesktopSession {
public:
    DesktopSession();
    ~DesktopSession();
    DesktopSession(const DesktopSession&) = delete;
    DesktopSession& operator=(const DesktopSession&) = delete;

    /// For the environment variable SESSION_MANAGER.
    const std::string& address() const;

    /// Tells the program that the session is about to end.
    /// @param may_ask  whether it may ask the person something
    void prepareEnd(bool may_ask);
    /// What the program said to that.
    enum class Answer { none, agreed, cancelled };
    Answer answer() const;
    /// Ends the program, which had agreed.
    void end();

private:
    struct State;
    struct Callbacks;
    std::unique_ptr<State> m_state;
};

} // namespace quarn::test
