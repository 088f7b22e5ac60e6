#include "desktop/dialogs/Coastlines.h"

#include <QFile>
#include <QList>
#include <QPolygonF>

namespace quarn::desktop {
namespace {

/// Only whole points make a ring, and only three of them a surface.
QPolygonF ringOf(const QByteArray& line, double steps_per_deg) {
    QPolygonF ring;
    qint64 x = 0;
    qint64 y = 0;
    const QList<QByteArray> numbers = line.simplified().split(' ');
    for (qsizetype index = 0; index + 1 < numbers.size(); index += 2) {
        bool is_east = false;
        bool is_north = false;
        x += numbers[index].toInt(&is_east);
        y += numbers[index + 1].toInt(&is_north);
        if (!is_east || !is_north)
            return {};
        ring << QPointF(static_cast<double>(x) / steps_per_deg,
                        -static_cast<double>(y) / steps_per_deg);
    }
    return ring.size() < 3 ? QPolygonF() : ring;
}

} // namespace

QPainterPath coastlinesFromText(QByteArrayView text) {
    const QList<QByteArray> lines = text.toByteArray().split('\n');
    const int steps_per_deg = lines.first().trimmed().toInt();
    QPainterPath outlines;
    outlines.setFillRule(Qt::OddEvenFill);
    if (steps_per_deg <= 0)
        return outlines;
    for (const QByteArray& line : lines.mid(1)) {
        if (const QPolygonF ring = ringOf(line, steps_per_deg); !ring.isEmpty()) {
            outlines.addPolygon(ring);
            outlines.closeSubpath();
        }
    }
    return outlines;
}

const QPainterPath& coastlines() {
    static const QPainterPath outlines = [] {
        QFile file(":/map/coastlines.txt");
        return file.open(QIODevice::ReadOnly) ? coastlinesFromText(file.readAll()) : QPainterPath();
    }();
    return outlines;
}

} // namespace quarn::desktop
