#include "desktop/recovery/RecoveryBeat.h"

#include "desktop/command_line/CommandStarter.h"

#include <QTimer>

#include <algorithm>

namespace quarn::desktop {

namespace {

using namespace std::chrono_literals;

/// The keeper itself knows when it is time; it is looked after a few times in each beat.
std::chrono::milliseconds betweenLooks(std::chrono::milliseconds every) {
    return std::clamp<std::chrono::milliseconds>(every / 4, 50ms, 1s);
}

} // namespace

RecoveryBeat::RecoveryBeat(Session& session, CommandStarter& starter, RecoveryOptions options,
                           QObject* parent)
    : QObject(parent), m_options(std::move(options)), m_keeper(session, m_options) {
    auto* const timer = new QTimer(this);
    connect(timer, &QTimer::timeout, this, &RecoveryBeat::beat);
    connect(&starter, &CommandStarter::ended, this, &RecoveryBeat::beat);
    timer->start(betweenLooks(m_options.every));
}

void RecoveryBeat::beat() {
    m_keeper.beat();
    if (const std::optional<std::string> trouble = m_keeper.takeTrouble())
        emit troubled(QString::fromStdString(*trouble));
}

void RecoveryBeat::keepNow() {
    if (const std::optional<std::string> trouble = m_keeper.keepNow())
        emit troubled(QString::fromStdString(*trouble));
}

} // namespace quarn::desktop
