#include "host/session/Recovery.h"

namespace quarn {

// Nothing is kept and found yet; the answers say so.

struct RecoveryKeeper::State {};

RecoveryKeeper::RecoveryKeeper(Session&, RecoveryOptions) : m_state(std::make_unique<State>()) {}

RecoveryKeeper::~RecoveryKeeper() = default;

void RecoveryKeeper::beat() {}

std::optional<std::string> RecoveryKeeper::keepNow() {
    return "Unsaved work cannot be kept yet.";
}

void RecoveryKeeper::forget() {}

std::optional<std::string> RecoveryKeeper::takeTrouble() {
    return std::nullopt;
}

std::vector<RecoverableDocument> recoverableDocuments(const RecoveryOptions&) {
    return {};
}

std::optional<std::string> recover(Session&, const RecoverableDocument&) {
    return "Documents cannot be recovered yet.";
}

void discard(const RecoverableDocument&) {}

} // namespace quarn
