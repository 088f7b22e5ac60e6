#pragma once

#include "desktop/views/ViewContext.h"
#include "desktop/views/ViewDrawing.h"
#include "desktop/views/ViewGrid.h"
#include "host/front_end/FrontEndChoices.h"
#include "sdk/qncore/QnView.h"

#include <QMap>
#include <QMenu>
#include <QSize>

namespace quarn::desktop {

class ViewWidget;

/// All views of the document, side by side. It keeps views by their names and looks them up anew
/// after every command.
class ViewArea final : public QWidget {
    Q_OBJECT

public:
    explicit ViewArea(ViewContext context, QWidget* parent = nullptr);

    /// Takes a picture that a view shows.
    void showPicture(CQuarnView& view, const ShownPicture& picture);

    /// The widget of a view; null when there is none of this name.
    ViewWidget* widget(const QString& view_name) const;
    QList<ViewWidget*> widgets() const { return m_widgets; }
    ViewDrawing& drawing() { return m_drawing; }
    ViewGrid& grid() { return *m_grid; }

    /// Fills a menu with the sizes that the frame of the active view can have.
    void fillFrameSizes(QMenu& menu);
    /// The size of the active view's frame, in pixels: that of recorded pictures.
    QSize activeFrameSize() const;

signals:
    /// The active view is another one, or its frame has another size.
    void frameChanged();

public slots:
    /// A command begins: notes which pictures it shows.
    void commandStarted();
    /// A command has ended: shows the views that there are now, and draws those whose picture the
    /// command did not show itself.
    void commandEnded();
    /// Gives one view all the room, or, where it has it, shows all of them.
    void toggleMaximized(const QString& view_name);
    /// As toggleMaximized, for the view that is worked in.
    void toggleActiveMaximized();

private:
    void refresh();
    void rebuild(const QStringList& names);
    ViewWidget& addWidget(const QString& name);
    void noteFrameSizes();
    void fitFrames();
    void showActive();
    void showHint();

    ViewContext m_context;
    ViewDrawing m_drawing;
    ViewGrid* m_grid;
    QList<ViewWidget*> m_widgets; ///< in the order of the document's views
    unsigned m_document_number = 0;
    QMap<QString, QSize> m_given_sizes; ///< of frames, by the name of the view
    QStringList m_shown_by_command;
};

} // namespace quarn::desktop
