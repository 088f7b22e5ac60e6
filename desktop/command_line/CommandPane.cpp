#include "desktop/command_line/CommandPane.h"

#include "desktop/texts/Texts.h"

#include <QEvent>
#include <QPointer>
#include <QVBoxLayout>

namespace quarn::desktop {

namespace {

constexpr int MARGIN_PX = 6;

QColor mixed(const QColor& base, const QColor& accent, double share) {
    const auto part = [&](int from, int to) {
        return from + static_cast<int>((to - from) * share);
    };
    return {part(base.red(), accent.red()), part(base.green(), accent.green()),
            part(base.blue(), accent.blue())};
}

} // namespace

CommandPane::CommandPane(const Session& session, QWidget* parent)
    : QWidget(parent), m_session(session), m_output(new OutputPane(this)),
      m_frame(new QFrame(this)), m_strip(new PromptStrip(m_frame)),
      m_line(new CommandEdit(m_frame)) {
    m_frame->setObjectName("askingFrame");
    m_frame->setAutoFillBackground(true);
    // Files that are dropped here are for the window to open.
    m_output->setAcceptDrops(false);
    m_line->setAcceptDrops(false);
    auto* const framed = new QVBoxLayout(m_frame);
    framed->setContentsMargins(MARGIN_PX, MARGIN_PX, MARGIN_PX, MARGIN_PX);
    framed->setSpacing(MARGIN_PX);
    framed->addWidget(m_strip);
    framed->addWidget(m_line);

    auto* const column = new QVBoxLayout(this);
    column->setContentsMargins(0, 0, 0, 0);
    column->setSpacing(0);
    column->addWidget(m_output, 1);
    column->addWidget(m_frame);

    connect(m_line, &CommandEdit::entered, this, &CommandPane::takeLine);
    connect(m_line, &CommandEdit::escaped, this, &CommandPane::cancelQuestion);
    connect(m_line, &QLineEdit::textChanged, m_strip,
            [this](const QString& text) { m_strip->setHasTyped(!text.trimmed().isEmpty()); });
    connect(m_strip, &PromptStrip::answered, this,
            [this](const QString& text) { answer(wideText(text)); });
    connect(m_strip, &PromptStrip::confirmed, this, [this] { takeLine(m_line->text()); });
    connect(m_strip, &PromptStrip::cancelled, this, &CommandPane::cancelQuestion);
    showCommandLine();
}

CommandPane::~CommandPane() {
    for (Asked* asked : m_asked)
        asked->loop.quit();
}

Answer CommandPane::ask(const Question& question) {
    Asked asked{question};
    if (m_asked.empty())
        m_unfinished = m_line->text();
    m_asked.push_back(&asked);
    showQuestion();
    const QPointer<CommandPane> still_there(this);
    asked.loop.exec();
    if (!still_there)
        return asked.answer;
    std::erase(m_asked, &asked);
    if (m_asked.empty())
        showCommandLine();
    else
        showQuestion();
    return asked.answer;
}

std::optional<Question::Kind> CommandPane::askedKind() const {
    if (m_asked.empty())
        return std::nullopt;
    return m_asked.back()->question.kind;
}

void CommandPane::answer(const KM_wString& text) {
    finish({Answer::Kind::text, text});
}

void CommandPane::cancelQuestion() {
    finish({Answer::Kind::cancel, {}});
}

void CommandPane::takeLine(const QString& text) {
    const QString line = text.trimmed();
    if (isAsking()) {
        finish(line.isEmpty() ? Answer{Answer::Kind::enter, {}}
                              : Answer{Answer::Kind::text, wideText(line)});
        return;
    }
    m_line->clear();
    if (line.isEmpty())
        return;
    m_line->history().add(line);
    emit lineEntered(line);
}

/// Gives the newest question its answer and writes down both, so that one can read later what was
/// chosen.
void CommandPane::finish(Answer answer) {
    if (m_asked.empty() || !m_asked.back()->loop.isRunning())
        return;
    Asked& asked = *m_asked.back();
    QString said = qtText(asked.question.prompt) + ":";
    if (answer.kind == Answer::Kind::text)
        said += ' ' + qtText(answer.text);
    else if (answer.kind == Answer::Kind::enter && asked.question.default_answer)
        said += ' ' + qtText(*asked.question.default_answer);
    m_output->print((wideText(said) + L"\n").View());
    asked.answer = std::move(answer);
    asked.loop.quit();
}

void CommandPane::showQuestion() {
    const Question& question = m_asked.back()->question;
    m_strip->setQuestion(question);
    m_strip->show();
    m_line->clear();
    m_line->setCallsBackLines(false);
    m_line->setCompleter(
        [&question](std::wstring_view typed) { return completeAnswer(typed, question); });
    m_line->setPlaceholderText(localized(L"Type the answer here", 45110));
    colourAskingFrame();
    m_line->setFocus();
}

void CommandPane::showCommandLine() {
    m_strip->hide();
    m_line->setText(m_unfinished);
    m_unfinished.clear();
    m_line->setCallsBackLines(true);
    m_line->setCompleter([this](std::wstring_view typed) {
        return completeCommand(typed, m_session.commandNames());
    });
    m_line->setPlaceholderText(localized(L"Type a command here", 45111));
    colourAskingFrame();
}

void CommandPane::colourAskingFrame() {
    QPalette colours = palette();
    if (isAsking())
        colours.setColor(QPalette::Window, mixed(palette().color(QPalette::Window),
                                                 palette().color(QPalette::Highlight), 0.25));
    m_frame->setPalette(colours);
    m_line->setPalette(palette());
}

void CommandPane::changeEvent(QEvent* event) {
    if (event->type() == QEvent::PaletteChange)
        colourAskingFrame();
    QWidget::changeEvent(event);
}

} // namespace quarn::desktop
