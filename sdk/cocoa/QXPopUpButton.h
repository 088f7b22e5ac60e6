#pragma once

#include "sdk/qncore/QnComboBox.h"

#include <AppKit/AppKit.h>
#include <memory>

/// A pop-up button as the control that a combo box shows itself in.
///
/// @param button  retained for as long as the control lives; may be nil
/// @return the control; null for nil
QNCORE_API std::unique_ptr<IQnComboBoxControl> QXMakePopUpControl(NSPopUpButton* button);
