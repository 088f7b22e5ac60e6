#include "desktop/command_line/FlowLayout.h"

namespace quarn::desktop {

FlowLayout::FlowLayout(int spacing_px) {
    setContentsMargins(0, 0, 0, 0);
    setSpacing(spacing_px);
}

FlowLayout::~FlowLayout() {
    qDeleteAll(m_items);
}

void FlowLayout::addItem(QLayoutItem* item) {
    m_items.append(item);
}

int FlowLayout::count() const {
    return static_cast<int>(m_items.size());
}

QLayoutItem* FlowLayout::itemAt(int index) const {
    return m_items.value(index);
}

QLayoutItem* FlowLayout::takeAt(int index) {
    return index >= 0 && index < m_items.size() ? m_items.takeAt(index) : nullptr;
}

int FlowLayout::heightForWidth(int width) const {
    return flow(QRect(0, 0, width, 0), [](QLayoutItem*, const QRect&) {});
}

void FlowLayout::setGeometry(const QRect& area) {
    QLayout::setGeometry(area);
    flow(area, [](QLayoutItem* item, const QRect& place) { item->setGeometry(place); });
}

QSize FlowLayout::minimumSize() const {
    QSize size;
    for (const QLayoutItem* item : m_items) {
        if (!item->isEmpty())
            size = size.expandedTo(item->minimumSize());
    }
    return size;
}

/// All of it in one row.
QSize FlowLayout::sizeHint() const {
    QSize size;
    for (const QLayoutItem* item : m_items) {
        if (item->isEmpty())
            continue;
        const QSize hint = item->sizeHint();
        size =
            QSize(size.width() + hint.width() + spacing(), std::max(size.height(), hint.height()));
    }
    return size;
}

/// @param place  told where each item goes
/// @return the height that the rows take
template <class Place> int FlowLayout::flow(const QRect& area, Place&& place) const {
    int x = area.left();
    int y = area.top();
    int row_height = 0;
    for (QLayoutItem* item : m_items) {
        if (item->isEmpty())
            continue;
        const QSize size(std::min(item->sizeHint().width(), area.width()),
                         item->sizeHint().height());
        if (x > area.left() && x + size.width() > area.left() + area.width()) {
            x = area.left();
            y += row_height + spacing();
            row_height = 0;
        }
        place(item, QRect(QPoint(x, y), size));
        x += size.width() + spacing();
        row_height = std::max(row_height, size.height());
    }
    return y + row_height - area.top();
}

} // namespace quarn::desktop
