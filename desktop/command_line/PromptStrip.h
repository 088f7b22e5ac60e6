#pragma once

#include "host/front_end/FrontEnd.h"

#include <QComboBox>
#include <QLabel>
#include <QPushButton>

namespace quarn::desktop {

/// A question in words, with everything about it that can be clicked: its options, the objects that
/// answer it, OK and Cancel.
class PromptStrip final : public QWidget {
    Q_OBJECT
public:
    explicit PromptStrip(QWidget* parent = nullptr);

    /// Shows a question in place of the one before.
    void setQuestion(const Question& question);
    /// Whether OK means something: an answer is typed, or Enter is one by itself.
    void setHasTyped(bool has_typed);

signals:
    /// An option or an object was clicked; `text` answers the question as a typed answer would.
    void answered(const QString& text);
    /// OK: as Enter in the command line.
    void confirmed();
    void cancelled();

private:
    void showOptions(const Question& question);
    void showObjects(const Question& question);

    QLabel* m_prompt;
    QWidget* m_choices;
    QComboBox* m_objects;
    QPushButton* m_ok;
    QList<QWidget*> m_option_buttons;
    bool m_enter_is_answer = false;
};

/// An object's name as an answer that is never taken for an option.
KM_wString objectAnswer(const KM_wString& name);

} // namespace quarn::desktop
