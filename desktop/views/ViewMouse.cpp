#include "desktop/views/ViewMouse.h"

#include "desktop/command_line/CommandPane.h"
#include "desktop/command_line/CommandStarter.h"
#include "desktop/texts/Texts.h"
#include "desktop/views/OpenViews.h"
#include "desktop/views/PickLines.h"
#include "desktop/views/ViewDrawing.h"
#include "desktop/views/ViewWidget.h"
#include "host/session/DocumentState.h"
#include "host/session/ViewFrame.h"
#include "host/session/ViewNavigation.h"

#include <QApplication>
#include <QMouseEvent>
#include <QNativeGestureEvent>
#include <QWheelEvent>

#include <cmath>

namespace quarn::desktop {

namespace {

constexpr double ZOOM_OF_A_NOTCH = 1.2;
constexpr double ANGLE_OF_A_NOTCH = 120.0; ///< of a common mouse wheel, in eighths of a degree

bool isMove(Qt::MouseButton button, Qt::KeyboardModifiers modifiers) {
    return button == Qt::MiddleButton || modifiers.testFlag(Qt::ShiftModifier);
}

} // namespace

ViewMouse::ViewMouse(ViewContext context, ViewDrawing& drawing, ViewWidget& widget)
    : QObject(&widget), m_context(context), m_drawing(drawing), m_widget(widget) {
    widget.installEventFilter(this);
}

bool ViewMouse::eventFilter(QObject* watched, QEvent* event) {
    switch (event->type()) {
    case QEvent::MouseButtonPress:
        press(*static_cast<QMouseEvent*>(event));
        return true;
    case QEvent::MouseMove:
        move(*static_cast<QMouseEvent*>(event));
        return true;
    case QEvent::MouseButtonRelease:
        release(*static_cast<QMouseEvent*>(event));
        return true;
    case QEvent::MouseButtonDblClick:
        m_button = Qt::NoButton;
        fit();
        return true;
    case QEvent::Wheel:
        turnWheel(*static_cast<QWheelEvent*>(event));
        return true;
    case QEvent::NativeGesture:
        pinch(*static_cast<QNativeGestureEvent*>(event));
        return true;
    case QEvent::ContextMenu:
        return true;
    default:
        return QObject::eventFilter(watched, event);
    }
}

CQuarnView* ViewMouse::freeView() const {
    if (!m_context.areViewsFree())
        return nullptr;
    return findView(m_context.session.document(), m_widget.viewName());
}

void ViewMouse::press(const QMouseEvent& event) {
    m_widget.setFocus(Qt::MouseFocusReason);
    if (m_button != Qt::NoButton)
        return;
    m_button = event.button();
    m_pressed_at = m_last_at = event.position();
    m_is_dragging = false;
    CQuarnView* const view = freeView();
    if (view && !m_widget.isActive()) {
        activateView(*view);
        emit m_widget.activated();
    }
}

void ViewMouse::move(const QMouseEvent& event) {
    if (m_button == Qt::NoButton)
        return;
    const QPointF distance = event.position() - m_pressed_at;
    if (distance.manhattanLength() >= QApplication::startDragDistance())
        m_is_dragging = true;
    CQuarnView* const view = freeView();
    if (!m_is_dragging || !view)
        return;
    const QPointF step = (event.position() - m_last_at) * m_widget.framePixelsPerUnit();
    m_last_at = event.position();
    if (isMove(m_button, event.modifiers()))
        panView(*view, step.x(), step.y());
    else
        orbitView(*view, step.x(), step.y());
    m_drawing.wantMoving(m_widget.viewName());
}

void ViewMouse::release(const QMouseEvent& event) {
    if (event.button() != m_button)
        return;
    m_button = Qt::NoButton;
    if (!m_is_dragging && event.button() == Qt::LeftButton)
        click(event.position(), event.modifiers());
}

void ViewMouse::turnWheel(const QWheelEvent& event) {
    zoom(std::pow(ZOOM_OF_A_NOTCH, event.angleDelta().y() / ANGLE_OF_A_NOTCH), event.position());
}

void ViewMouse::pinch(const QNativeGestureEvent& event) {
    if (event.gestureType() == Qt::ZoomNativeGesture)
        zoom(1.0 + event.value(), event.position());
}

void ViewMouse::zoom(double factor, const QPointF& point) {
    CQuarnView* const view = freeView();
    if (!view)
        return;
    const QPointF frame_point = m_widget.framePoint(point);
    zoomView(*view, factor, frame_point.x(), frame_point.y());
    m_drawing.wantMoving(m_widget.viewName());
}

void ViewMouse::click(const QPointF& point, Qt::KeyboardModifiers modifiers) {
    CQuarnView* const view = freeView();
    if (!view)
        return;
    const QPointF frame_point = m_widget.framePoint(point);
    if (m_context.pane.isAsking())
        answerAt(*view, frame_point);
    else
        selectAt(*view, frame_point, modifiers.testFlag(Qt::ControlModifier));
}

void ViewMouse::answerAt(CQuarnView& view, const QPointF& frame_point) {
    if (m_context.pane.askedKind() == Question::Kind::object) {
        if (const auto picked = objectAt(view, frame_point.x(), frame_point.y()))
            m_context.pane.answerWithObject(objectWord(m_context.session.document(), *picked));
    } else if (m_context.pane.takesPoint()) {
        if (const auto point = pointAt(view, frame_point.x(), frame_point.y()))
            m_context.pane.answer(pointText(*point));
    }
}

void ViewMouse::selectAt(CQuarnView& view, const QPointF& frame_point, bool adds) {
    CQuarnDoc& document = m_context.session.document();
    if (objectCount(document) > 0)
        m_context.starter.start(
            selectLine(document, objectAt(view, frame_point.x(), frame_point.y()), adds));
}

/// The view of the mouse is the active one since the first click of the two.
void ViewMouse::fit() {
    if (!m_context.session.isCommandRunning() && objectCount(m_context.session.document()) > 0)
        m_context.starter.start("_-FitView _Enter");
}

} // namespace quarn::desktop
