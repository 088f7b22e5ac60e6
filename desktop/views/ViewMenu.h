#pragma once

#include "desktop/views/ViewContext.h"

#include <QObject>

class QMenu;

namespace quarn::desktop {

class ViewWidget;

/// The menu behind a view's name: display modes, directions, frame sizes, and how much room the
/// view has. What changes the document goes through commands, in the view whose menu it is.
class ViewMenu final : public QObject {
    Q_OBJECT

public:
    /// Fills the widget's menu whenever it opens; belongs to the widget.
    ViewMenu(ViewContext context, ViewWidget& widget);

signals:
    /// The frame is to have the size of the widget again.
    void frameFreed();

private:
    void fill();
    void addModes(QMenu& menu);
    void addDirections(QMenu& menu);
    void addFrameSizes(QMenu& menu);
    void run(const QString& line);

    ViewContext m_context;
    ViewWidget& m_widget;
};

} // namespace quarn::desktop
