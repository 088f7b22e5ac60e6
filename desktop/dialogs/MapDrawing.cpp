#include "desktop/dialogs/MapDrawing.h"

#include "desktop/dialogs/Coastlines.h"
#include "desktop/texts/Texts.h"

#include <QLinearGradient>

#include <cmath>

namespace quarn::desktop {
namespace {

/// Of the year 2000 (J. Meeus, "Astronomical Algorithms", 2nd ed., eq. 22.2: 23 degrees 26' 21").
constexpr double TROPIC_DEG = 23.4393;

constexpr MapColours LIGHT = {
    .sea = QColor(199, 222, 240),
    .deep_sea = QColor(171, 203, 228),
    .land = QColor(238, 233, 217),
    .coast = QColor(140, 150, 148),
    .grid = QColor(70, 105, 135, 45),
    .named_grid = QColor(60, 95, 130, 130),
    .text = QColor(50, 80, 110, 220),
    .city = QColor(90, 88, 80),
    .mark = QColor(208, 38, 38),
    .mark_rim = QColor(255, 255, 255),
    .note = QColor(255, 255, 255, 225),
};

constexpr MapColours DARK = {
    .sea = QColor(33, 48, 64),
    .deep_sea = QColor(25, 37, 51),
    .land = QColor(78, 84, 82),
    .coast = QColor(128, 138, 136),
    .grid = QColor(170, 200, 230, 32),
    .named_grid = QColor(160, 195, 230, 105),
    .text = QColor(175, 205, 235, 220),
    .city = QColor(206, 204, 190),
    .mark = QColor(255, 96, 84),
    .mark_rim = QColor(20, 24, 28),
    .note = QColor(20, 26, 34, 225),
};

void drawSea(QPainter& painter, const MapFrame& frame, const MapColours& colours) {
    QLinearGradient depth(frame.positionOf({90, 0}), frame.positionOf({-90, 0}));
    depth.setColorAt(0.0, colours.deep_sea);
    depth.setColorAt(0.5, colours.sea);
    depth.setColorAt(1.0, colours.deep_sea);
    painter.fillRect(frame.area(), depth);
}

/// The outline is thin whatever the zoom.
void drawLand(QPainter& painter, const MapFrame& frame, const MapColours& colours) {
    painter.save();
    painter.setTransform(frame.widgetFromDegrees(), true);
    QPen coast(colours.coast, 0.8);
    coast.setCosmetic(true);
    coast.setJoinStyle(Qt::RoundJoin);
    painter.setPen(coast);
    painter.setBrush(colours.land);
    painter.drawPath(coastlines());
    painter.restore();
}

/// A line in the middle of a row of pixels stays sharp.
double crisp(double position) {
    return std::floor(position) + 0.5;
}

void drawLatitude(QPainter& painter, const MapFrame& frame, double latitude_deg) {
    const double y = crisp(frame.positionOf({latitude_deg, 0}).y());
    painter.drawLine(QPointF(frame.area().left(), y), QPointF(frame.area().right(), y));
}

void drawLongitude(QPainter& painter, const MapFrame& frame, double longitude_deg) {
    const double x = crisp(frame.positionOf({0, longitude_deg}).x());
    painter.drawLine(QPointF(x, frame.area().top()), QPointF(x, frame.area().bottom()));
}

void drawGrid(QPainter& painter, const MapFrame& frame, const MapColours& colours) {
    const int step_deg = frame.zoom() < 2.5 ? 30 : frame.zoom() < 7 ? 10 : 5;
    painter.setPen(QPen(colours.grid, 1));
    for (int longitude = -180 + step_deg; longitude < 180; longitude += step_deg)
        drawLongitude(painter, frame, longitude);
    for (int latitude = -90 + step_deg; latitude < 90; latitude += step_deg) {
        if (latitude != 0)
            drawLatitude(painter, frame, latitude);
    }
}

void drawNamedCircle(QPainter& painter, const MapFrame& frame, const MapColours& colours,
                     double latitude_deg, const QString& name) {
    const bool is_equator = latitude_deg == 0.0;
    painter.setPen(QPen(colours.named_grid, 1, is_equator ? Qt::SolidLine : Qt::DashLine));
    drawLatitude(painter, frame, latitude_deg);
    const double y = frame.positionOf({latitude_deg, 0}).y();
    painter.setPen(colours.text);
    painter.drawText(QPointF(frame.area().left() + 7, y - 4), name);
}

void drawNamedCircles(QPainter& painter, const MapFrame& frame, const MapColours& colours) {
    QFont small = painter.font();
    small.setPointSizeF(small.pointSizeF() * 0.82);
    painter.save();
    painter.setFont(small);
    painter.setRenderHint(QPainter::Antialiasing, false);
    drawNamedCircle(painter, frame, colours, 0.0, localized(L"Equator", 45315));
    drawNamedCircle(painter, frame, colours, TROPIC_DEG, localized(L"Tropic of Cancer", 45316));
    drawNamedCircle(painter, frame, colours, -TROPIC_DEG, localized(L"Tropic of Capricorn", 45317));
    painter.restore();
}

void drawCities(QPainter& painter, const MapFrame& frame, const MapColours& colours) {
    const double radius = frame.zoom() < 2 ? 1.4 : frame.zoom() < 6 ? 2.0 : 2.8;
    painter.setPen(Qt::NoPen);
    painter.setBrush(colours.city);
    for (const City& city : cities())
        painter.drawEllipse(frame.positionOf({city.latitude_deg, city.longitude_deg}), radius,
                            radius);
}

} // namespace

MapColours mapColours(const QPalette& palette) {
    return palette.color(QPalette::Window).lightness() < 128 ? DARK : LIGHT;
}

void drawEarth(QPainter& painter, const MapFrame& frame, const MapColours& colours) {
    painter.save();
    painter.setClipRect(frame.area());
    drawSea(painter, frame, colours);
    painter.setRenderHint(QPainter::Antialiasing);
    drawLand(painter, frame, colours);
    painter.setRenderHint(QPainter::Antialiasing, false);
    drawGrid(painter, frame, colours);
    drawNamedCircles(painter, frame, colours);
    painter.setRenderHint(QPainter::Antialiasing);
    drawCities(painter, frame, colours);
    painter.restore();
}

void drawMark(QPainter& painter, const MapFrame& frame, const Place& place,
              const MapColours& colours) {
    painter.save();
    painter.setClipRect(frame.area());
    QColor faint = colours.mark;
    faint.setAlphaF(0.55F);
    painter.setPen(QPen(faint, 1));
    drawLatitude(painter, frame, place.latitude_deg);
    drawLongitude(painter, frame, place.longitude_deg);
    painter.setRenderHint(QPainter::Antialiasing);
    const QPointF middle = frame.positionOf(place);
    painter.setBrush(Qt::NoBrush);
    painter.setPen(QPen(colours.mark_rim, 4.5));
    painter.drawEllipse(middle, 7, 7);
    painter.setPen(QPen(colours.mark, 2.5));
    painter.drawEllipse(middle, 7, 7);
    painter.setPen(Qt::NoPen);
    painter.setBrush(colours.mark);
    painter.drawEllipse(middle, 2.2, 2.2);
    painter.restore();
}

} // namespace quarn::desktop
