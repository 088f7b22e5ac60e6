#pragma once

#include "host/front_end/FrontEndChoices.h"

#include <QImage>
#include <QMenu>
#include <QToolButton>
#include <QWidget>

#include <optional>

namespace quarn::desktop {

/// Shows the picture of one view, with the view's name in its corner. It knows the view by its name
/// alone, and nothing of the mouse.
class ViewWidget final : public QWidget {
    Q_OBJECT

public:
    explicit ViewWidget(const QString& view_name, QWidget* parent = nullptr);

    const QString& viewName() const { return m_view_name; }

    /// Takes a copy of what the view shows.
    void setPicture(const ShownPicture& picture);
    /// The picture that is shown; of no size before the first one.
    const QImage& picture() const { return m_picture; }

    /// A frame of a size of its own, in pixels, is shown as large as fits; without one the frame
    /// has the widget's size.
    void setFixedFrame(std::optional<QSize> size_px) { m_fixed_frame = size_px; }
    const std::optional<QSize>& fixedFrame() const { return m_fixed_frame; }
    /// The size that the view's frame should have, in pixels of the screen.
    QSize wantedFrame() const;

    /// A point of the widget in pixels of the view's frame.
    QPointF framePoint(const QPointF& point) const;
    /// How many pixels of the frame one unit of the widget has.
    double framePixelsPerUnit() const;

    void setActive(bool is_active);
    bool isActive() const { return m_is_active; }
    /// Words across the picture, for a view with nothing in it; empty for none.
    void setHint(const QString& hint);

    /// The label in the corner, which opens the view's menu.
    QToolButton& nameButton() { return *m_name_button; }
    QMenu& menu() { return *m_menu; }
    /// Shows on the button in the other corner whether this view has all the room.
    void setMaximized(bool is_maximized);
    QToolButton& maximizeButton() { return *m_maximize_button; }

    QSize minimumSizeHint() const override { return {120, 80}; }
    QSize sizeHint() const override { return {480, 320}; }

signals:
    /// The widget has another size, or is seen again.
    void frameChanged();
    /// A person chose this view to work in.
    void activated();
    /// The button in the other corner was clicked.
    void maximizeClicked();

protected:
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void showEvent(QShowEvent* event) override;

private:
    QSize frameSize_px() const;
    void styleName();
    void placeButtons();
    void paintBorder(QPainter& painter);

    QString m_view_name;
    QImage m_picture;
    std::optional<QSize> m_fixed_frame;
    QString m_hint;
    bool m_is_active = false;
    QMenu* m_menu;
    QToolButton* m_name_button;
    QToolButton* m_maximize_button;
};

} // namespace quarn::desktop
