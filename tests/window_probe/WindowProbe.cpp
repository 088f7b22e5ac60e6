#include "tests/window_probe/WidgetReport.h"

#include <QCoreApplication>
#include <QGenericPlugin>
#include <QJsonDocument>
#include <QSocketNotifier>
#include <QTimer>

#include <unistd.h>

namespace quarn::test {

namespace {

bool writeAll(int stream, const QByteArray& bytes) {
    for (qsizetype written = 0; written < bytes.size();) {
        const ssize_t now = write(stream, bytes.constData() + written,
                                  static_cast<std::size_t>(bytes.size() - written));
        if (now <= 0)
            return false;
        written += now;
    }
    return true;
}

/// Answers every byte that comes through a socket with what can be seen of the windows. It clicks
/// nothing. When whoever asks is gone, the program ends.
class WindowProbe final : public QObject {
public:
    explicit WindowProbe(int socket) : m_socket(socket) {
        QTimer::singleShot(0, this, [this] { listen(); });
    }

private:
    void listen() {
        m_notifier = new QSocketNotifier(m_socket, QSocketNotifier::Read, this);
        connect(m_notifier, &QSocketNotifier::activated, this, [this] { answer(); });
    }

    void answer() {
        char asked = 0;
        if (read(m_socket, &asked, 1) != 1)
            _exit(113);
        const QByteArray told = QJsonDocument(reportWindows()).toJson(QJsonDocument::Compact);
        if (!writeAll(m_socket, told + '\n'))
            _exit(113);
    }

    int m_socket;
    QSocketNotifier* m_notifier = nullptr;
};

/// Qt loads it into the program that the tests start, by way of QT_QPA_GENERIC_PLUGINS. What the
/// program itself is made of stays as it is.
class WindowProbePlugin final : public QGenericPlugin {
    Q_OBJECT
    Q_PLUGIN_METADATA(IID QGenericPluginFactoryInterface_iid FILE "probe.json")

public:
    QObject* create(const QString&, const QString&) override {
        bool is_number = false;
        const int socket = qEnvironmentVariableIntValue("QUARN_PROBE_SOCKET", &is_number);
        return is_number ? new WindowProbe(socket) : nullptr;
    }
};

} // namespace

} // namespace quarn::test

#include "WindowProbe.moc"
