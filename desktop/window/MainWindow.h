#pragma once

#include "desktop/front_end/DesktopFrontEnd.h"
#include "host/session/Session.h"

#include <QMainWindow>

class QDockWidget;

namespace quarn {
struct RecoveryOptions;
}

namespace quarn::desktop {

class AnimationBar;
class CommandMenus;
class CommandPane;
class CommandStarter;
class FileDrop;
class ProgramEnd;
class RecentFiles;
class RecoveryBeat;
class RecoveryOffer;
class RenderPictureWindow;
class SessionEnd;
class UnsavedChanges;
class SunActions;
class UpAxisAsking;
class ViewArea;
class WindowClosing;

/// The window of the program: menus, the views of the document, the animation below them, and the
/// command line. It puts the parts together and knows nothing that they know.
class MainWindow final : public QMainWindow {
    Q_OBJECT

public:
    /// Becomes the window of the front end. Both must outlive this.
    MainWindow(Session& session, DesktopFrontEnd& front_end);
    ~MainWindow() override;

    CommandStarter& starter() { return *m_starter; }
    CommandPane& commandPane() { return *m_pane; }
    ViewArea& views() { return *m_views; }
    AnimationBar& animationBar() { return *m_animation; }
    CommandMenus& menus() { return *m_menus; }
    ProgramEnd& programEnd() { return *m_end; }

    /// Runs the command lines of a script file, as a program without a person does, while the
    /// window shows what happens.
    /// @param wants_exit  ends the program afterwards, without a question: with 0 where every
    ///                    command succeeded, else with 1
    void runScript(const QString& file, bool wants_exit);
    /// From now on unsaved work is kept for recovery, and that of earlier runs can be had back.
    void keepUnsavedWork(const RecoveryOptions& options);
    /// What can be recovered; null before keepUnsavedWork.
    RecoveryOffer* recoveryOffer() { return m_recovery_offer; }
    /// Tells the person something that must not be missed: in the status bar and the output.
    void tellAndPrint(const QString& message);
    /// After the event loop: size and place are remembered, and unsaved work is kept for the next
    /// start or not wanted any more.
    void finish();
    /// Size, place and borders of the last run (QSettings); a good size where there was none.
    void restoreLayout();

protected:
    void closeEvent(QCloseEvent* event) override;

private:
    void layOut();
    void buildMenus();
    void connectParts();
    FrontEndParts parts();
    void commandEnded();
    void showRenderedPicture(const ShownPicture& picture);
    void showRenderProgress(double share);
    RenderPictureWindow& renderWindow();
    void showTitle();
    void saveLayout();
    void noteRecording(const RecordingReport& report);
    void noteSharedFile(const SharedFileReport& report);
    void settleUnsavedWork();
    void tell(const QString& message);

    Session& m_session;
    DesktopFrontEnd& m_front_end;
    CommandStarter* m_starter;
    CommandPane* m_pane;
    ViewArea* m_views;
    AnimationBar* m_animation;
    CommandMenus* m_menus;
    RecentFiles* m_recent_files;
    UnsavedChanges* m_changes;
    WindowClosing* m_closing;
    FileDrop* m_file_drop;
    ProgramEnd* m_end;
    SessionEnd* m_session_end;
    UpAxisAsking* m_up_axis;
    SunActions* m_sun;
    RecoveryBeat* m_recovery = nullptr;
    RecoveryOffer* m_recovery_offer = nullptr;
    RenderPictureWindow* m_render_window = nullptr;
    QDockWidget* m_command_dock = nullptr;
    bool m_lacks_files = false; ///< a recording, or what is made of one, since the script began
};

} // namespace quarn::desktop
