#pragma once

class QColor;
class QLineEdit;
class QPalette;
class QString;

namespace quarn::desktop {

/// Marks a field whose text cannot be taken, or takes the mark away: a tinted ground, and a sign at
/// its end that tells why when the mouse rests on it.
/// @param why  a sentence in the user's language; empty for no mark
void markField(QLineEdit& field, const QString& why);

/// The colour of a sentence about a field that cannot be taken, read on a light or a dark ground.
QColor warningColour(const QPalette& palette);

/// Whether a field is marked.
bool isMarked(const QLineEdit& field);

} // namespace quarn::desktop
