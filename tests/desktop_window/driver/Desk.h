#pragma once

#include "tests/desktop_window/driver/Display.h"
#include "tests/desktop_window/driver/Windows.h"
#include "tests/support/TempFolder.h"

#include <functional>
#include <optional>

namespace quarn::test {

/// How the program is started at a desk.
struct DeskStart {
    QSize screen_px = {1600, 1000};
    QStringList arguments = {};
    unsigned long largest_file = 0;   ///< bytes that a file may have; 0: no limit
    std::string session_manager = {}; ///< as DesktopSession::address
};

/// A person at a desk: the program `quarn-desktop` in a real window, a home folder that nothing
/// else uses, and mouse and keys. Every wait ends with an exception when the program has ended or
/// does not answer; its message tells what was to be seen then.
class Desk {
public:
    /// Starts nothing yet: files can be put into the home folder before.
    Desk();
    ~Desk();
    Desk(const Desk&) = delete;
    Desk& operator=(const Desk&) = delete;

    const std::filesystem::path& home() const { return m_home; }
    std::filesystem::path documents() const { return home() / "Documents"; }
    Display& display() { return *m_display; }

    /// Starts the program and waits until its window is there and idle.
    void start(const DeskStart& start = {});
    /// Starts the program, which may ask something at once.
    void begin(const DeskStart& start);
    /// Sends the program a signal.
    void sendSignal(int signal) { m_program->sendSignal(signal); }
    /// Waits until the program has ended by itself.
    Ended waitForEnd();

    /// What can be seen now.
    Windows look();
    using Condition = std::function<bool(const Windows&)>;
    /// Looks until the condition holds.
    /// @param what  for the message when it never does
    Windows lookUntil(const std::string& what, const Condition& condition);
    /// Looks until a widget is there, and enabled.
    SeenWidget widget(const QString& name);
    /// Looks until a widget shows that text.
    void waitForText(const QString& name, const QString& text);
    /// Looks until there is no such widget.
    void waitUntilGone(const QString& name);
    /// Looks until no command runs and no modal window is open.
    Windows waitUntilIdle();

    void click(const QString& name);
    /// Clicks a button by what stands on it.
    void clickButton(const QString& text);
    /// Clicks an entry of a list or menu, an arrow or a knob of a widget.
    void clickItem(const QString& widget, const QString& item);
    /// Opens a combo box and clicks an entry.
    void choose(const QString& combo_box, const QString& entry);
    /// Clicks the arrow of a number until the number is there.
    void stepTo(const QString& number, int value);
    /// Opens a menu of the menu bar and clicks an entry in it.
    /// @param action  its name, as `command_Open`
    void chooseInMenu(const QString& action);
    /// Presses Escape in the window that is in front.
    void escape();
    /// The button in the frame of a window.
    void closeWindow(const QString& window_name);

    /// Gives up whatever is asked, in dialogs, choosers and questions, until the program is idle.
    void giveUp(const std::function<void(const Windows&)>& how);
    /// A click on Cancel, wherever it stands; Escape where it stands nowhere.
    void cancel(const Windows& seen);

    /// The screen, once it shows the same for a moment.
    QImage stillPicture();
    /// How a file opener in the PATH was called: the arguments, one a line.
    std::string openedFiles() const { return readFile(home() / "opened"); }

private:
    class Probe;
    void fail(const std::string& what);

    TempFolder m_folder;
    std::filesystem::path m_home;
    std::unique_ptr<Display> m_display;
    std::unique_ptr<Probe> m_probe;
    std::unique_ptr<RunningProgram> m_program;
    std::optional<Windows> m_last_seen;
};

} // namespace quarn::test
