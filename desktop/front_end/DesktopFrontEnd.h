#pragma once

#include "desktop/front_end/EscapeKey.h"
#include "host/front_end/FrontEnd.h"

#include <QElapsedTimer>
#include <QPointer>
#include <QWidget>

#include <functional>
#include <string>

namespace quarn::desktop {

/// What the window's parts do for the front end. A part that is not there is an empty function:
/// then nothing is shown, and nobody answers or chooses. Widgets are the owner of what is opened;
/// null where there is no window yet.
struct FrontEndParts {
    std::function<void(std::wstring_view text)> print;
    std::function<Answer(const Question& question)> ask;
    std::function<int(QWidget* owner, std::wstring_view text, std::wstring_view title,
                      unsigned flags)>
        show_message;
    std::function<std::optional<std::filesystem::path>(QWidget* owner, std::wstring_view title,
                                                       std::wstring_view message,
                                                       const std::filesystem::path& start)>
        choose_folder;
    std::function<FileChoice(QWidget* owner, const FileQuestion& question)> choose_file;
    std::function<std::optional<Place>(QWidget* owner, std::wstring_view title, const Place& start)>
        choose_place;
    std::function<std::optional<ModelUp>(QWidget* owner, const UpAxisQuestion& question)>
        choose_up_axis;
    std::function<std::unique_ptr<DialogWindow>(const DialogTemplate& form, QWidget* owner)>
        make_dialog;
    std::function<void(const std::filesystem::path& file, int written, int total)> frame_written;
    std::function<void(const RecordingReport& report)> recording_ended;
    std::function<void(const std::filesystem::path& file, double share)> shared_file_progress;
    /// Without it the front end prints what the report says.
    std::function<void(const SharedFileReport& report)> shared_file_ended;
    std::function<void(double share)> picture_rendered;
    std::function<void(ModelStep step, double share)> model_read;
    std::function<void(CQuarnView& view, const ShownPicture& picture)> view_shown;
    std::function<void(const ShownPicture& picture)> render_window_shown;
};

/// The front end of the window: passes on to its parts, and lets them work on their events while
/// the host waits. Needs the application object; must outlive the session.
///
/// An `HWND` of this front end is a `QWidget*`, cast as it is: the main window, or the window of a
/// dialog.
class DesktopFrontEnd final : public FrontEnd {
public:
    /// From now on these parts are used; what was printed before is shown by them.
    void setParts(FrontEndParts parts);
    void setMainWindow(QWidget* window) { m_main_window = window; }

    /// Told by whoever starts commands, for the outermost one.
    void commandStarts();
    void commandEnded();
    /// Asks the running command to end; holds until it has ended.
    void requestStop() { m_is_stop_requested = true; }

    void print(std::wstring_view text) override;
    Answer ask(const Question& question) override;
    int showMessage(std::wstring_view text, std::wstring_view title, unsigned flags) override;
    std::optional<std::filesystem::path>
    chooseFolder(std::wstring_view title, std::wstring_view message,
                 const std::filesystem::path& start_folder) override;
    FileChoice chooseFile(const FileQuestion& question) override;
    std::optional<ModelUp> chooseUpAxis(const UpAxisQuestion& question) override;
    std::optional<Place> chooseLocation(std::wstring_view title, const Place& start) override;
    std::unique_ptr<DialogWindow> makeDialog(const DialogTemplate& form, HWND owner) override;
    void pumpEvents(unsigned milliseconds) override;
    bool isKeyDown(int virtual_key) override;
    bool isInterrupted() const override;
    HWND mainWindow() override;
    void frameWritten(const std::filesystem::path& file, int written, int total) override;
    void recordingEnded(const RecordingReport& report) override;
    void sharedFileProgress(const std::filesystem::path& file, double share) override;
    void sharedFileEnded(const SharedFileReport& report) override;
    void pictureRendered(double share) override;
    void modelRead(const std::filesystem::path& file, ModelStep step, double share) override;
    void viewShown(CQuarnView& view, const ShownPicture& picture) override;
    void renderWindowShown(const ShownPicture& picture) override;

private:
    void breatheWhenDue();

    FrontEndParts m_parts;
    EscapeKey m_escape;
    QPointer<QWidget> m_main_window;
    std::wstring m_early_text; ///< printed before there was anything to show it
    QElapsedTimer m_since_breath;
    bool m_is_stop_requested = false;
};

} // namespace quarn::desktop
