#pragma once

#include "desktop/views/ViewContext.h"

#include <QObject>
#include <QPointF>

class CQuarnView;
class QMouseEvent;
class QNativeGestureEvent;
class QWheelEvent;

namespace quarn::desktop {

class ViewDrawing;
class ViewWidget;

/// What the mouse does in a view.
///
/// Right drag, or left drag, turns the camera about its target; with Shift, and with the middle
/// button, it moves the picture. The wheel and a pinch zoom about the mouse; a double click fits
/// the view to the model. A left click selects the object under it, with Ctrl one more; while a
/// question waits it answers it with the object or the point under it.
class ViewMouse final : public QObject {
    Q_OBJECT

public:
    /// Watches the widget for as long as that lives.
    ViewMouse(ViewContext context, ViewDrawing& drawing, ViewWidget& widget);

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    CQuarnView* freeView() const;
    void press(const QMouseEvent& event);
    void move(const QMouseEvent& event);
    void release(const QMouseEvent& event);
    void turnWheel(const QWheelEvent& event);
    void pinch(const QNativeGestureEvent& event);
    void zoom(double factor, const QPointF& point);
    void click(const QPointF& point, Qt::KeyboardModifiers modifiers);
    void answerAt(CQuarnView& view, const QPointF& frame_point);
    void selectAt(CQuarnView& view, const QPointF& frame_point, bool adds);
    void fit();

    ViewContext m_context;
    ViewDrawing& m_drawing;
    ViewWidget& m_widget;
    Qt::MouseButton m_button = Qt::NoButton; ///< the one that was pressed first and is still down
    QPointF m_pressed_at;
    QPointF m_last_at;
    bool m_is_dragging = false; ///< it has moved farther than a click
};

} // namespace quarn::desktop
