#include "host/cocoa/WindowTexts.h"

#include "host/cocoa/TextOf.h"
#include "sdk/cocoa/QXText.h"
#include "sdk/qncore/QnLocalize.h"

namespace quarn {
namespace {

NSString* localized(NSString* english, NSInteger text_id) {
    return
        [NSString stringWithLPCTSTR:QnLocalizeString(textOf(english), static_cast<int>(text_id))];
}

/// OK and Cancel have the same texts in every dialog; other buttons have their controls' ids as
/// tags.
NSString* titleOf(NSButton* button) {
    if (sel_isEqual([button action], @selector(confirmDialog:))) {
        return [NSString stringWithLPCTSTR:QnLocalizeString(L"OK", 42490)];
    }
    if (sel_isEqual([button action], @selector(cancelDialog:))) {
        return [NSString stringWithLPCTSTR:QnLocalizeString(L"Cancel", 42491)];
    }
    return [button title];
}

/// GNUstep makes every text field of a nib editable that does not say otherwise; a label has no
/// frame.
bool isLabel(NSView* view) {
    return [view isKindOfClass:[NSTextField class]] && ![static_cast<NSTextField*>(view) isBezeled];
}

bool isPlainButton(NSView* view) {
    return [view isKindOfClass:[NSButton class]] && ![view isKindOfClass:[NSPopUpButton class]];
}

void localize(NSView* view) {
    if (isLabel(view)) {
        auto* const label = static_cast<NSTextField*>(view);
        [label setEditable:NO];
        [label setSelectable:NO];
        [label setStringValue:localized([label stringValue], [label tag])];
    } else if (isPlainButton(view)) {
        auto* const button = static_cast<NSButton*>(view);
        [button setTitle:titleOf(button)];
    }
    NSArray* const inside = [view subviews];
    for (NSUInteger at = 0; at < [inside count]; ++at) {
        localize([inside objectAtIndex:at]);
    }
}

} // namespace

void localizeWindow(QXDialogController* controller) {
    NSWindow* const window = [controller window];
    [window setTitle:localized([window title], [controller titleTextId])];
    localize([window contentView]);
}

} // namespace quarn
