#pragma once

#include "host/front_end/DialogWindow.h"
#include "sdk/cocoa/QXDialogController.h"

/// What the dialog layer tells a controller beside what subclasses see.
@interface QXDialogController (DialogEvents)

/// Who is told what a person does in the window; null when nobody is. Not owned.
- (void)setDialogEvents:(quarn::DialogEvents*)events;

@end
