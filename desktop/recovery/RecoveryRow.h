#pragma once

#include <QStyledItemDelegate>

namespace quarn::desktop {

/// Draws a row of the documents that can be recovered: the picture, and beside it the name (the
/// item's text), the place and the time, one below the other.
class RecoveryRow final : public QStyledItemDelegate {
    Q_OBJECT
public:
    static constexpr int PLACE = Qt::UserRole + 1;
    static constexpr int TIME = Qt::UserRole + 2;    ///< of one line or more
    static constexpr int PICTURE = Qt::UserRole + 3; ///< a QImage; a null one where there is none

    using QStyledItemDelegate::QStyledItemDelegate;
    void paint(QPainter* painter, const QStyleOptionViewItem& option,
               const QModelIndex& index) const override;
    QSize sizeHint(const QStyleOptionViewItem& option, const QModelIndex& index) const override;
};

} // namespace quarn::desktop
