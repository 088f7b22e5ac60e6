#pragma once

#include "sdk/cocoa/QXText.h"

namespace quarn {

/// The host's form of a text; empty for nil, to which a message that returns an object of C++ must
/// not be sent.
inline KM_wString textOf(NSString* text) {
    return text ? [text KMwString] : KM_wString();
}

} // namespace quarn
