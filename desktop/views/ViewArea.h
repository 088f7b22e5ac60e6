#pragma once

#include "desktop/views/RecordedSize.h"
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

    /// The size that recorded pictures will have, in pixels: the one that the view's frame was
    /// given by a command, else the chosen one.
    QSize recordedSize() const;
    /// Fills a menu with the sizes that recorded pictures can have.
    void fillRecordedSizes(QMenu& menu);

signals:
    /// recordedSize may be another one.
    void frameChanged();

public slots:
    /// A command begins: notes which pictures it shows, and gives the view of a recording the size
    /// of its pictures.
    void commandStarted(const QString& line);
    /// A command has ended: shows the views that there are now, and draws those whose picture the
    /// command did not show itself, or whose camera or display mode it changed after that.
    void commandEnded();
    /// Gives one view all the room, or, where it has it, shows all of them.
    void toggleMaximized(const QString& view_name);
    /// As toggleMaximized, for the view that is worked in.
    void toggleActiveMaximized();

private:
    void refresh();
    void rebuild(const QStringList& names);
    ViewWidget& addWidget(const QString& name);
    ViewWidget* recordedWidget() const;
    void chooseRecordedSize(std::optional<QSize> size_px);
    void sizeForRecording();
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
    /// What a picture of a view shows it with.
    struct Look {
        KM_Viewport camera;
        KM_UUID display_mode;
        friend bool operator==(const Look&, const Look&) = default;
    };
    static Look lookOf(const CQuarnView& view);
    QMap<QString, Look> m_shown_by_command; ///< last, by the name of the view
    RecordedSize m_recorded_size;
};

} // namespace quarn::desktop
