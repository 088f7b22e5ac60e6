#pragma once

#include "host/session/Session.h"

#include <QList>
#include <QObject>
#include <QUrl>
#include <QWidget>

namespace quarn::desktop {

class CommandStarter;
class UnsavedChanges;

/// Opens files that are dropped on a window: the first as a document, the others into it.
class FileDrop final : public QObject {
    Q_OBJECT
public:
    /// All must outlive this.
    /// @param window  takes files from now on
    FileDrop(CommandStarter& starter, UnsavedChanges& changes, QWidget& window);

    /// Opens what was dropped.
    void open(const QList<QUrl>& urls);

signals:
    /// Why something was not opened; one sentence for a person.
    void refused(const QString& message);

private:
    bool eventFilter(QObject* watched, QEvent* event) override;
    QStringList readableWords(const QList<QUrl>& urls);

    CommandStarter& m_starter;
    UnsavedChanges& m_changes;
};

} // namespace quarn::desktop
