#pragma once

#include "kelmar/KM_wString.h"

#include <Foundation/Foundation.h>

/// Wide text of the host, made of a Cocoa string and made into one. What is no Unicode character
/// becomes U+FFFD either way.
@interface NSString (QXText)

/// @param text  zero-terminated; null gives the empty string
/// @return an autoreleased string, never nil
+ (NSString*)stringWithLPCTSTR:(const wchar_t*)text;

/// The characters of this string, one for each code point. Not to be sent to nil: what comes of
/// that is no object.
- (KM_wString)KMwString;

@end
