#pragma once

#include "sdk/qncore/QnExport.h"

/// The Escape key.
inline constexpr int VK_ESCAPE = 27;

/// Whether a key is down now. @return negative while it is down, 0 otherwise
QNCORE_API short GetAsyncKeyState(int virtual_key);

/// A clock in milliseconds that never goes back; it wraps to 0 after 2^32 milliseconds, so only
/// unsigned differences mean anything.
QNCORE_API unsigned int GetTickCount();
