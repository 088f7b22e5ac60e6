#include "host/cocoa/BoundKeys.h"

#include "host/cocoa/TextOf.h"

#include <string>
#include <utility>

namespace quarn {
namespace {

/// The control among a view and those inside it whose value is bound to a key; nil for none.
NSControl* controlBoundTo(NSString* key, QXDialogController* controller, NSView* view) {
    NSDictionary* const binding = [view infoForBinding:NSValueBinding];
    if ([view isKindOfClass:[NSControl class]] &&
        [binding objectForKey:NSObservedObjectKey] == controller &&
        [[binding objectForKey:NSObservedKeyPathKey] isEqual:key]) {
        return static_cast<NSControl*>(view);
    }
    NSArray* const inside = [view subviews];
    for (NSUInteger at = 0; at < [inside count]; ++at) {
        NSControl* const found = controlBoundTo(key, controller, [inside objectAtIndex:at]);
        if (found) {
            return found;
        }
    }
    return nil;
}

} // namespace

BoundKeys::BoundKeys(QXDialogController* controller)
    : m_controller(controller), m_controls([[NSMutableDictionary alloc] init]),
      m_values([[controller dictionaryWithValuesForKeys:[controller bindingKeyNames]] retain]) {}

BoundKeys::~BoundKeys() {
    [m_controls release];
    [m_values release];
}

BoundKeys::BoundKeys(BoundKeys&& other) noexcept
    : m_controller(std::exchange(other.m_controller, nil)),
      m_controls(std::exchange(other.m_controls, nil)),
      m_values(std::exchange(other.m_values, nil)) {}

Result<BoundKeys> BoundKeys::takeOver(QXDialogController* controller) {
    BoundKeys keys(controller);
    NSArray* const names = [controller bindingKeyNames];
    for (NSUInteger at = 0; at < [names count]; ++at) {
        NSString* const key = [names objectAtIndex:at];
        NSControl* const control =
            controlBoundTo(key, controller, [[controller window] contentView]);
        if (!control) {
            return Error{"The nib \"" + textOf([controller nibName]).ToUtf8() +
                         "\" has no control that is bound to \"" + textOf(key).ToUtf8() + "\"."};
        }
        [control unbind:NSValueBinding];
        [keys.m_controls setObject:control forKey:key];
    }
    return keys;
}

void BoundKeys::show() const {
    NSArray* const names = [m_controls allKeys];
    for (NSUInteger at = 0; at < [names count]; ++at) {
        NSString* const key = [names objectAtIndex:at];
        const id value = [m_controller valueForKey:key];
        [[m_controls objectForKey:key] setStringValue:value ? [value description] : @""];
    }
}

void BoundKeys::store() const {
    NSArray* const names = [m_controls allKeys];
    for (NSUInteger at = 0; at < [names count]; ++at) {
        NSString* const key = [names objectAtIndex:at];
        [m_controller setValue:[[m_controls objectForKey:key] stringValue] forKey:key];
    }
}

void BoundKeys::putBack() const {
    [m_controller setValuesForKeysWithDictionary:m_values];
}

} // namespace quarn
