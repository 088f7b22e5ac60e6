#include "host/cocoa/CocoaDialogWindow.h"

#include "host/cocoa/DialogEvents.h"
#include "host/cocoa/TextOf.h"
#include "sdk/cocoa/QXText.h"

namespace quarn {
namespace {

/// Waits for the next event, though not for long: a dialog need not end in one.
void waitForEvent() {
    constexpr NSTimeInterval LONGEST_S = 0.05;
    [NSApp nextEventMatchingMask:NSAnyEventMask
                       untilDate:[NSDate dateWithTimeIntervalSinceNow:LONGEST_S]
                          inMode:NSModalPanelRunLoopMode
                         dequeue:NO];
}

} // namespace

CocoaDialogWindow::CocoaDialogWindow(QXDialogController* controller, const BoundKeys& keys)
    : m_controller(controller), m_keys(keys) {}

void CocoaDialogWindow::run(DialogEvents& events) {
    m_events = &events;
    [m_controller setDialogEvents:this];
    m_keys.show();
    NSWindow* const window = [m_controller window];
    [window center];
    m_is_closed = false;
    const NSModalSession session = [NSApp beginModalSessionForWindow:window];
    while (!m_is_closed) {
        NSAutoreleasePool* const pool = [[NSAutoreleasePool alloc] init];
        [NSApp runModalSession:session];
        if (!m_is_closed) {
            waitForEvent();
        }
        [pool drain];
    }
    [NSApp endModalSession:session];
    [m_controller setDialogEvents:nullptr];
    m_events = nullptr;
}

void CocoaDialogWindow::close() {
    [m_controller willCloseDialog];
    m_is_closed = true;
}

void CocoaDialogWindow::confirmed() {
    m_keys.store();
    m_events->confirmed();
}

void CocoaDialogWindow::givenUp() {
    m_events->givenUp();
}

void CocoaDialogWindow::buttonClicked(int control) {
    m_events->buttonClicked(control);
}

NSControl* CocoaDialogWindow::find(int control) const {
    NSView* const view = [[[m_controller window] contentView] viewWithTag:control];
    return [view isKindOfClass:[NSControl class]] ? static_cast<NSControl*>(view) : nil;
}

bool CocoaDialogWindow::hasControl(int control) const {
    return find(control) != nil;
}

std::wstring CocoaDialogWindow::text(int control) const {
    return std::wstring(textOf([find(control) stringValue]).View());
}

void CocoaDialogWindow::setText(int control, std::wstring_view text) {
    [find(control) setStringValue:[NSString stringWithLPCTSTR:KM_wString(text)]];
}

COleDateTime CocoaDialogWindow::dateTime(int) const {
    return {};
}

void CocoaDialogWindow::setDateTime(int, const COleDateTime&) {}

std::unique_ptr<IQnComboBoxControl> CocoaDialogWindow::comboBox(int) {
    return nullptr;
}

void CocoaDialogWindow::focus(int control) {
    NSControl* const found = find(control);
    if ([found isKindOfClass:[NSTextField class]]) {
        [static_cast<NSTextField*>(found) selectText:nil];
    } else if (found) {
        [[m_controller window] makeFirstResponder:found];
    }
}

} // namespace quarn
