#include "host/cocoa/WindowTexts.h"

#include "sdk/cocoa/QXText.h"
#include "sdk/qncore/QnLocalize.h"

namespace quarn {
namespace {

NSString* localized(NSString* english, NSInteger id) {
    return [NSString stringWithLPCTSTR:QnLocalizeString([english KMwString], static_cast<int>(id))];
}

bool isLabel(NSView* view) {
    return
        [view isKindOfClass:[NSTextField class]] && ![static_cast<NSTextField*>(view) isEditable];
}

bool isPlainButton(NSView* view) {
    return [view isKindOfClass:[NSButton class]] && ![view isKindOfClass:[NSPopUpButton class]];
}

void localize(NSView* view) {
    if (isLabel(view)) {
        auto* const label = static_cast<NSTextField*>(view);
        [label setStringValue:localized([label stringValue], [label tag])];
    } else if (isPlainButton(view)) {
        auto* const button = static_cast<NSButton*>(view);
        [button setTitle:localized([button title], [button tag])];
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
