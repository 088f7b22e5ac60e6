#pragma once

#include "host/front_end/FrontEndChoices.h"
#include "host/session/Session.h"

#include <QMenu>
#include <QStringList>

namespace quarn::desktop {

class CommandStarter;

/// The files that were opened and saved last, the newest first, in this run and in earlier ones:
/// kept in the settings of the user (QSettings), and offered in a menu.
class RecentFiles final : public QObject {
    Q_OBJECT
public:
    static constexpr int FILES_KEPT = 10;

    /// Both must outlive this.
    RecentFiles(Session& session, CommandStarter& starter, QWidget& window);

    QMenu& menu() { return *m_menu; }
    const QStringList& files() const { return m_files; }
    /// Puts a file first.
    void note(const std::filesystem::path& file);

public slots:
    /// Told of what a person chose in a file chooser: the command that asked has not read it yet.
    void noteChoice(const FileQuestion& question, const FileChoice& choice);

signals:
    /// A file was chosen from the menu. The line opens it and is not started here.
    void lineChosen(const QString& line);
    /// A file of the menu is gone, and was taken from it; one sentence for a person.
    void missing(const QString& message);

private:
    void commandStarted(const QString& line);
    void commandEnded(CQuarnCommand::result result);
    void open(const QString& file);
    void keep(const QStringList& files);
    void fillMenu();

    Session& m_session;
    QMenu* m_menu;
    QStringList m_files;
    QString m_command;                    ///< English name of the one that runs
    std::filesystem::path m_file_to_open; ///< what it was told to open
};

} // namespace quarn::desktop
