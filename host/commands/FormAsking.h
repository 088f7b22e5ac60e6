#pragma once

#include "sdk/qncore/QnCommand.h"
#include "sdk/qncore/QnDialog.h"

#include <optional>

namespace quarn {

// Commands that a person starts in a window ask with a form, where the line gives no words and
// there are dialogs; all others at their prompts.

/// Whether a command may ask with a form, where there are dialogs.
bool mayAskInForm(const CQuarnCommandContext& context);

/// Asks with a form.
/// @return success when it was confirmed, cancel when it was closed; nothing where the command has
///         to ask at its prompts: mayAskInForm tells so, there are no dialogs, and, with a message,
///         where the form cannot be shown
std::optional<CQuarnCommand::result> askInForm(const CQuarnCommandContext& context, CDialog& form);

/// Exchanges a whole number with limits, which belong to the range.
void exchangeWhole(CQnDialogExchange& exchange, int control, int& number, int least, int greatest);

/// Exchanges a number of which fewer digits are shown than it has. It keeps them all unless the
/// person enters another number.
/// @param shown  what is shown for the number
void exchangeRounded(CQnDialogExchange& exchange, int control, double& number, double shown);

/// An angle to 0.01 degrees, for exchangeRounded.
double roundedAngle(double degrees);

/// A length to seven digits, for exchangeRounded.
double roundedLength(double length);

} // namespace quarn
