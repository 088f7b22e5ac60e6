#include "desktop/dialogs/WorldMap.h"

#include "desktop/dialogs/MapDrawing.h"
#include "desktop/dialogs/PlaceText.h"
#include "desktop/texts/Texts.h"

#include <QKeyEvent>
#include <QMouseEvent>
#include <QPainter>
#include <QWheelEvent>

#include <algorithm>
#include <cmath>

namespace quarn::desktop {
namespace {

constexpr double CITY_RADIUS_PX = 5.0;
constexpr double KEY_ZOOM = 1.5;

double stepOf(Qt::KeyboardModifiers modifiers) {
    if (modifiers & Qt::ShiftModifier)
        return 10.0;
    return modifiers & Qt::ControlModifier ? 0.01 : 1.0;
}

} // namespace

WorldMap::WorldMap(QWidget* parent) : QWidget(parent) {
    setMouseTracking(true);
    setFocusPolicy(Qt::StrongFocus);
    setCursor(Qt::CrossCursor);
    setMinimumSize(360, 180);
    QSizePolicy policy(QSizePolicy::Expanding, QSizePolicy::Expanding);
    setSizePolicy(policy);
    setAccessibleName(localized(L"Map of the world", 45313));
    m_frame.resize(size());
}

QSize WorldMap::sizeHint() const {
    return {720, 360};
}

void WorldMap::setPlace(const std::optional<Place>& place) {
    m_place = place;
    if (m_place && m_frame.zoom() > 1) {
        m_frame.reveal(*m_place);
        m_land = {};
    }
    update();
}

void WorldMap::choose(const Place& place) {
    setPlace(place);
    emit placeChosen(place);
}

void WorldMap::chooseAt(const QPointF& position, bool takes_cities) {
    const City* const city = takes_cities ? m_frame.cityAt(position, CITY_RADIUS_PX) : nullptr;
    choose(city ? Place{city->latitude_deg, city->longitude_deg} : m_frame.placeAt(position));
}

void WorldMap::moveMark(int key, double step_deg) {
    const double north = key == Qt::Key_Up ? 1 : key == Qt::Key_Down ? -1 : 0;
    const double east = key == Qt::Key_Right ? 1 : key == Qt::Key_Left ? -1 : 0;
    const Place from = m_place.value_or(Place{});
    // Past the 180th meridian the other side begins.
    const double longitude = std::remainder(from.longitude_deg + east * step_deg, 360.0);
    choose({std::clamp(from.latitude_deg + north * step_deg, -90.0, 90.0), longitude});
}

void WorldMap::zoomAt(double factor, const QPointF& position) {
    m_frame.zoomAt(factor, position);
    m_land = {};
    update();
}

void WorldMap::redrawLand() {
    m_land = QPixmap(size() * devicePixelRatioF());
    m_land.setDevicePixelRatio(devicePixelRatioF());
    m_land.fill(Qt::transparent);
    QPainter painter(&m_land);
    painter.setFont(font());
    drawEarth(painter, m_frame, mapColours(palette()));
}

void WorldMap::paintEvent(QPaintEvent*) {
    if (m_land.isNull() || m_land.devicePixelRatio() != devicePixelRatioF())
        redrawLand();
    const MapColours colours = mapColours(palette());
    QPainter painter(this);
    painter.drawPixmap(0, 0, m_land);
    if (m_place)
        drawMark(painter, m_frame, *m_place, colours);
    drawLabel(painter);
    painter.setBrush(Qt::NoBrush);
    painter.setPen(hasFocus() ? palette().color(QPalette::Highlight) : colours.coast);
    painter.drawRect(m_frame.area().adjusted(0.5, 0.5, -0.5, -0.5));
}

/// The name of the city under the mouse, beside its dot.
void WorldMap::drawLabel(QPainter& painter) const {
    if (!m_city_below)
        return;
    const MapColours colours = mapColours(palette());
    const QString name = cityText(*m_city_below);
    const QPointF dot =
        m_frame.positionOf({m_city_below->latitude_deg, m_city_below->longitude_deg});
    QRectF note = QRectF(painter.fontMetrics().boundingRect(name)).adjusted(-7, -4, 7, 4);
    note.moveBottomLeft(dot + QPointF(10, -8));
    const QRectF& area = m_frame.area();
    if (note.right() > area.right() - 2)
        note.moveRight(std::max(dot.x() - 10, area.left() + 2 + note.width()));
    if (note.top() < area.top() + 2)
        note.moveTop(dot.y() + 12);
    painter.save();
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setPen(QPen(colours.coast, 1));
    painter.setBrush(colours.note);
    painter.drawRoundedRect(note, 4, 4);
    painter.setPen(palette().color(QPalette::WindowText));
    painter.drawText(note, Qt::AlignCenter, name);
    painter.restore();
}

void WorldMap::resizeEvent(QResizeEvent*) {
    m_frame.resize(size());
    m_land = {};
}

void WorldMap::mousePressEvent(QMouseEvent* event) {
    if (event->button() == Qt::LeftButton && m_frame.area().contains(event->position()))
        chooseAt(event->position(), true);
    else if (event->button() == Qt::RightButton || event->button() == Qt::MiddleButton)
        m_dragged = event->position();
}

void WorldMap::mouseMoveEvent(QMouseEvent* event) {
    if (m_dragged) {
        m_frame.drag(event->position() - *m_dragged);
        m_dragged = event->position();
        m_land = {};
        update();
    } else if (event->buttons() & Qt::LeftButton) {
        chooseAt(event->position(), false);
    }
    showHovered(event->position());
}

void WorldMap::mouseReleaseEvent(QMouseEvent* event) {
    if (event->button() == Qt::RightButton || event->button() == Qt::MiddleButton)
        m_dragged.reset();
}

void WorldMap::showHovered(const QPointF& position) {
    const bool is_on_map = m_frame.area().contains(position);
    const City* const city = is_on_map ? m_frame.cityAt(position, CITY_RADIUS_PX) : nullptr;
    if (city != m_city_below) {
        m_city_below = city;
        update();
    }
    emit hovered(is_on_map ? std::optional(m_frame.placeAt(position)) : std::nullopt);
}

void WorldMap::leaveEvent(QEvent*) {
    m_city_below = nullptr;
    update();
    emit hovered({});
}

void WorldMap::wheelEvent(QWheelEvent* event) {
    constexpr double eighths_per_notch = 120.0;
    zoomAt(std::pow(1.25, event->angleDelta().y() / eighths_per_notch), event->position());
    event->accept();
}

void WorldMap::keyPressEvent(QKeyEvent* event) {
    const QPointF middle =
        m_place ? m_frame.positionOf(*m_place) : QPointF(m_frame.area().center());
    switch (event->key()) {
    case Qt::Key_Left:
    case Qt::Key_Right:
    case Qt::Key_Up:
    case Qt::Key_Down:
        return moveMark(event->key(), stepOf(event->modifiers()));
    case Qt::Key_Plus:
        return zoomAt(KEY_ZOOM, middle);
    case Qt::Key_Minus:
        return zoomAt(1 / KEY_ZOOM, middle);
    case Qt::Key_0:
        return zoomAt(1 / MapFrame::GREATEST_ZOOM, middle);
    default:
        QWidget::keyPressEvent(event);
    }
}

void WorldMap::changeEvent(QEvent* event) {
    if (event->type() == QEvent::PaletteChange || event->type() == QEvent::FontChange)
        m_land = {};
    QWidget::changeEvent(event);
}

} // namespace quarn::desktop
