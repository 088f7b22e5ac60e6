#pragma once

#include <QPlainTextEdit>

#include <string_view>

namespace quarn::desktop {

/// What the host has said, oldest first. Its text can be selected and copied, not changed. Who
/// scrolled up to read goes on reading there; else the newest line is in sight.
class OutputPane final : public QPlainTextEdit {
    Q_OBJECT
public:
    /// Lines that are kept; the oldest go.
    static constexpr int LINES_KEPT = 5000;

    explicit OutputPane(QWidget* parent = nullptr);

    /// Adds text to the end; it ends a line only where it has a line break.
    void print(std::wstring_view text);
    /// Adds a command line or an answer that a person gave, told apart from what the host says, as
    /// a line of its own.
    void printTyped(const QString& line);

protected:
    void resizeEvent(QResizeEvent* event) override;

private:
    void append(const QString& text, const QTextCharFormat& format);
};

} // namespace quarn::desktop
