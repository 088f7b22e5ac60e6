#pragma once

#include <QImage>
#include <QWidget>

namespace quarn::desktop {

/// A picture in a scroll area: all of it as large as it fits, or each of its pixels as one of the
/// screen's.
class PictureSheet final : public QWidget {
public:
    explicit PictureSheet(QWidget* parent = nullptr);

    void setPicture(const QImage& picture);
    const QImage& picture() const { return m_picture; }
    /// Fills this room without growing over the picture's own size; an empty one means the
    /// picture's own size.
    void fitInto(const QSize& room);
    /// How many pixels of the screen one of the picture takes.
    double scale() const;

protected:
    void paintEvent(QPaintEvent* event) override;

private:
    QSizeF wholeSize() const;
    void takeSize();

    QImage m_picture;
    QImage m_shrunk; ///< for the screen's pixels; null when it must be made anew
    QSize m_room;
};

} // namespace quarn::desktop
