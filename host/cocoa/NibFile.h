#pragma once

#include <AppKit/AppKit.h>

namespace quarn {

/// The file of a nib: a resource of the bundle that a class belongs to, or, where libraries are
/// plain files, `share/quarn/cocoa/<name>` of the tree that the class's library lies in.
///
/// @param name   without an ending
/// @param owner  the class that names the nib
/// @return the path, autoreleased; nil when there is no such file
NSString* nibFile(NSString* name, Class owner);

} // namespace quarn
