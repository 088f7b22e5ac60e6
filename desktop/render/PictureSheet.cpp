#include "desktop/render/PictureSheet.h"

#include <QPainter>

#include <cmath>

namespace quarn::desktop {

PictureSheet::PictureSheet(QWidget* parent) : QWidget(parent) {
    setSizePolicy(QSizePolicy::Fixed, QSizePolicy::Fixed);
}

void PictureSheet::setPicture(const QImage& picture) {
    m_picture = picture;
    m_shrunk = {};
    takeSize();
    update();
}

void PictureSheet::fitInto(const QSize& room) {
    m_room = room;
    takeSize();
}

QSizeF PictureSheet::wholeSize() const {
    return QSizeF(m_picture.size()) / devicePixelRatioF();
}

void PictureSheet::takeSize() {
    QSizeF shown = wholeSize();
    if (!m_room.isEmpty() && (shown.width() > m_room.width() || shown.height() > m_room.height()))
        shown.scale(m_room, Qt::KeepAspectRatio);
    setFixedSize(shown.toSize().expandedTo({1, 1}));
}

double PictureSheet::scale() const {
    return m_picture.isNull() ? 1.0 : width() * devicePixelRatioF() / m_picture.width();
}

/// At its own size the picture's pixels are the screen's; only a smaller one is smoothed.
void PictureSheet::paintEvent(QPaintEvent*) {
    if (m_picture.isNull())
        return;
    QPainter painter(this);
    const QSize pixels = (QSizeF(size()) * devicePixelRatioF()).toSize();
    const bool is_whole = std::abs(pixels.width() - m_picture.width()) <= 1;
    if (is_whole) {
        QImage whole = m_picture;
        whole.setDevicePixelRatio(devicePixelRatioF());
        painter.drawImage(0, 0, whole);
        return;
    }
    if (m_shrunk.size() != pixels)
        m_shrunk = m_picture.scaled(pixels, Qt::IgnoreAspectRatio, Qt::SmoothTransformation);
    m_shrunk.setDevicePixelRatio(devicePixelRatioF());
    painter.drawImage(0, 0, m_shrunk);
}

} // namespace quarn::desktop
