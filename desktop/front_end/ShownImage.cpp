#include "desktop/front_end/ShownImage.h"

#include <QPainter>

namespace quarn::desktop {

namespace {

constexpr qint64 BYTES_PER_PIXEL = 4;

bool isSeeThrough(const ShownPicture& picture) {
    constexpr std::uint8_t opaque = 255;
    for (std::size_t i = 3; i < picture.rgba.size(); i += BYTES_PER_PIXEL)
        if (picture.rgba[i] != opaque)
            return true;
    return false;
}

QImage squares() {
    constexpr int side_px = 8;
    QImage tile(2 * side_px, 2 * side_px, QImage::Format_RGB32);
    tile.fill(QColor(0xCC, 0xCC, 0xCC));
    QPainter painter(&tile);
    painter.fillRect(0, 0, side_px, side_px, Qt::white);
    painter.fillRect(side_px, side_px, side_px, side_px, Qt::white);
    return tile;
}

} // namespace

QImage imageOf(const ShownPicture& picture) {
    const qint64 row_bytes = picture.width_px * BYTES_PER_PIXEL;
    if (picture.width_px <= 0 || picture.height_px <= 0 ||
        static_cast<qint64>(picture.rgba.size()) < row_bytes * picture.height_px)
        return {};
    const bool is_see_through = isSeeThrough(picture);
    const QImage borrowed(picture.rgba.data(), picture.width_px, picture.height_px, row_bytes,
                          is_see_through ? QImage::Format_RGBA8888 : QImage::Format_RGBX8888);
    if (!is_see_through)
        return borrowed.convertToFormat(QImage::Format_RGB32);
    QImage image(borrowed.size(), QImage::Format_RGB32);
    QPainter painter(&image);
    painter.fillRect(image.rect(), QBrush(squares()));
    painter.drawImage(0, 0, borrowed);
    return image;
}

} // namespace quarn::desktop
