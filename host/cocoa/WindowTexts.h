#pragma once

#include "sdk/cocoa/QXDialogController.h"

namespace quarn {

/// Puts the texts of a controller's window into the user's language: the title by its
/// `titleTextId`, labels by their tags, OK and Cancel by what they send.
void localizeWindow(QXDialogController* controller);

} // namespace quarn
