#include "desktop/recovery/RecoveryRow.h"

#include <QApplication>
#include <QPainter>

namespace quarn::desktop {

namespace {

constexpr QSize PICTURE_PX{144, 90};
constexpr int MARGIN_PX = 8;
constexpr int LINE_GAP_PX = 4;

/// The picture in the middle of its place, as large as it fits.
void paintPicture(QPainter& painter, const QRect& place, const QImage& picture,
                  const QPalette& palette) {
    painter.fillRect(place, palette.color(QPalette::Midlight));
    if (!picture.isNull()) {
        QRect shown({}, picture.size().scaled(place.size(), Qt::KeepAspectRatio));
        shown.moveCenter(place.center());
        painter.setRenderHint(QPainter::SmoothPixmapTransform);
        painter.drawImage(shown, picture);
    }
    painter.setPen(palette.color(QPalette::Mid));
    painter.drawRect(place.adjusted(0, 0, -1, -1));
}

/// A line of text at the top of a place, cut in its middle where it is too long: a path's beginning
/// and end tell most. @return the place below it
QRect paintLine(QPainter& painter, const QRect& place, const QString& text) {
    const QFontMetrics metrics = painter.fontMetrics();
    painter.drawText(place, Qt::AlignLeading | Qt::AlignTop,
                     metrics.elidedText(text, Qt::ElideMiddle, place.width()));
    return place.adjusted(0, metrics.height() + LINE_GAP_PX, 0, 0);
}

} // namespace

void RecoveryRow::paint(QPainter* painter, const QStyleOptionViewItem& option,
                        const QModelIndex& index) const {
    QStyleOptionViewItem row = option;
    initStyleOption(&row, index);
    row.text.clear();
    QStyle* const style = row.widget ? row.widget->style() : QApplication::style();
    style->drawControl(QStyle::CE_ItemViewItem, &row, painter, row.widget);

    painter->save();
    const QRect inner = row.rect.adjusted(MARGIN_PX, MARGIN_PX, -MARGIN_PX, -MARGIN_PX);
    const QRect picture =
        QStyle::alignedRect(row.direction, Qt::AlignLeading | Qt::AlignVCenter, PICTURE_PX, inner);
    paintPicture(*painter, picture, index.data(PICTURE).value<QImage>(), row.palette);
    const int beside = PICTURE_PX.width() + 2 * MARGIN_PX;
    QRect lines = row.direction == Qt::RightToLeft ? inner.adjusted(0, 0, -beside, 0)
                                                   : inner.adjusted(beside, 0, 0, 0);
    const bool is_selected = (row.state & QStyle::State_Selected) != 0;
    painter->setPen(row.palette.color(is_selected ? QPalette::HighlightedText : QPalette::Text));
    QFont bold = row.font;
    bold.setBold(true);
    painter->setFont(bold);
    lines = paintLine(*painter, lines, index.data(Qt::DisplayRole).toString());
    painter->setFont(row.font);
    lines = paintLine(*painter, lines, index.data(PLACE).toString());
    for (const QString& line : index.data(TIME).toString().split('\n'))
        lines = paintLine(*painter, lines, line);
    painter->restore();
}

QSize RecoveryRow::sizeHint(const QStyleOptionViewItem&, const QModelIndex&) const {
    return PICTURE_PX + QSize(2 * MARGIN_PX, 2 * MARGIN_PX);
}

} // namespace quarn::desktop
