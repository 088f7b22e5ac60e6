#pragma once

#include "host/cities/Cities.h"
#include "host/cities/LocationChoice.h"

#include <QPointF>
#include <QRectF>
#include <QSizeF>
#include <QTransform>

namespace quarn::desktop {

/// What part of the earth a map shows, and where: all of it as large as it fits, or a part that
/// fills the same frame. Positions are in the widget's coordinates.
class MapFrame {
public:
    static constexpr double GREATEST_ZOOM = 24.0;

    /// Fits the frame into a widget of a size.
    void resize(const QSizeF& widget);
    /// Zooms so that the place at a position stays there; between 1 and GREATEST_ZOOM.
    void zoomAt(double factor, const QPointF& position);
    void showAll() { setView(1.0, {}); }
    /// Moves what is shown; it never leaves the earth.
    void drag(const QPointF& by) { setView(m_zoom, m_offset + by); }
    /// Moves what is shown as little as it takes to see a place.
    void reveal(const Place& place);

    double zoom() const { return m_zoom; }
    /// The part of the widget that the map fills.
    const QRectF& area() const { return m_area; }
    double pixelsPerDegree() const { return m_area.width() * m_zoom / 360.0; }
    QPointF positionOf(const Place& place) const;
    /// One beside the map counts as the nearest on its edge. Rounded to what a pixel tells: to a
    /// tenth of a degree or a hundredth.
    Place placeAt(const QPointF& position) const;
    /// The nearest city within so many pixels; null where there is none.
    const City* cityAt(const QPointF& position, double radius_px) const;
    /// Takes longitude and minus latitude in degrees to positions.
    QTransform widgetFromDegrees() const;

private:
    WorldMapSize size() const { return {m_area.width() * m_zoom, m_area.height() * m_zoom}; }
    void setView(double zoom, const QPointF& offset);

    QRectF m_area;
    double m_zoom = 1.0;
    QPointF m_offset; ///< of the map's corner from the area's, never positive
};

} // namespace quarn::desktop
