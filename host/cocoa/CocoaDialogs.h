#pragma once

#include "ground/Result.h"
#include "sdk/qncore/QnDialog.h"
#include "sdk/qncore/QnExport.h"

namespace quarn {

/// Shows a dialog by the Cocoa controller that it names, and waits until it is closed. The library
/// with the controller's class must be open. To be called on the main thread, with a session at
/// work.
///
/// @return what CDialog::DoModal returns; an error, with nothing shown, when the dialog names no
///         controller, when no library has its class, when the class refuses the dialog or is no
///         QXDialogController, when its nib is not found, and when no control is bound to one of
///         its keys
QNCORE_API Result<int> runCocoaDialog(CQuarnDialog& dialog);

} // namespace quarn
