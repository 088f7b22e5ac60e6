#pragma once

#include <QByteArrayView>
#include <QPainterPath>

namespace quarn::desktop {

/// Reads the outlines of land: on the first line the steps of a degree, on each further one a ring
/// as whole numbers of steps, its first point (longitude, latitude) and then how far each point is
/// from the one before. @return in degrees, y down: longitude, minus latitude; a line that is no
/// ring is left out, and a text that is no such file gives no outlines
QPainterPath coastlinesFromText(QByteArrayView text);

/// The land of the earth, of the program's own file; fill it by the odd-even rule, as lakes are
/// rings too. Nothing crosses the 180th meridian. Read once; valid until the program ends.
const QPainterPath& coastlines();

} // namespace quarn::desktop
