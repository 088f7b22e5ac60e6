#include "desktop/command_line/PromptStrip.h"

#include "desktop/command_line/FlowLayout.h"
#include "desktop/texts/PlainTip.h"
#include "desktop/texts/Texts.h"
#include "host/session/Completion.h"

#include <QHBoxLayout>

namespace quarn::desktop {

namespace {

constexpr int GAP_PX = 6;

/// What a label or button shows of a text that somebody else wrote: "&" is no mnemonic.
QString plainCaption(QString text) {
    return text.replace('&', "&&");
}

QString promptHtml(const Question& question) {
    QString text = "<b>" + qtText(question.prompt).toHtmlEscaped() + "</b>";
    if (question.default_answer && !question.default_answer->IsEmpty())
        text += "&nbsp; &lt;" + qtText(*question.default_answer).toHtmlEscaped() + "&gt;";
    return text;
}

/// As it is typed, but with room to read: `Name = Value`.
QString optionText(const QuestionOption& option) {
    const QString name = qtText(option.local_name);
    return option.value.IsEmpty() ? name : name + " = " + qtText(option.value);
}

/// A folder may be longer than the strip is wide; its end tells most.
QString shortened(const QString& text) {
    constexpr qsizetype LONGEST = 48;
    const qsizetype begin = LONGEST / 3;
    return text.size() <= LONGEST ? text
                                  : text.left(begin) + u'\u2026' + text.right(LONGEST - begin - 1);
}

/// The English name behind "_" picks an option in every language.
QString optionAnswer(Question::Kind kind, const QuestionOption& option) {
    return qtText(quarn::optionText(kind, L"_" + std::wstring(option.english_name.View())));
}

} // namespace

PromptStrip::PromptStrip(QWidget* parent)
    : QWidget(parent), m_prompt(new QLabel(this)), m_choices(new QWidget(this)),
      m_objects(new QComboBox), m_ok(new QPushButton(localized(L"OK", 45103), this)) {
    m_prompt->setObjectName("prompt");
    m_prompt->setTextFormat(Qt::RichText);
    m_prompt->setWordWrap(true);
    m_objects->setObjectName("promptObjects");
    m_objects->setAccessibleName(localized(L"Objects", 45104));
    m_objects->setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
    m_objects->setMinimumContentsLength(18);
    m_choices->setLayout(new FlowLayout(GAP_PX));
    m_choices->layout()->addWidget(m_objects);

    m_ok->setObjectName("promptOk");
    auto* const cancel = new QPushButton(localized(L"Cancel", 45105), this);
    cancel->setObjectName("promptCancel");
    cancel->setShortcut(Qt::Key_Escape);
    cancel->setToolTip(localized(L"Ends the command (Escape)", 45106));

    auto* const row = new QHBoxLayout(this);
    row->setContentsMargins(0, 0, 0, 0);
    row->setSpacing(2 * GAP_PX);
    row->addWidget(m_prompt, 2);
    row->addWidget(m_choices, 3);
    row->addWidget(m_ok, 0, Qt::AlignTop);
    row->addWidget(cancel, 0, Qt::AlignTop);

    connect(m_ok, &QPushButton::clicked, this, &PromptStrip::confirmed);
    connect(cancel, &QPushButton::clicked, this, &PromptStrip::cancelled);
    connect(m_objects, &QComboBox::activated, this, [this](int index) {
        if (index > 0)
            emit answered(qtText(objectAnswer(wideText(m_objects->itemText(index)))));
    });
}

void PromptStrip::setQuestion(const Question& question) {
    const bool has_default = question.default_answer && !question.default_answer->IsEmpty();
    m_enter_is_answer = question.accepts_nothing || has_default;
    m_prompt->setText(promptHtml(question));
    m_ok->setToolTip(
        has_default && !question.accepts_nothing
            ? plainTip(localized(L"Takes %1 (Enter)", 45107).arg(qtText(*question.default_answer)))
            : localized(L"Goes on (Enter)", 45108));
    showObjects(question);
    showOptions(question);
    setHasTyped(false);
}

void PromptStrip::setHasTyped(bool has_typed) {
    m_ok->setEnabled(has_typed || m_enter_is_answer);
}

/// The buttons of the question before may be the ones whose click is being worked on.
void PromptStrip::showOptions(const Question& question) {
    for (QWidget* button : std::exchange(m_option_buttons, {})) {
        button->hide();
        button->deleteLater();
    }
    for (const QuestionOption& option : question.options) {
        auto* const button = new QPushButton(plainCaption(shortened(optionText(option))));
        button->setToolTip(plainTip(optionText(option)));
        button->setObjectName("option_" + qtText(option.english_name));
        const QString answer = optionAnswer(question.kind, option);
        connect(button, &QPushButton::clicked, this, [this, answer] { emit answered(answer); });
        m_choices->layout()->addWidget(button);
        button->show();
        m_option_buttons.append(button);
    }
}

void PromptStrip::showObjects(const Question& question) {
    m_objects->clear();
    m_objects->addItem(localized(L"Choose an object…", 45109));
    for (const KM_wString& name : question.object_names)
        m_objects->addItem(qtText(name));
    m_objects->setVisible(!question.object_names.empty());
}

KM_wString objectAnswer(const KM_wString& name) {
    const bool can_be_quoted = !name.IsEmpty() && name.View().find(L'"') == std::wstring_view::npos;
    return can_be_quoted ? L"\"" + name + L"\"" : name;
}

} // namespace quarn::desktop
