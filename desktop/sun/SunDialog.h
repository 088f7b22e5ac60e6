#pragma once

#include <QDialog>

#include <functional>
#include <vector>

class QFormLayout;
class QLabel;
class QVBoxLayout;

namespace quarn::desktop {

/// What the window's forms about the sun have in common: rows of fields, a line that says which of
/// them cannot be taken and why, and the buttons.
///
/// The line is called `flaw`, the buttons `ok` and `cancel`.
class SunDialog : public QDialog {
public:
    /// Only where every field can be taken.
    void accept() override;

protected:
    SunDialog(const char* name, const QString& title, QWidget* owner);

    /// A new row.
    /// @param label  empty: none. Its key that jumps to the field is found by itself.
    void addRow(const QString& label, QWidget* field, const QList<QWidget*>& beside = {});
    /// Has a field looked at before the form is taken.
    /// @param flaw  tells why it cannot be taken, in a sentence; empty where it can
    void check(QWidget* field, std::function<QString()> flaw);
    /// Takes back what was said of the fields: one of them is another now.
    void forgetFlaws();
    /// Adds line and buttons, when all else is there.
    /// @param ok  what the button says that takes the form; empty: there is one that closes it
    void finish(const QString& ok);

    QVBoxLayout& column() { return *m_column; }

private:
    struct Check {
        QWidget* field;
        std::function<QString()> flaw;
    };

    QVBoxLayout* m_column;
    QFormLayout* m_rows;
    QLabel* m_flaw;
    QList<QLabel*> m_labels;
    std::vector<Check> m_checks;
};

} // namespace quarn::desktop
