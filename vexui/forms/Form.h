#pragma once

#include "kelmar/KM_AnimationProperties.h"
#include "sdk/vexui/VexUi.h"
#include "vexui/forms/NameCheck.h"
#include "vexui/forms/RecordingFields.h"

#include <QDialog>

#include <functional>
#include <vector>

class QComboBox;
class QFormLayout;
class QHBoxLayout;
class QLabel;
class QVBoxLayout;

namespace vexui {

class CountField;

/// What a form will lead to, for the line beneath its fields.
struct Outcome {
    QString text;            ///< in the user's language
    bool is_warning = false; ///< it can be taken, but a person should look
};

/// What all forms have in common: sections of labelled fields, a line beneath that says what will
/// come out or what is wrong, and the two buttons. Nothing is written anywhere before the person
/// confirmed.
///
/// No form or field has a meta object of its own: after the library is unloaded Qt remembers
/// nothing of it.
class Form : public QDialog {
public:
    Form(const char* name, const QString& title, QWidget* owner);

    /// Writes what stands in the fields; only after it was confirmed.
    virtual void takeInto(IZoetrixDataUI& lists, KM_3dmAnimationProperties& record) const = 0;

    /// Confirms, unless a field cannot be taken: then it moves there.
    void accept() override;

protected:
    /// What a field is called, by tests and by people.
    struct Caption {
        const char* name;
        QString label; ///< with its mnemonic
        QString tip;
    };
    /// Says why a field cannot be taken; empty when it can.
    using Fault = std::function<QString()>;

    /// Sections that are added from now on, the line and the buttons stand to the right of those
    /// that are there: a form of many fields is wide, for screens that are low.
    void beginColumn();
    /// A framed group of fields; the forms fill it from top to bottom.
    QFormLayout& addSection(const QString& title);
    /// Adds a field. Fields are reached with Tab in the order they are added.
    void addField(QFormLayout& section, const Caption& caption, QWidget& field);
    /// Adds a field for a whole number; the form follows what stands in it.
    void addCount(QFormLayout& section, const Caption& caption, CountField& field);
    /// Has a field checked whenever anything changes.
    void check(QWidget& field, Fault fault);
    /// A list with its selection; entry 0 is selected when the selection is outside the list.
    QComboBox& addList(QFormLayout& section, const Caption& caption,
                       const KM_ClassArray<KM_wString>& list, int selection);
    /// Adds the section that every form ends with, and has the name checked.
    RecordingFields addRecording(const IZoetrixDataUI& lists,
                                 const KM_3dmAnimationProperties& record,
                                 BadCharacters bad_characters);
    /// Adds a button or a line of text beneath the field that was added last.
    void addBeneath(QFormLayout& section, QWidget& widget);
    void addToTabOrder(QWidget& field);

    /// Ends the construction: adds the line and the buttons, and begins to check.
    void finish(std::function<Outcome()> outcome);
    /// Checks all fields and tells what will come out.
    virtual void review();

private:
    struct Check {
        QWidget* field;
        Fault fault;
        QString plain_tip;
    };

    void addButtons();
    void alignLabels();
    void mark(Check& check, const QString& fault);
    void tell(const Outcome& outcome, bool is_fault);

    QHBoxLayout* m_columns;
    QVBoxLayout* m_column; ///< the last
    std::vector<QLabel*> m_labels;
    std::vector<QWidget*> m_tab_order;
    std::vector<Check> m_checks;
    QWidget* m_first_faulty = nullptr;
    QLabel* m_icon = nullptr;
    QLabel* m_line = nullptr;
    std::function<Outcome()> m_outcome;
};

} // namespace vexui
