#include "tests/desktop_window/driver/Display.h"

#include <poll.h>
#include <stdexcept>
#include <thread>
#include <unistd.h>
#include <xcb/xcb.h>
#include <xcb/xtest.h>

namespace quarn::test {

namespace {

constexpr int SERVER_START_MS = 30'000;
/// A hand is not faster; and a program that is asked twice in a millisecond proves nothing.
constexpr std::chrono::milliseconds HAND{12};

template <class Reply> using Owned = std::unique_ptr<Reply, decltype(&std::free)>;

template <class Reply> Owned<Reply> owned(Reply* reply) {
    if (!reply)
        throw std::runtime_error("the display does not answer");
    return {reply, &std::free};
}

/// Reads the number of the display that the server tells, and a line break.
std::string readNumber(int pipe) {
    std::string number;
    pollfd ready = {pipe, POLLIN, 0};
    for (char sign = 0; poll(&ready, 1, SERVER_START_MS) == 1 && read(pipe, &sign, 1) == 1;) {
        if (sign == '\n')
            return number;
        number += sign;
    }
    throw std::runtime_error("Xvfb does not start");
}

} // namespace

Display::Display(QSize size_px) {
    int ends[2];
    if (pipe(ends) != 0)
        throw std::runtime_error("no pipe to the display server");
    Start start;
    start.program = QUARN_XVFB;
    // Ends with its last client, also when the test is killed.
    start.arguments = {"-displayfd",
                       std::to_string(ends[1]),
                       "-screen",
                       "0",
                       std::to_string(size_px.width()) + 'x' + std::to_string(size_px.height()) +
                           "x24",
                       "-nolisten",
                       "tcp",
                       "-noreset",
                       "-terminate"};
    m_server = std::make_unique<RunningProgram>(start);
    close(ends[1]);
    m_name = ':' + readNumber(ends[0]);
    close(ends[0]);
    m_connection = xcb_connect(m_name.c_str(), nullptr);
    if (xcb_connection_has_error(m_connection))
        throw std::runtime_error("no connection to display " + m_name);
    m_screen = xcb_setup_roots_iterator(xcb_get_setup(m_connection)).data;
}

Display::~Display() {
    xcb_disconnect(m_connection);
}

void Display::pause() const {
    xcb_flush(m_connection);
    std::this_thread::sleep_for(HAND);
}

void Display::fake(int kind, int detail, QPoint at) {
    xcb_test_fake_input(m_connection, static_cast<std::uint8_t>(kind),
                        static_cast<std::uint8_t>(detail), XCB_CURRENT_TIME, m_screen->root,
                        static_cast<std::int16_t>(at.x()), static_cast<std::int16_t>(at.y()), 0);
    pause();
}

void Display::moveMouse(QPoint to) {
    fake(XCB_MOTION_NOTIFY, 0, to);
}

void Display::press(int button) {
    fake(XCB_BUTTON_PRESS, button);
}

void Display::release(int button) {
    fake(XCB_BUTTON_RELEASE, button);
}

void Display::click(QPoint at, int button) {
    moveMouse(at);
    press(button);
    release(button);
}

void Display::doubleClick(QPoint at) {
    click(at);
    click(at);
}

void Display::drag(QPoint from, QPoint to, int button) {
    constexpr int STEPS = 12;
    moveMouse(from);
    press(button);
    for (int step = 1; step <= STEPS; ++step)
        moveMouse(from + (to - from) * step / STEPS);
    release(button);
}

void Display::turnWheel(QPoint at, int notches) {
    const int button = notches > 0 ? 4 : 5;
    moveMouse(at);
    for (int left = std::abs(notches); left > 0; --left) {
        press(button);
        release(button);
    }
}

void Display::tapKey(unsigned symbol) {
    const xcb_setup_t* const setup = xcb_get_setup(m_connection);
    const int first = setup->min_keycode;
    const int count = setup->max_keycode - first + 1;
    const auto map = owned(
        xcb_get_keyboard_mapping_reply(m_connection,
                                       xcb_get_keyboard_mapping(m_connection, setup->min_keycode,
                                                                static_cast<std::uint8_t>(count)),
                                       nullptr));
    const xcb_keysym_t* const symbols = xcb_get_keyboard_mapping_keysyms(map.get());
    for (int key = 0; key < count; ++key)
        if (symbols[key * map->keysyms_per_keycode] == symbol) {
            fake(XCB_KEY_PRESS, first + key);
            fake(XCB_KEY_RELEASE, first + key);
            return;
        }
    throw std::runtime_error("the keyboard has no such key");
}

unsigned Display::atom(const std::string& name) const {
    return owned(xcb_intern_atom_reply(m_connection,
                                       xcb_intern_atom(m_connection, 0,
                                                       static_cast<std::uint16_t>(name.size()),
                                                       name.c_str()),
                                       nullptr))
        ->atom;
}

void Display::askToClose(unsigned window) {
    xcb_client_message_event_t message = {};
    message.response_type = XCB_CLIENT_MESSAGE;
    message.format = 32;
    message.window = window;
    message.type = atom("WM_PROTOCOLS");
    message.data.data32[0] = atom("WM_DELETE_WINDOW");
    xcb_send_event(m_connection, 0, window, 0, reinterpret_cast<const char*>(&message));
    pause();
}

void Display::resize(unsigned window, QSize size_px) {
    const std::uint32_t values[] = {0, 0, static_cast<std::uint32_t>(size_px.width()),
                                    static_cast<std::uint32_t>(size_px.height())};
    xcb_configure_window(m_connection, window,
                         XCB_CONFIG_WINDOW_X | XCB_CONFIG_WINDOW_Y | XCB_CONFIG_WINDOW_WIDTH |
                             XCB_CONFIG_WINDOW_HEIGHT,
                         values);
    pause();
}

void Display::giveKeyboard(unsigned window) {
    xcb_set_input_focus(m_connection, XCB_INPUT_FOCUS_PARENT, window, XCB_CURRENT_TIME);
    pause();
}

QImage Display::picture() const {
    const QSize size(m_screen->width_in_pixels, m_screen->height_in_pixels);
    const auto reply = owned(xcb_get_image_reply(
        m_connection,
        xcb_get_image(m_connection, XCB_IMAGE_FORMAT_Z_PIXMAP, m_screen->root, 0, 0,
                      m_screen->width_in_pixels, m_screen->height_in_pixels, ~0U),
        nullptr));
    return QImage(xcb_get_image_data(reply.get()), size.width(), size.height(),
                  QImage::Format_RGB32)
        .copy();
}

} // namespace quarn::test
