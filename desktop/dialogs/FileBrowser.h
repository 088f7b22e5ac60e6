#pragma once

#include <QFileDialog>

namespace quarn::desktop {

/// The window in which folders and files are chosen: the desktop's own where it has one. In the
/// program's own, its widgets carry texts in the user's language.
///
/// A folder that is typed and does not exist yet is made when the window is confirmed, as one that
/// a person is to choose must be there.
class FileBrowser final : public QFileDialog {
public:
    FileBrowser(QWidget* owner, const QString& title);

    /// Lets a person choose a folder; files are not shown.
    void askForFolder();

    /// A sentence above the folders. The desktop's own window has no place for it.
    void setMessage(const QString& message);

    void accept() override;

private:
    bool eventFilter(QObject* watched, QEvent* event) override;
    bool makeTypedFolder();
};

} // namespace quarn::desktop
