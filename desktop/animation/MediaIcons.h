#pragma once

#include <QColor>
#include <QIcon>

namespace quarn::desktop {

enum class MediaSign { first, previous, play, stop, next, last, record, page };

/// The usual sign on a player's button, sharp at every size, in a colour that suits the palette.
QIcon mediaIcon(MediaSign sign, const QColor& colour, const QColor& disabled_colour);

} // namespace quarn::desktop
