#include "desktop/documents/FileDrop.h"

#include "desktop/command_line/CommandStarter.h"
#include "desktop/documents/StartedLine.h"
#include "desktop/documents/UnsavedChanges.h"
#include "desktop/texts/Texts.h"

#include <QApplication>
#include <QDragEnterEvent>
#include <QDropEvent>
#include <QFileInfo>
#include <QMimeData>
#include <QTimer>

namespace quarn::desktop {

FileDrop::FileDrop(CommandStarter& starter, UnsavedChanges& changes, QWidget& window)
    : QObject(&window), m_starter(starter), m_changes(changes) {
    window.setAcceptDrops(true);
    window.installEventFilter(this);
}

/// The other program waits for the end of the drop, so opening begins after it.
bool FileDrop::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() == QEvent::DragEnter) {
        auto& drag = static_cast<QDragEnterEvent&>(*event);
        const bool is_free = !m_starter.isRunning() && !QApplication::activeModalWidget();
        if (drag.mimeData()->hasUrls() && is_free)
            drag.acceptProposedAction();
        return true;
    }
    if (event->type() == QEvent::Drop) {
        auto& drop = static_cast<QDropEvent&>(*event);
        drop.acceptProposedAction();
        QTimer::singleShot(0, this, [this, urls = drop.mimeData()->urls()] { open(urls); });
        return true;
    }
    return QObject::eventFilter(watched, event);
}

void FileDrop::open(const QList<QUrl>& urls) {
    const QStringList words = readableWords(urls);
    if (words.isEmpty())
        return;
    if (!m_changes.mayLeave())
        return;
    CQuarnCommand::result opened = CQuarnCommand::failure;
    const QMetaObject::Connection connection =
        connect(&m_starter, &CommandStarter::ended, this,
                [&opened](CQuarnCommand::result result) { opened = result; });
    m_starter.start("_Open " + words.first());
    disconnect(connection);
    if (opened != CQuarnCommand::success)
        return;
    for (const QString& word : words.mid(1))
        m_starter.start("_Import " + word);
}

/// The files, as words of command lines. What is none is told.
QStringList FileDrop::readableWords(const QList<QUrl>& urls) {
    QStringList words;
    for (const QUrl& url : urls) {
        const QString file = url.toLocalFile();
        const QString word = file.isEmpty() ? file : quotedPath(nativePath(file));
        if (!word.isEmpty() && QFileInfo(file).isFile())
            words.append(word);
        else
            emit refused(localized(L"%1 is no file that can be opened here.", 45263)
                             .arg(url.toDisplayString(QUrl::PreferLocalFile)));
    }
    return words;
}

} // namespace quarn::desktop
