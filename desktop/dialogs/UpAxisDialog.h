#pragma once

#include "host/front_end/FrontEndChoices.h"

#include <QCheckBox>
#include <QDialog>
#include <QPixmap>
#include <QToolButton>

#include <optional>

namespace quarn::desktop {

/// Asks which axis of a model file points up, by two pictures of the model to click on.
class UpAxisDialog final : public QDialog {
public:
    /// A way the model may stand, and what it looks like then.
    struct Way {
        ModelUp up;
        QPixmap picture;
    };

    /// @param file   its name, for the question
    /// @param taken  the way that stands already; Enter chooses it
    UpAxisDialog(QWidget* owner, const QString& file, const Way& taken, const Way& other);

    /// What the person clicked on; nothing when they gave the question up.
    std::optional<ModelUp> choice() const { return m_choice; }
    /// Whether they want to be asked again.
    bool wantsToBeAsked() const { return !m_never_again->isChecked(); }

protected:
    void keyPressEvent(QKeyEvent* event) override;

private:
    QToolButton* makeButton(const Way& way, const QString& caption);

    QToolButton* m_taken;
    QCheckBox* m_never_again = nullptr;
    std::optional<ModelUp> m_choice;
};

} // namespace quarn::desktop
