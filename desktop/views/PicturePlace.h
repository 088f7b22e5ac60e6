#pragma once

#include <QPointF>
#include <QRectF>
#include <QSize>

namespace quarn::desktop {

/// Where a picture stands in a widget: as large as fits, in the middle, with its own aspect.
/// @return a rectangle in the widget's coordinates; empty for a picture or a widget of no size
QRectF picturePlace(const QSize& widget, const QSize& picture_px);

/// A point of the widget as pixels of the picture, which may lie outside it.
/// @param place  as of picturePlace, not empty
QPointF picturePoint(const QPointF& point, const QRectF& place, const QSize& picture_px);

} // namespace quarn::desktop
