#include "desktop/command_line/CommandEdit.h"

#include "desktop/texts/Texts.h"

#include <QKeyEvent>
#include <QScreen>

namespace quarn::desktop {

namespace {

constexpr int ROWS_SHOWN = 10;
constexpr int LARGEST_WIDTH_PX = 480;

} // namespace

CommandEdit::CommandEdit(QWidget* parent) : QLineEdit(parent), m_list(new QListWidget(this)) {
    setObjectName("commandLine");
    setAccessibleName(localized(L"Command line", 45102));
    // A tool tip's window never takes the keyboard from the line.
    m_list->setWindowFlags(Qt::ToolTip);
    m_list->setObjectName("completions");
    m_list->setFocusPolicy(Qt::NoFocus);
    m_list->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    m_list->hide();
    connect(this, &QLineEdit::textEdited, this, &CommandEdit::offerCompletions);
    connect(m_list, &QListWidget::itemClicked, this,
            [this](QListWidgetItem* item) { takeCandidate(m_list->row(item)); });
}

void CommandEdit::setCompleter(Completer completer) {
    m_complete = std::move(completer);
    m_list->hide();
}

void CommandEdit::setCallsBackLines(bool calls_back) {
    m_calls_back_lines = calls_back;
}

/// Tab would otherwise move the keyboard on before the line sees it.
bool CommandEdit::event(QEvent* event) {
    if (event->type() == QEvent::KeyPress) {
        const auto& key = static_cast<QKeyEvent&>(*event);
        const bool has_something_to_complete = m_list->isVisible() || !text().isEmpty();
        if (key.key() == Qt::Key_Tab && key.modifiers() == Qt::NoModifier &&
            has_something_to_complete) {
            completeByTab();
            return true;
        }
    }
    return QLineEdit::event(event);
}

void CommandEdit::keyPressEvent(QKeyEvent* event) {
    if (m_list->isVisible() && listTakes(*event))
        return;
    switch (event->key()) {
    case Qt::Key_Return:
    case Qt::Key_Enter: {
        m_list->hide();
        emit entered(text());
        return;
    }
    case Qt::Key_Escape:
        emit escaped();
        return;
    case Qt::Key_Up:
        if (m_calls_back_lines)
            showLine(m_history.older(text()));
        return;
    case Qt::Key_Down:
        if (m_calls_back_lines)
            showLine(m_history.newer(text()));
        return;
    default:
        QLineEdit::keyPressEvent(event);
    }
}

void CommandEdit::focusOutEvent(QFocusEvent* event) {
    m_list->hide();
    QLineEdit::focusOutEvent(event);
}

/// Keys that mean the open list. Enter means the line, unless a row was chosen.
bool CommandEdit::listTakes(const QKeyEvent& key) {
    const int rows = m_list->count();
    const int row = m_list->currentRow();
    switch (key.key()) {
    case Qt::Key_Up:
        m_list->setCurrentRow(row > 0 ? row - 1 : rows - 1);
        return true;
    case Qt::Key_Down:
        m_list->setCurrentRow((row + 1) % rows);
        return true;
    case Qt::Key_Return:
    case Qt::Key_Enter:
        if (row < 0)
            return false;
        takeCandidate(row);
        return true;
    case Qt::Key_Escape:
        m_list->hide();
        return true;
    default:
        return false;
    }
}

void CommandEdit::offerCompletions() {
    m_completion = {};
    if (m_complete && !text().trimmed().isEmpty())
        m_completion = m_complete(text().left(cursorPosition()).toStdWString());
    m_list->clear();
    for (const Completion::Candidate& candidate : m_completion.candidates)
        m_list->addItem(qtText(candidate.shown));
    m_list->setCurrentRow(-1);
    const std::wstring typed = text().left(cursorPosition()).toStdWString();
    const auto& candidates = m_completion.candidates;
    const bool is_complete =
        candidates.size() == 1 && typed.substr(m_completion.begin) == candidates[0].text;
    m_list->hide();
    if (!candidates.empty() && !is_complete && isVisible())
        showList();
}

/// Above the line, which stands at the bottom of the window; below it where there is no room.
void CommandEdit::showList() {
    const int frame = 2 * m_list->frameWidth();
    const int rows = std::min(m_list->count(), ROWS_SHOWN);
    const int height = rows * std::max(1, m_list->sizeHintForRow(0)) + frame;
    const int scroll_bar = m_list->count() > ROWS_SHOWN ? 24 : 8;
    const int width = std::min(m_list->sizeHintForColumn(0) + frame + scroll_bar, LARGEST_WIDTH_PX);
    const QPoint above = mapToGlobal(QPoint(0, -height));
    const bool has_room = above.y() >= screen()->availableGeometry().top();
    m_list->setGeometry(QRect(has_room ? above : mapToGlobal(QPoint(0, this->height())),
                              QSize(std::max(width, 160), height)));
    m_list->show();
}

/// As on a console: first what all candidates share, then the chosen or the only one.
void CommandEdit::completeByTab() {
    const int row = m_list->isVisible() ? m_list->currentRow() : -1;
    if (row >= 0) {
        takeCandidate(row);
        return;
    }
    offerCompletions();
    if (m_completion.candidates.size() == 1) {
        takeCandidate(0);
        return;
    }
    const std::wstring common = m_completion.commonText();
    const auto typed_length = static_cast<std::size_t>(cursorPosition()) - m_completion.begin;
    if (common.size() > typed_length)
        replaceTyped(common);
    else if (m_list->isVisible())
        m_list->setCurrentRow(0);
}

void CommandEdit::takeCandidate(int row) {
    const Completion::Candidate taken = m_completion.candidates.at(static_cast<std::size_t>(row));
    replaceTyped(taken.text + taken.ending);
    m_list->hide();
    setFocus();
}

/// @param text  stands in place of what a candidate replaces, up to the cursor
void CommandEdit::replaceTyped(const std::wstring& text) {
    const auto begin = static_cast<qsizetype>(m_completion.begin);
    const QString behind = this->text().mid(cursorPosition());
    const QString up_to_cursor = this->text().left(begin) + qtText(text);
    setText(up_to_cursor + behind);
    setCursorPosition(static_cast<int>(up_to_cursor.size()));
}

void CommandEdit::showLine(const QString& line) {
    m_list->hide();
    setText(line);
}

} // namespace quarn::desktop
