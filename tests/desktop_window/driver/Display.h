#pragma once

#include "tests/quarn/ProgramRun.h"

#include <QImage>
#include <QPoint>
#include <QSize>

#include <chrono>
#include <memory>
#include <string>

struct xcb_connection_t;
struct xcb_screen_t;

namespace quarn::test {

/// A display of its own without a window manager, and the hand that moves its mouse and presses its
/// keys. Everything goes through the display server, as from a real mouse.
class Display {
public:
    explicit Display(QSize size_px = {1600, 1000});
    ~Display();
    Display(const Display&) = delete;
    Display& operator=(const Display&) = delete;

    /// For the environment variable DISPLAY.
    const std::string& name() const { return m_name; }

    void moveMouse(QPoint to);
    void press(int button);
    void release(int button);
    /// Moves there and clicks with the left button, or another one.
    void click(QPoint at, int button = 1);
    void doubleClick(QPoint at);
    void drag(QPoint from, QPoint to, int button = 1);
    /// Turns the wheel there: up for more than 0 notches.
    void turnWheel(QPoint at, int notches);
    /// Presses a key and lets it go.
    /// @param symbol  its number in the X protocol, as 0xff1b for Escape
    void tapKey(unsigned symbol);

    /// Asks a window to close, as the button in the frame of a window manager does.
    void askToClose(unsigned window);
    /// Gives a window another size, as dragging its frame does.
    void resize(unsigned window, QSize size_px);
    /// Gives a window the keyboard, as a window manager does when it comes in front.
    void giveKeyboard(unsigned window);

    /// What the whole screen shows now.
    QImage picture() const;

private:
    void fake(int kind, int detail, QPoint at = {});
    unsigned atom(const std::string& name) const;
    void pause() const;

    std::string m_name;
    std::unique_ptr<RunningProgram> m_server;
    xcb_connection_t* m_connection = nullptr;
    xcb_screen_t* m_screen = nullptr;
};

} // namespace quarn::test
