#pragma once

#include "desktop/views/ViewContext.h"

#include <QMap>
#include <QObject>
#include <QStringList>
#include <QTimer>

#include <functional>

namespace quarn::desktop {

class ViewWidget;

/// Draws the views of the window when they need it: at most once in a turn of the event loop,
/// quickly while something moves and well once it rests, and never while a command draws them
/// itself. What is put off is done when the command has ended.
class ViewDrawing final : public QObject {
    Q_OBJECT

public:
    /// @param widgets  the widgets of the views that are there now
    ViewDrawing(ViewContext context, std::function<QList<ViewWidget*>()> widgets,
                QObject* parent = nullptr);

    /// A view needs to be drawn.
    void want(const QString& view_name) { mark(view_name, Quality::resting); }
    /// As want, while the mouse moves the camera: it is drawn well when that stopped.
    void wantMoving(const QString& view_name) { mark(view_name, Quality::moving); }
    void wantAll();
    /// Gives the frames of views the sizes of their widgets, and draws those that changed.
    void fitFrames();
    /// Something else drew the view: nothing is left to do.
    void forget(const QString& view_name);
    /// Whether it draws a view now; else who draws is a command.
    bool isDrawing() const { return m_is_drawing; }
    /// Draws what is wanted now instead of in the next turn.
    void drawWanted();

private:
    enum class Quality { moving, resting };
    void mark(const QString& view_name, Quality quality);
    void draw(const QString& view_name, Quality quality);
    bool isShown(const QString& view_name) const;
    void rest();

    ViewContext m_context;
    std::function<QList<ViewWidget*>()> m_widgets;
    QMap<QString, Quality> m_wanted;
    QStringList m_moving; ///< drawn quickly last time
    QTimer m_turn;
    QTimer m_rest;
    qint64 m_quick_draw_ms = 0; ///< how long the last moving picture took
    bool m_is_drawing = false;
};

} // namespace quarn::desktop
