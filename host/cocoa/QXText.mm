#include "sdk/cocoa/QXText.h"

#include <string>

namespace {

constexpr unichar REPLACEMENT = 0xFFFD;

bool isLeadingSurrogate(unichar unit) {
    return (unit & 0xFC00) == 0xD800;
}

bool isTrailingSurrogate(unichar unit) {
    return (unit & 0xFC00) == 0xDC00;
}

bool isSurrogate(wchar_t character) {
    return (character & ~0x7FF) == 0xD800;
}

wchar_t joined(unichar leading, unichar trailing) {
    return static_cast<wchar_t>(0x10000 + ((leading & 0x3FF) << 10) + (trailing & 0x3FF));
}

void appendUnits(std::u16string& units, wchar_t character) {
    if (character < 0 || character > 0x10FFFF || isSurrogate(character)) {
        units += static_cast<char16_t>(REPLACEMENT);
    } else if (character > 0xFFFF) {
        units += static_cast<char16_t>(0xD800 + ((character - 0x10000) >> 10));
        units += static_cast<char16_t>(0xDC00 + (character & 0x3FF));
    } else {
        units += static_cast<char16_t>(character);
    }
}

} // namespace

@implementation NSString (QXText)

+ (NSString*)stringWithLPCTSTR:(const wchar_t*)text {
    std::u16string units;
    for (const wchar_t* at = text; at && *at; ++at) {
        appendUnits(units, *at);
    }
    return [NSString stringWithCharacters:reinterpret_cast<const unichar*>(units.data())
                                   length:units.size()];
}

- (KM_wString)KMwString {
    const NSUInteger length = [self length];
    std::wstring text;
    for (NSUInteger at = 0; at < length; ++at) {
        const unichar unit = [self characterAtIndex:at];
        const unichar next = at + 1 < length ? [self characterAtIndex:at + 1] : 0;
        if (isLeadingSurrogate(unit) && isTrailingSurrogate(next)) {
            text += joined(unit, next);
            ++at;
        } else {
            text += static_cast<wchar_t>(isSurrogate(unit) ? REPLACEMENT : unit);
        }
    }
    return std::wstring_view(text);
}

@end
