#pragma once

#include "host/front_end/FrontEndChoices.h"

#include <QAction>
#include <QObject>
#include <QWidget>

#include <map>
#include <optional>

namespace quarn::desktop {

/// Asks which way the models of files are up that do not say so: of each file once, until the
/// program ends, and not at all where the person does not want it (QSettings).
class UpAxisAsking final : public QObject {
    Q_OBJECT
public:
    explicit UpAxisAsking(QObject* parent);

    /// What the person chooses, or chose before of the same file.
    /// @return nothing where they gave the question up, do not want it, or the model has no picture
    std::optional<ModelUp> ask(QWidget* owner, const UpAxisQuestion& question);
    /// Whether it asks, to be switched; for a menu.
    QAction& switchAction() { return *m_switch; }

private:
    std::optional<ModelUp> askPerson(QWidget* owner, const UpAxisQuestion& question);

    QAction* m_switch;
    std::map<std::filesystem::path, ModelUp> m_answers;
};

} // namespace quarn::desktop
