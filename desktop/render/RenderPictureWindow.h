#pragma once

#include "host/front_end/FrontEndChoices.h"

#include <QElapsedTimer>
#include <QTimer>
#include <QWidget>

class QAction;
class QLabel;
class QProgressBar;
class QScrollArea;
class QToolBar;

namespace quarn::desktop {

class PictureSheet;

/// The window with the picture that the renderer made. It shows itself when it gets one.
///
/// Its actions are called `fit`, `whole` (100 %), `save` and `stop`; its picture `picture`, its
/// progress bar `progress`.
class RenderPictureWindow final : public QWidget {
    Q_OBJECT

public:
    /// @param main_window  it stands before this one, and goes with it; may be null
    explicit RenderPictureWindow(QWidget* main_window);

    /// Shows a picture, which is copied. One of no size closes the window without a signal, unless
    /// another follows at once, as in a recording of rendered pictures.
    void showPicture(const ShownPicture& picture);
    /// Shows how much of a picture is done, from 0 to 1; while it is less than 1 the window offers
    /// to stop, and neither saves nor reports that it is closed: closing it stops then. Without a
    /// picture the window shows itself once rendering takes a while.
    void showProgress(double share);

    /// Shows all of the picture, or each of its pixels as one of the screen's.
    void setFitting(bool is_fitting);
    /// How many pixels of the screen one of the picture takes.
    double scale() const;

signals:
    /// The person wants the picture in a file.
    void saveRequested();
    /// The person wants no more of the picture that is being rendered.
    void stopRequested();
    /// The person closed the window; the picture is not needed any more.
    void closedByPerson();

protected:
    void closeEvent(QCloseEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;

private:
    QToolBar* makeTools();
    QAction* addTool(QToolBar& tools, const char* name, const QString& text, const QString& hint);
    QWidget* makeFoot();
    void fit();
    void growToPicture();
    void showWhenItTakesLong();
    void showNumbers();
    bool isRendering() const { return m_is_rendering; }

    PictureSheet* m_sheet = nullptr;
    QScrollArea* m_area = nullptr;
    QAction* m_fit = nullptr;
    QAction* m_whole = nullptr;
    QAction* m_save = nullptr;
    QAction* m_stop = nullptr;
    QProgressBar* m_progress = nullptr;
    QLabel* m_numbers = nullptr;
    bool m_is_rendering = false;
    QElapsedTimer m_since_start; ///< of the rendering that runs
    QTimer m_farewell;           ///< hides the window unless a picture comes before
};

} // namespace quarn::desktop
