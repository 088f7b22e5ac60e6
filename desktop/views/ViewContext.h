#pragma once

namespace quarn {
class Session;
}

namespace quarn::desktop {

class CommandPane;
class CommandStarter;

/// What the parts of a view work with. All of it outlives them.
struct ViewContext {
    Session& session;
    CommandStarter& starter;
    CommandPane& pane;

    /// Whether views may be drawn and their cameras moved now: no command runs, or the one that
    /// runs waits for an answer. One that plays or records moves them itself.
    bool areViewsFree() const;
};

} // namespace quarn::desktop
