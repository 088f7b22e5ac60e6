#include "desktop/recovery/RecoveryOffer.h"

#include "desktop/command_line/CommandStarter.h"
#include "desktop/documents/UnsavedChanges.h"
#include "desktop/recovery/RecoveryDialog.h"
#include "desktop/texts/Texts.h"

#include <algorithm>

namespace quarn::desktop {

RecoveryOffer::RecoveryOffer(Session& session, CommandStarter& starter, UnsavedChanges& changes,
                             RecoveryOptions options, QWidget& window)
    : QObject(&window), m_session(session), m_starter(starter), m_changes(changes),
      m_options(std::move(options)), m_window(window),
      m_action(new QAction(localized(L"Recover &unsaved work…", 45391), this)) {
    m_action->setObjectName("recoverWork");
    connect(m_action, &QAction::triggered, this, &RecoveryOffer::offerAgain);
    connect(&starter, &CommandStarter::started, this, [this] { m_action->setEnabled(false); });
    connect(&starter, &CommandStarter::ended, this, [this] { m_action->setEnabled(true); });
}

bool RecoveryOffer::offer(const std::filesystem::path& wanted) {
    std::vector<RecoverableDocument> documents = recoverableDocuments(m_options);
    if (documents.empty() || m_starter.isRunning())
        return false;
    std::ranges::stable_partition(documents, [&](const RecoverableDocument& document) {
        std::error_code no_file; // as of a document that was never saved
        return std::filesystem::equivalent(document.document, wanted, no_file);
    });
    const RecoveryActs acts{
        [this](const RecoverableDocument& document) { return recover(document); }, discard};
    RecoveryDialog dialog(std::move(documents), acts, &m_window);
    return dialog.exec() == QDialog::Accepted;
}

std::size_t RecoveryOffer::count() const {
    return recoverableDocuments(m_options).size();
}

void RecoveryOffer::offerAgain() {
    if (count() == 0)
        emit nothingThere(localized(L"There is no unsaved work to recover.", 45405));
    else if (m_changes.mayLeave())
        offer();
}

/// To whoever watches, as one command: another document is there afterwards.
std::optional<std::string> RecoveryOffer::recover(const RecoverableDocument& document) {
    std::optional<std::string> trouble;
    const QString line = localized(L"Recover %1", 45404).arg(nameOf(document));
    m_starter.startWork(line, [&] {
        trouble = quarn::recover(m_session, document);
        return trouble ? CQuarnCommand::failure : CQuarnCommand::success;
    });
    return trouble;
}

} // namespace quarn::desktop
