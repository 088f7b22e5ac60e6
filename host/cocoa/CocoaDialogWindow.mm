#include "host/cocoa/CocoaDialogWindow.h"

#include "host/cocoa/DialogEvents.h"
#include "sdk/cocoa/QXText.h"

namespace quarn {

CocoaDialogWindow::CocoaDialogWindow(QXDialogController* controller, const BoundKeys& keys)
    : m_controller(controller), m_keys(keys) {}

void CocoaDialogWindow::run(DialogEvents& events) {
    m_events = &events;
    [m_controller setDialogEvents:this];
    m_keys.show();
    NSWindow* const window = [m_controller window];
    [window center];
    [NSApp runModalForWindow:window];
    [m_controller setDialogEvents:nullptr];
    m_events = nullptr;
}

void CocoaDialogWindow::close() {
    [m_controller willCloseDialog];
    if (m_events) {
        [NSApp stopModal];
    }
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
    return std::wstring([[find(control) stringValue] KMwString].View());
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
