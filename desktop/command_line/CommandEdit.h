#pragma once

#include "desktop/command_line/LineHistory.h"
#include "host/session/Completion.h"

#include <QLineEdit>
#include <QListWidget>

#include <functional>

namespace quarn::desktop {

/// The line that commands and answers are typed into. Up and Down call back earlier command lines;
/// a list of what the text may be completed to opens while one types, and Tab completes it.
class CommandEdit final : public QLineEdit {
    Q_OBJECT
public:
    /// Says what the text before the cursor may be completed to.
    using Completer = std::function<Completion(std::wstring_view)>;

    explicit CommandEdit(QWidget* parent = nullptr);

    void setCompleter(Completer completer);
    /// Whether the line is a command's: only then Up and Down walk through earlier ones.
    void setCallsBackLines(bool calls_back);
    LineHistory& history() { return m_history; }

    /// The list of completions; for its place on the screen, and for tests.
    QListWidget& completionList() { return *m_list; }

signals:
    /// Enter was pressed. The line is as it was typed.
    void entered(const QString& line);
    /// Escape was pressed while the list was closed.
    void escaped();

protected:
    bool event(QEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void focusOutEvent(QFocusEvent* event) override;

private:
    void offerCompletions();
    void showList();
    bool listTakes(const QKeyEvent& key);
    void completeByTab();
    void takeCandidate(int row);
    void replaceTyped(const std::wstring& text);
    void showLine(const QString& line);

    Completer m_complete;
    Completion m_completion;
    LineHistory m_history;
    QListWidget* m_list;
    bool m_calls_back_lines = true;
};

} // namespace quarn::desktop
