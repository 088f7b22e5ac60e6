#include "desktop/dialogs/MapFrame.h"

#include <QLineF>

#include <algorithm>
#include <cmath>

namespace quarn::desktop {
namespace {

constexpr double REVEALED_MARGIN_PX = 24.0;
constexpr double FINE_PIXELS_PER_DEG = 12.0;

double rounded(double angle_deg, double steps_per_deg) {
    return std::round(angle_deg * steps_per_deg) / steps_per_deg;
}

/// How far a position must move to lie between two limits.
double wayInto(double position, double least, double greatest) {
    return std::clamp(position, least, greatest) - position;
}

} // namespace

void MapFrame::resize(const QSizeF& widget) {
    const double zoomed_before = m_area.width();
    const double width = std::floor(std::max(2.0, std::min(widget.width(), 2 * widget.height())));
    m_area = QRectF(std::floor((widget.width() - width) / 2),
                    std::floor((widget.height() - width / 2) / 2), width, width / 2);
    const double growth = zoomed_before > 0 ? width / zoomed_before : 1.0;
    setView(m_zoom, m_offset * growth);
}

void MapFrame::zoomAt(double factor, const QPointF& position) {
    const double zoom = std::clamp(m_zoom * factor, 1.0, GREATEST_ZOOM);
    const QPointF from_corner = position - m_area.topLeft();
    setView(zoom, from_corner - (from_corner - m_offset) * (zoom / m_zoom));
}

void MapFrame::reveal(const Place& place) {
    const QPointF position = positionOf(place);
    drag({wayInto(position.x(), m_area.left() + REVEALED_MARGIN_PX,
                  m_area.right() - REVEALED_MARGIN_PX),
          wayInto(position.y(), m_area.top() + REVEALED_MARGIN_PX,
                  m_area.bottom() - REVEALED_MARGIN_PX)});
}

QPointF MapFrame::positionOf(const Place& place) const {
    const WorldMapPoint point = worldMapPoint(place, size());
    return m_area.topLeft() + m_offset + QPointF(point.x, point.y);
}

Place MapFrame::placeAt(const QPointF& position) const {
    const QPointF point = position - m_area.topLeft() - m_offset;
    const Place place = placeOnWorldMap({point.x(), point.y()}, size());
    const double steps_per_deg = pixelsPerDegree() < FINE_PIXELS_PER_DEG ? 10.0 : 100.0;
    return {rounded(place.latitude_deg, steps_per_deg),
            rounded(place.longitude_deg, steps_per_deg)};
}

const City* MapFrame::cityAt(const QPointF& position, double radius_px) const {
    const City* nearest = nullptr;
    double least = radius_px;
    for (const City& city : cities()) {
        const QPointF dot = positionOf({city.latitude_deg, city.longitude_deg});
        if (const double distance = QLineF(dot, position).length(); distance <= least) {
            least = distance;
            nearest = &city;
        }
    }
    return nearest;
}

QTransform MapFrame::widgetFromDegrees() const {
    const QPointF middle = positionOf({0.0, 0.0});
    return QTransform::fromTranslate(middle.x(), middle.y())
        .scale(pixelsPerDegree(), pixelsPerDegree());
}

void MapFrame::setView(double zoom, const QPointF& offset) {
    m_zoom = zoom;
    m_offset = {std::clamp(offset.x(), m_area.width() * (1 - zoom), 0.0),
                std::clamp(offset.y(), m_area.height() * (1 - zoom), 0.0)};
}

} // namespace quarn::desktop
