#include "desktop/documents/ProgramEnd.h"

#include "desktop/command_line/CommandPane.h"
#include "desktop/command_line/CommandStarter.h"
#include "host/session/StopSignals.h"

#include <QCoreApplication>
#include <QSocketNotifier>

namespace quarn::desktop {

namespace {

/// Enough for a large picture or model that is being worked on; less than what a computer that
/// shuts down gives its programs.
constexpr unsigned LONGEST_STOP_S = 10;

} // namespace

ProgramEnd::ProgramEnd(CommandStarter& starter, CommandPane& pane, QObject* parent)
    : QObject(parent), m_starter(starter), m_pane(pane) {}

void ProgramEnd::watchSignals() {
    watchForStopSignals(LONGEST_STOP_S);
    if (stopSignalDescriptor() < 0)
        return;
    auto* const notifier = new QSocketNotifier(stopSignalDescriptor(), QSocketNotifier::Read, this);
    connect(notifier, &QSocketNotifier::activated, this, [this, notifier] {
        notifier->setEnabled(false); // the byte stays in the pipe
        end(UnsavedWork::kept);
    });
}

/// Event loops that are begun afterwards return at once, so that no dialog is opened any more.
void ProgramEnd::end(UnsavedWork work) {
    m_work = work;
    m_starter.stopForGood();
    m_pane.cancelQuestion();
    QCoreApplication::exit();
}

} // namespace quarn::desktop
