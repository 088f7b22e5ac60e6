#pragma once

#include "desktop/dialogs/MapFrame.h"
#include "host/cities/Cities.h"
#include "host/front_end/FrontEndChoices.h"

#include <QPixmap>
#include <QWidget>

#include <optional>

namespace quarn::desktop {

/// A map of the earth on which a place is marked and chosen.
///
/// A click chooses the place under the mouse, or the city whose dot it meets; dragging moves the
/// mark. The wheel and the keys + and - zoom, the right button drags the map, 0 shows all of it.
/// The arrow keys move the mark by a degree, with Shift by ten, with Control by a hundredth.
class WorldMap final : public QWidget {
    Q_OBJECT

public:
    explicit WorldMap(QWidget* parent = nullptr);

    /// Marks a place; nothing marks none.
    void setPlace(const std::optional<Place>& place);
    const std::optional<Place>& place() const { return m_place; }
    /// Where a place is drawn, in the widget's own coordinates.
    QPointF positionOf(const Place& place) const { return m_frame.positionOf(place); }
    /// How many times larger than all of the earth it is shown.
    double zoom() const { return m_frame.zoom(); }

    QSize sizeHint() const override;

signals:
    /// The person chose a place. It is marked already.
    void placeChosen(const quarn::Place& place);
    /// The mouse is over a place, or over none any more.
    void hovered(const std::optional<quarn::Place>& place);

protected:
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;
    void leaveEvent(QEvent* event) override;
    void wheelEvent(QWheelEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void changeEvent(QEvent* event) override;

private:
    void chooseAt(const QPointF& position, bool takes_cities);
    void choose(const Place& place);
    void moveMark(int key, double step_deg);
    void zoomAt(double factor, const QPointF& position);
    void showHovered(const QPointF& position);
    void redrawLand();
    void drawLabel(QPainter& painter) const;

    MapFrame m_frame;
    std::optional<Place> m_place;
    const City* m_city_below = nullptr; ///< under the mouse
    QPixmap m_land;                     ///< all but the mark; null when it must be drawn anew
    std::optional<QPointF> m_dragged;   ///< where the right button took the map last
};

} // namespace quarn::desktop
