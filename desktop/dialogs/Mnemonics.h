#pragma once

#include <QString>
#include <QStringList>

namespace quarn::desktop {

/// Labels with a key each that jumps to their control (`&` before its letter): the first letter of
/// a word that no other label has, else any letter. A label that has one keeps it; one without a
/// free letter, or in a script without letters on the keyboard, gets none.
///
/// @param labels  in the user's language; an ampersand that a blank follows, or that stands last,
///                is one
/// @param taken   letters that are not free, in lower case
QStringList withMnemonics(const QStringList& labels, QString taken = {});

/// A label without its mark.
QString withoutMnemonic(QString label);

} // namespace quarn::desktop
