#pragma once

#include "host/front_end/DialogTemplate.h"
#include "host/front_end/DialogWindow.h"

#include <memory>

class QWidget;

namespace quarn::desktop {

/// A template as a modal form. While it runs no other window of the program takes input.
///
/// Its widget is called `form<id>`, its controls `control<id>`, its buttons `ok` and `cancel`. When
/// the owner is destroyed the form goes with it: a form that runs is given up then, and one that is
/// gone reads as empty.
///
/// @param owner  the window it stands before; a dialog that is open already comes first, and null
///               is no window
std::unique_ptr<DialogWindow> makeFormWindow(const DialogTemplate& form, QWidget* owner);

} // namespace quarn::desktop
