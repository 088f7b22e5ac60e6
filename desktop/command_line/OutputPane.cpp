#include "desktop/command_line/OutputPane.h"

#include "desktop/texts/Texts.h"

#include <QFontDatabase>
#include <QScrollBar>
#include <QTextBlock>

namespace quarn::desktop {

OutputPane::OutputPane(QWidget* parent) : QPlainTextEdit(parent) {
    setObjectName("output");
    setAccessibleName(localized(L"What the program says", 45101));
    setReadOnly(true);
    setTextInteractionFlags(Qt::TextSelectableByMouse | Qt::TextSelectableByKeyboard);
    setUndoRedoEnabled(false);
    setMaximumBlockCount(LINES_KEPT);
    setFont(QFontDatabase::systemFont(QFontDatabase::FixedFont));
    setFrameShape(QFrame::NoFrame);
}

void OutputPane::print(std::wstring_view text) {
    append(qtText(text), {});
}

void OutputPane::printTyped(const QString& line) {
    const bool is_within_line = !document()->lastBlock().text().isEmpty();
    QTextCharFormat format;
    format.setForeground(palette().brush(QPalette::Link));
    format.setFontWeight(QFont::DemiBold);
    append((is_within_line ? "\n" : "") + line + "\n", format);
}

/// Questions and results take room away from it.
void OutputPane::resizeEvent(QResizeEvent* event) {
    QScrollBar& bar = *verticalScrollBar();
    const bool follows = bar.value() >= bar.maximum();
    QPlainTextEdit::resizeEvent(event);
    if (follows)
        bar.setValue(bar.maximum());
}

void OutputPane::append(const QString& text, const QTextCharFormat& format) {
    QScrollBar& bar = *verticalScrollBar();
    const bool follows = bar.value() >= bar.maximum();
    QTextCursor end(document());
    end.movePosition(QTextCursor::End);
    end.insertText(text, format);
    if (follows)
        bar.setValue(bar.maximum());
}

} // namespace quarn::desktop
