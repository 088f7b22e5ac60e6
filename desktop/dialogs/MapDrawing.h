#pragma once

#include "desktop/dialogs/MapFrame.h"

#include <QColor>
#include <QPainter>
#include <QPalette>

namespace quarn::desktop {

/// The colours of a map, for windows with a light or a dark ground.
struct MapColours {
    QColor sea;
    QColor deep_sea; ///< toward the poles
    QColor land;
    QColor coast;
    QColor grid;
    QColor named_grid; ///< the equator and the tropics
    QColor text;
    QColor city;
    QColor mark;
    QColor mark_rim;
    QColor note; ///< the ground of a note on the map
};

MapColours mapColours(const QPalette& palette);

/// Sea, land, the grid of longitudes and latitudes, the named circles, and the cities.
void drawEarth(QPainter& painter, const MapFrame& frame, const MapColours& colours);

/// The mark of a place, with lines to the edges of the map.
void drawMark(QPainter& painter, const MapFrame& frame, const Place& place,
              const MapColours& colours);

} // namespace quarn::desktop
