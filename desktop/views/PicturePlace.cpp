#include "desktop/views/PicturePlace.h"

namespace quarn::desktop {

QRectF picturePlace(const QSize& widget, const QSize& picture_px) {
    if (widget.isEmpty() || picture_px.isEmpty())
        return {};
    const QSizeF size = QSizeF(picture_px).scaled(QSizeF(widget), Qt::KeepAspectRatio);
    return {QPointF((widget.width() - size.width()) / 2.0, (widget.height() - size.height()) / 2.0),
            size};
}

QPointF picturePoint(const QPointF& point, const QRectF& place, const QSize& picture_px) {
    const QPointF inside = point - place.topLeft();
    return {inside.x() * picture_px.width() / place.width(),
            inside.y() * picture_px.height() / place.height()};
}

} // namespace quarn::desktop
