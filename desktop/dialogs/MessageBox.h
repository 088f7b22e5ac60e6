#pragma once

#include <string_view>

class QWidget;

namespace quarn::desktop {

/// Shows a message and waits until it is confirmed or closed.
/// @param flags  its icon: 16 an error, 32 a question, 48 a warning, 64 a note; other bits have no
///               effect
/// @return 1
int showMessageBox(QWidget* owner, std::wstring_view text, std::wstring_view title, unsigned flags);

/// Asks something that is answered with yes or no; Enter and Escape are no.
/// @param yes  what stands on the button that agrees
bool askWhether(QWidget* owner, std::wstring_view text, std::wstring_view title,
                std::wstring_view yes);

} // namespace quarn::desktop
