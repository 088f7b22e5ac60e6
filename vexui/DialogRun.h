#pragma once

#include "kelmar/KM_AnimationProperties.h"
#include "sdk/vexui/VexUi.h"

#include <functional>

class QWidget;

namespace vexui {

class Form;

/// Whether this is the thread of a program with Qt windows.
bool canShowWindows();

/// Makes a form, to be deleted by whoever called, with an owner or null.
using MakeForm = std::function<Form*(QWidget* owner)>;

/// Shows a form until it is answered, and deletes it.
///
/// @param lists   unchanged unless it was confirmed; tells the owner
/// @param record  likewise
/// @return whether it was confirmed; false, after a message, while another form is open; false
///         where no window can be shown
bool runForm(const MakeForm& make_form, IZoetrixDataUI& lists, KM_3dmAnimationProperties& record);

} // namespace vexui
