#pragma once

#include "desktop/animation/AnimationSummary.h"
#include "desktop/animation/MediaIcons.h"
#include "host/front_end/FrontEnd.h"

#include <QHBoxLayout>
#include <QLabel>
#include <QSlider>
#include <QSpinBox>
#include <QToolButton>
#include <QWidget>

class CQuarnView;

namespace quarn {
class Session;
}

namespace quarn::desktop {

class CommandStarter;
class ProgressRow;
class SharedFileRow;

/// Plays, steps through and records the animation of the document, all by the plug-in's commands.
/// Frames count from 0, as in the commands and in the names of recorded files.
class AnimationBar final : public QWidget {
    Q_OBJECT
public:
    /// Both must outlive this.
    AnimationBar(Session& session, CommandStarter& starter, QWidget* parent = nullptr);

    /// Adds a control of the window's own before the Record button, such as the size of frames.
    void addControl(QWidget* control);
    /// Opens the page of the last recording; for a menu, too.
    QAction& openPageAction() { return *m_open_page; }
    /// Whether the command that runs or has just ended was a move of the slider: it is not worth a
    /// line in the output.
    bool isStepping() const { return m_is_stepping; }

public slots:
    /// Looks at the document's animation again: after every command, and when documents change. A
    /// command's end needs no call.
    void refresh();
    /// Records the animation, after a folder was chosen.
    void record();
    void frameWritten(const std::filesystem::path& file, int written, int total);
    void pictureRendered(double share);
    void modelRead(ModelStep step, double share);
    void sharedFileProgress(const std::filesystem::path& file, double share);
    void sharedFileEnded(const SharedFileReport& report);
    /// A view shows another picture: while the animation plays, its next frame.
    void viewShown(const CQuarnView& view);

private:
    void buildControls();
    QToolButton* addButton(const char* name, const QString& tip, MediaSign sign,
                           const QString& line = {});
    void connectControls();
    void commandStarted(const QString& line);
    void commandEnded();
    void playOrStop();
    void wantFrame(int frame);
    void showWantedFrame();
    void showFrameNumber(int frame);
    void showState();
    void paintIcons();
    bool isPlaying() const;
    bool isCommandStarted() const;

    void changeEvent(QEvent* event) override;

    Session& m_session;
    CommandStarter& m_starter;
    AnimationSummary m_animation;
    struct Sign {
        QToolButton* button;
        MediaSign sign;
    };
    QList<Sign> m_signs;
    QHBoxLayout* m_row;
    QToolButton* m_play = nullptr;
    QToolButton* m_record = nullptr;
    QSlider* m_slider = nullptr;
    QSpinBox* m_number = nullptr;
    QLabel* m_date = nullptr;
    QAction* m_open_page = nullptr;
    QToolButton* m_page_button = nullptr;
    ProgressRow* m_progress;
    SharedFileRow* m_shared_file;
    std::optional<QString> m_page_line; ///< opens the page of the last recording
    std::optional<int> m_wanted_frame;  ///< the newest that was asked for and is not shown yet
    int m_pictures_shown = 0;           ///< while playing
    bool m_is_stepping = false;
};

} // namespace quarn::desktop
