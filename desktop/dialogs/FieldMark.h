#pragma once

class QLineEdit;
class QString;

namespace quarn::desktop {

/// Marks a field whose text cannot be taken, or takes the mark away: a tinted ground, and a sign at
/// its end that tells why when the mouse rests on it.
/// @param why  a sentence in the user's language; empty for no mark
void markField(QLineEdit& field, const QString& why);

/// Whether a field is marked.
bool isMarked(const QLineEdit& field);

} // namespace quarn::desktop
