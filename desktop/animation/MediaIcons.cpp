#include "desktop/animation/MediaIcons.h"

#include <QIconEngine>
#include <QPainter>
#include <QPainterPath>

namespace quarn::desktop {

namespace {

/// Signs are drawn in a square of this side.
constexpr double SIDE = 16.0;

/// A triangle that points to the right, or to the left where the tip is left of the base.
void addTriangle(QPainterPath& path, double base_x, double tip_x) {
    path.moveTo(base_x, 3);
    path.lineTo(tip_x, 8);
    path.lineTo(base_x, 13);
    path.closeSubpath();
}

/// A sheet with a folded corner.
void addSheet(QPainterPath& path) {
    path.setFillRule(Qt::OddEvenFill);
    path.moveTo(3, 1.5);
    path.lineTo(9.5, 1.5);
    path.lineTo(13, 5);
    path.lineTo(13, 14.5);
    path.lineTo(3, 14.5);
    path.closeSubpath();
    addTriangle(path, 6.2, 10.8);
}

QPainterPath shapeOf(MediaSign sign) {
    QPainterPath path;
    switch (sign) {
    case MediaSign::first:
        path.addRect(3, 3, 2, 10);
        addTriangle(path, 13, 5.5);
        break;
    case MediaSign::previous:
        addTriangle(path, 12, 4);
        break;
    case MediaSign::play:
        path.moveTo(4, 2);
        path.lineTo(14, 8);
        path.lineTo(4, 14);
        path.closeSubpath();
        break;
    case MediaSign::stop:
        path.addRect(3, 3, 10, 10);
        break;
    case MediaSign::next:
        addTriangle(path, 4, 12);
        break;
    case MediaSign::last:
        addTriangle(path, 3, 10.5);
        path.addRect(11, 3, 2, 10);
        break;
    case MediaSign::record:
        path.addEllipse(QPointF(8, 8), 5.5, 5.5);
        break;
    case MediaSign::page:
        addSheet(path);
        break;
    }
    return path;
}

class MediaIconEngine final : public QIconEngine {
public:
    MediaIconEngine(MediaSign sign, const QColor& colour, const QColor& disabled_colour)
        : m_sign(sign), m_colour(colour), m_disabled_colour(disabled_colour) {}

    void paint(QPainter* painter, const QRect& area, QIcon::Mode mode, QIcon::State) override {
        painter->save();
        painter->setRenderHint(QPainter::Antialiasing);
        painter->translate(area.topLeft());
        painter->scale(area.width() / SIDE, area.height() / SIDE);
        painter->fillPath(shapeOf(m_sign), mode == QIcon::Disabled ? m_disabled_colour : m_colour);
        painter->restore();
    }

    QPixmap pixmap(const QSize& size, QIcon::Mode mode, QIcon::State state) override {
        QPixmap picture(size);
        picture.fill(Qt::transparent);
        QPainter painter(&picture);
        paint(&painter, QRect(QPoint(0, 0), size), mode, state);
        return picture;
    }

    QIconEngine* clone() const override {
        return new MediaIconEngine(m_sign, m_colour, m_disabled_colour);
    }

private:
    MediaSign m_sign;
    QColor m_colour;
    QColor m_disabled_colour;
};

} // namespace

QIcon mediaIcon(MediaSign sign, const QColor& colour, const QColor& disabled_colour) {
    return QIcon(new MediaIconEngine(sign, colour, disabled_colour));
}

} // namespace quarn::desktop
