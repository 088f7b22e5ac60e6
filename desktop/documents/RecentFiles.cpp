#include "desktop/documents/RecentFiles.h"

#include "desktop/command_line/CommandStarter.h"
#include "desktop/documents/StartedLine.h"
#include "desktop/texts/Texts.h"
#include "host/session/DocumentState.h"

#include <QSettings>

namespace quarn::desktop {

namespace {

constexpr const char* SETTING = "files/recent";

std::filesystem::path absolutePath(const std::filesystem::path& file) {
    std::error_code error;
    const std::filesystem::path whole = std::filesystem::absolute(file, error);
    return error ? file : whole.lexically_normal();
}

bool isThere(const std::filesystem::path& file) {
    std::error_code error;
    return std::filesystem::exists(file, error);
}

/// The first word, without its quotes.
QString firstWord(const QString& words) {
    if (words.startsWith('"'))
        return words.section('"', 1, 1);
    return words.section(' ', 0, 0);
}

/// "house.obj — /home/anna/models"; the folder tells files of one name apart.
QString captionOf(const QString& file, int number) {
    const std::filesystem::path path = nativePath(file);
    const QString name = qtText(path.filename()) + "  –  " + qtText(path.parent_path());
    return QString("&%1  %2").arg(number).arg(QString(name).replace('&', "&&"));
}

} // namespace

RecentFiles::RecentFiles(Session& session, CommandStarter& starter, QWidget& window)
    : QObject(&window), m_session(session),
      m_menu(new QMenu(localized(L"Open &recent", 45260), &window)),
      m_files(QSettings().value(SETTING).toStringList()) {
    m_menu->setObjectName("recentFiles");
    connect(&starter, &CommandStarter::started, this, &RecentFiles::commandStarted);
    connect(&starter, &CommandStarter::ended, this, &RecentFiles::commandEnded);
    fillMenu();
}

void RecentFiles::note(const std::filesystem::path& file) {
    const QString path = qtText(absolutePath(file));
    QStringList files = m_files;
    files.removeAll(path);
    files.prepend(path);
    keep(files.mid(0, FILES_KEPT));
}

void RecentFiles::noteChoice(const FileQuestion& question, const FileChoice& choice) {
    const bool opens = m_command == "Open" && question.kind == FileQuestion::Kind::open;
    if (opens && choice.kind == FileChoice::Kind::chosen)
        m_file_to_open = choice.file;
}

void RecentFiles::commandStarted(const QString& line) {
    const StartedLine read = readLine(m_session, line);
    m_command = read.english_name;
    m_file_to_open.clear();
    if (m_command == "Open")
        m_file_to_open = nativePath(firstWord(read.words));
}

/// What was opened or saved is the document's file; a model that was opened is none.
void RecentFiles::commandEnded(CQuarnCommand::result result) {
    const QString command = std::exchange(m_command, {});
    const bool concerns_files = command == "Open" || command == "Save" || command == "SaveAs";
    if (result != CQuarnCommand::success || !concerns_files)
        return;
    const std::filesystem::path file =
        m_file_to_open.empty() ? documentFile(m_session.document()) : m_file_to_open;
    if (!file.empty() && isThere(file))
        note(file);
}

void RecentFiles::open(const QString& file) {
    const std::filesystem::path path = nativePath(file);
    if (isThere(path)) {
        emit lineChosen("_Open " + quotedPath(path));
        return;
    }
    QStringList files = m_files;
    files.removeAll(file);
    keep(files);
    emit missing(
        localized(L"%1 is not there any more. It was taken from the list.", 45261).arg(file));
}

void RecentFiles::keep(const QStringList& files) {
    m_files = files;
    QSettings().setValue(SETTING, m_files);
    fillMenu();
}

void RecentFiles::fillMenu() {
    m_menu->clear();
    int number = 1;
    for (const QString& file : m_files) {
        QAction* const action = m_menu->addAction(captionOf(file, number));
        action->setObjectName(QString("recentFile%1").arg(number++));
        action->setData(file);
        connect(action, &QAction::triggered, this, [this, file] { open(file); });
    }
    m_menu->addSeparator();
    QAction* const forget = m_menu->addAction(localized(L"&Clear the list", 45262));
    forget->setObjectName("forgetRecentFiles");
    connect(forget, &QAction::triggered, this, [this] { keep({}); });
    m_menu->setEnabled(!m_files.isEmpty());
}

} // namespace quarn::desktop
