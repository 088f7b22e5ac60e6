#pragma once

#include "desktop/command_line/CommandEdit.h"
#include "desktop/command_line/OutputPane.h"
#include "desktop/command_line/PromptStrip.h"
#include "host/session/Session.h"

#include <QEventLoop>
#include <QFrame>

#include <optional>
#include <vector>

namespace quarn::desktop {

/// What the host says, and below it the line that a person types commands and answers into. A
/// question stands in a strip of its own colour above the line for as long as it is asked.
class CommandPane final : public QWidget {
    Q_OBJECT
public:
    /// @param session  whose commands the line completes; must outlive this
    explicit CommandPane(const Session& session, QWidget* parent = nullptr);
    ~CommandPane() override;

    void print(std::wstring_view text) { m_output->print(text); }

    /// Asks a question and works on events until a person has answered it; it is cancelled when
    /// this goes away. A question asked meanwhile is asked first.
    Answer ask(const Question& question);
    bool isAsking() const { return !m_asked.empty(); }
    /// What kind of answer is wanted now; nothing while none is.
    std::optional<Question::Kind> askedKind() const;
    /// Whether a text that is given now is a point.
    bool takesPoint() const { return isAsking() && m_asked.back()->question.takes_points; }

    OutputPane& output() { return *m_output; }
    CommandEdit& line() { return *m_line; }

public slots:
    /// Shows a command line that was started, wherever it came from.
    void showStarted(const QString& line) { m_output->printTyped(line); }
    /// Answers the question from elsewhere, as if the text had been typed. Without one it does
    /// nothing.
    void answer(const KM_wString& text);
    /// Answers with an object that was pointed at.
    void answerWithObject(const KM_wString& name) { answer(objectAnswer(name)); }
    /// Cancels the question, as Escape does.
    void cancelQuestion();

signals:
    /// A command line was typed, and Enter. It is not started here.
    void lineEntered(const QString& line);

protected:
    void changeEvent(QEvent* event) override;

private:
    struct Asked {
        const Question& question;
        QEventLoop loop{};
        Answer answer{Answer::Kind::cancel, {}};
    };

    void takeLine(const QString& text);
    void finish(Answer answer);
    void showQuestion();
    void showCommandLine();
    void colourAskingFrame();

    const Session& m_session;
    OutputPane* m_output;
    QFrame* m_frame; ///< holds strip and line, and is coloured while there is a question
    PromptStrip* m_strip;
    CommandEdit* m_line;
    std::vector<Asked*> m_asked; ///< the one that is shown stands last
    QString m_unfinished;        ///< what was being typed when a question came
};

} // namespace quarn::desktop
