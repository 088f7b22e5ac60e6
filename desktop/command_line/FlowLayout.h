#pragma once

#include <QLayout>
#include <QList>

namespace quarn::desktop {

/// Puts its widgets side by side and begins another row where one is full, as words in a text.
class FlowLayout final : public QLayout {
public:
    explicit FlowLayout(int spacing_px);
    ~FlowLayout() override;

    void addItem(QLayoutItem* item) override;
    int count() const override;
    QLayoutItem* itemAt(int index) const override;
    QLayoutItem* takeAt(int index) override;
    Qt::Orientations expandingDirections() const override { return {}; }
    bool hasHeightForWidth() const override { return true; }
    int heightForWidth(int width) const override;
    void setGeometry(const QRect& area) override;
    QSize minimumSize() const override;
    QSize sizeHint() const override;

private:
    template <class Place> int flow(const QRect& area, Place&& place) const;

    QList<QLayoutItem*> m_items;
};

} // namespace quarn::desktop
