#pragma once

#include "host/session/Recovery.h"

#include <QDialog>

#include <functional>
#include <vector>

class QListWidget;
class QListWidgetItem;
class QPushButton;

namespace quarn::desktop {

/// What the dialog does with a document that a person decided about.
struct RecoveryActs {
    /// Opens it. @return nothing when it is open; else a sentence that says why it is not
    std::function<std::optional<std::string>(const RecoverableDocument&)> recover;
    /// Removes what was kept of it.
    std::function<void(const RecoverableDocument&)> discard;
};

/// Shows the documents whose unsaved work was kept, each with its picture and when that was, and
/// lets a person recover one, discard some, or leave all of it for later.
class RecoveryDialog final : public QDialog {
    Q_OBJECT
public:
    /// @param documents  at least one; the first is chosen at the beginning
    RecoveryDialog(std::vector<RecoverableDocument> documents, RecoveryActs acts, QWidget* owner);

private:
    void addDocument(const RecoverableDocument& document, std::size_t index);
    void addButtons(QLayout& column);
    const RecoverableDocument& chosen() const;
    void recoverChosen();
    void discardChosen();

    std::vector<RecoverableDocument> m_documents;
    RecoveryActs m_acts;
    QListWidget* m_list;
};

/// What a person calls the document: the name of its file.
QString nameOf(const RecoverableDocument& document);

} // namespace quarn::desktop
