#pragma once

#include "host/front_end/SharedFileReport.h"

#include <QPushButton>
#include <QWidget>

#include <optional>

namespace quarn::desktop {

/// What became of the file for others that was made last: a page, a film, a camera,
/// or what is known of the sun. Stays until
/// the person closes it, or something else is made.
class SharedFileRow final : public QWidget {
    Q_OBJECT
public:
    explicit SharedFileRow(QWidget* parent = nullptr);

    void showReport(const SharedFileReport& report);
    /// Whether the buttons may start a command now.
    void setFree(bool is_free);

signals:
    /// A command line that opens the file, or the folder that it is in, with the desktop's program.
    void lineChosen(const QString& line);

private:
    class NarrowLabel;
    QPushButton* addButton(const char* name, const QString& text, const QString& tip,
                           std::optional<QString>& line);

    NarrowLabel* m_text;
    QPushButton* m_show_in_folder;
    QPushButton* m_open;
    QPushButton* m_open_picture;
    std::optional<QString> m_folder_line; ///< nothing where there is nothing to show
    std::optional<QString> m_open_line;
    std::optional<QString> m_picture_line;
};

} // namespace quarn::desktop
