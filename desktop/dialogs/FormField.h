#pragma once

#include "host/front_end/DialogTemplate.h"
#include "sdk/qncore/QnDateTime.h"

#include <string>
#include <string_view>

class QWidget;

namespace quarn::desktop {

/// A control of a template as a widget, named `control<id>`, with its tool tip. Fields for numbers
/// mark themselves while their text is none.
QWidget* makeField(const DialogControl& control, QWidget* parent);

/// What stands in a field for a text or a number; empty for another control.
std::wstring fieldText(const QWidget& field);
/// Writes into a field for a text or a number; else does nothing.
void setFieldText(QWidget& field, std::wstring_view text);

/// @return `former` with the part that the control shows replaced; `former` itself for a control
///         that shows neither
COleDateTime fieldDateTime(const QWidget& field, const COleDateTime& former);
/// A value that is not valid changes nothing.
void setFieldDateTime(QWidget& field, const COleDateTime& value);

/// Gives the control the keyboard, with its text selected.
void focusField(QWidget& field);

} // namespace quarn::desktop
