#include <QAbstractButton>
#include <QApplication>
#include <QElapsedTimer>
#include <QFile>
#include <QGenericPlugin>
#include <QKeyEvent>
#include <QLineEdit>
#include <QListWidget>
#include <QTimer>

namespace quarn::test {

namespace {

constexpr int BETWEEN_LINES_MS = 15;
constexpr int POINTS_BETWEEN_SAVES = 40;
/// How long a window is there before nothing that should not be offered is offered any more.
constexpr int LONGEST_WAIT_FOR_OFFER_MS = 500;

/// What it does.
enum class Task { work, recover, find_nothing };

/// Types command lines as a person does, one after the other, and writes down in a journal what it
/// begins and what is done: whoever kills the program reads there what was there to be lost.
///
/// It makes points and saves now and then, to `work.quarn` in its folder, with a copy of each saved
/// file beside it. Or it waits until a recovery is offered, takes it, saves it as `recovered.quarn`
/// and ends the program; where there should be none it ends the program after a while without.
class WindowTypist final : public QObject {
public:
    WindowTypist(const QString& folder, Task task)
        : m_folder(folder), m_journal(folder + "/journal"), m_task(task) {
        m_journal.open(QIODevice::WriteOnly | QIODevice::Append | QIODevice::Unbuffered);
        connect(&m_timer, &QTimer::timeout, this,
                [this] { m_task == Task::work ? work() : recover(); });
        m_timer.start(BETWEEN_LINES_MS);
    }

private:
    /// Nothing is typed while a command runs or a dialog is open.
    void work() {
        if (QApplication::activeModalWidget() || m_is_typing)
            return;
        if (m_points == 0)
            save("_-SaveAs \"" + m_folder + "/work.quarn\"");
        else if (m_points % POINTS_BETWEEN_SAVES == 0)
            save("_-Save");
        note("begun", ++m_points);
        if (type(QString("_-Point %1,0,0").arg(m_points)))
            note("done", m_points);
    }

    void save(const QString& line) {
        note("saving", m_points);
        if (!type(line))
            return;
        QFile::remove(m_folder + "/saved.quarn");
        QFile::copy(m_folder + "/work.quarn", m_folder + "/saved.quarn");
        note("saved", m_points);
    }

    void recover() {
        QWidget* const dialog = QApplication::activeModalWidget();
        const bool is_offered = dialog && dialog->objectName() == "recovery";
        if (!m_is_typing && is_offered) {
            take(*dialog);
            type("_-SaveAs \"" + m_folder + "/recovered.quarn\"");
            type("_-Exit");
        } else if (!m_is_typing && m_task == Task::find_nothing && commandLine()) {
            endAfterAWhile();
        }
    }

    void endAfterAWhile() {
        if (!m_clock.isValid())
            m_clock.start();
        else if (m_clock.elapsed() > LONGEST_WAIT_FOR_OFFER_MS)
            type("_-Exit");
    }

    /// A person takes nothing that says it is older than the file.
    void take(QWidget& dialog) {
        const QListWidgetItem& row = *dialog.findChild<QListWidget*>("recoverable")->item(0);
        const bool is_older =
            row.data(Qt::AccessibleTextRole).toString().contains("Older than its file");
        note(is_older ? "older" : "offered", 0);
        dialog.findChild<QAbstractButton*>(is_older ? "later" : "recover")->click();
    }

    /// Null while there is no window.
    static QLineEdit* commandLine() {
        for (QWidget* const window : QApplication::topLevelWidgets())
            if (window->objectName() == "mainWindow")
                return window->findChild<QLineEdit*>("commandLine");
        return nullptr;
    }

    /// @return whether there was a line to type into
    bool type(const QString& line) {
        QLineEdit* const edit = commandLine();
        if (!edit)
            return false;
        m_is_typing = true;
        edit->setText(line);
        QKeyEvent press(QEvent::KeyPress, Qt::Key_Return, Qt::NoModifier, "\r");
        QApplication::sendEvent(edit, &press);
        m_is_typing = false;
        return true;
    }

    /// "done 12 81234": what, which point, and when, on the clock that all processes share.
    void note(const char* what, int point) {
        using namespace std::chrono;
        const qint64 now_ms =
            duration_cast<milliseconds>(steady_clock::now().time_since_epoch()).count();
        m_journal.write(QString("%1 %2 %3\n").arg(what).arg(point).arg(now_ms).toLatin1());
    }

    QString m_folder;
    QFile m_journal;
    Task m_task;
    QTimer m_timer;
    QElapsedTimer m_clock; ///< since there is a window
    int m_points = 0;
    bool m_is_typing = false;
};

/// Loaded by way of QT_QPA_GENERIC_PLUGINS, with `QUARN_TYPIST_FOLDER` and, where it does not work,
/// `QUARN_TYPIST_RECOVERS`: "nothing" or something.
class WindowTypistPlugin final : public QGenericPlugin {
    Q_OBJECT
    Q_PLUGIN_METADATA(IID QGenericPluginFactoryInterface_iid FILE "typist.json")

public:
    QObject* create(const QString&, const QString&) override {
        const QString folder = qEnvironmentVariable("QUARN_TYPIST_FOLDER");
        if (folder.isEmpty())
            return nullptr;
        const QString recovers = qEnvironmentVariable("QUARN_TYPIST_RECOVERS");
        return new WindowTypist(folder, recovers.isEmpty()      ? Task::work
                                        : recovers == "nothing" ? Task::find_nothing
                                                                : Task::recover);
    }
};

} // namespace

} // namespace quarn::test

#include "WindowTypist.moc"
