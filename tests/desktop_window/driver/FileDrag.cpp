#include "tests/desktop_window/driver/FileDrag.h"

#include <algorithm>
#include <array>
#include <chrono>
#include <cstdlib>
#include <memory>
#include <optional>
#include <stdexcept>
#include <thread>
#include <xcb/xcb.h>

namespace quarn::test {

namespace {

using Clock = std::chrono::steady_clock;
constexpr std::chrono::seconds LONGEST_WAIT{30};
constexpr std::uint32_t PROTOCOL_VERSION = 5;

/// The program that the file comes from: a window that nobody sees, and the selection it owns.
class DragSource {
public:
    DragSource(const std::string& display, const std::filesystem::path& file)
        : m_connection(xcb_connect(display.c_str(), nullptr)),
          m_list("file://" + file.string() + "\r\n") {
        if (xcb_connection_has_error(m_connection))
            throw std::runtime_error("no connection to display " + display);
        const xcb_screen_t* const screen =
            xcb_setup_roots_iterator(xcb_get_setup(m_connection)).data;
        m_window = xcb_generate_id(m_connection);
        xcb_create_window(m_connection, XCB_COPY_FROM_PARENT, m_window, screen->root, 0, 0, 1, 1, 0,
                          XCB_WINDOW_CLASS_INPUT_OUTPUT, screen->root_visual, 0, nullptr);
        xcb_set_selection_owner(m_connection, m_window, atom("XdndSelection"), XCB_CURRENT_TIME);
    }
    ~DragSource() { xcb_disconnect(m_connection); }
    DragSource(const DragSource&) = delete;
    DragSource& operator=(const DragSource&) = delete;

    bool dropOn(unsigned window, QPoint at) {
        const std::uint32_t uris = atom("text/uri-list");
        const std::uint32_t place =
            static_cast<std::uint32_t>(at.x()) << 16 | static_cast<std::uint32_t>(at.y());
        send(window, "XdndEnter", {m_window, PROTOCOL_VERSION << 24, uris, 0, 0});
        send(window, "XdndPosition",
             {m_window, 0, place, XCB_CURRENT_TIME, atom("XdndActionCopy")});
        const std::optional<bool> is_wanted = waitFor("XdndStatus");
        if (!is_wanted.value_or(false)) {
            send(window, "XdndLeave", {m_window, 0, 0, 0, 0});
            return false;
        }
        send(window, "XdndDrop", {m_window, 0, XCB_CURRENT_TIME, 0, 0});
        return waitFor("XdndFinished").value_or(false);
    }

private:
    std::uint32_t atom(const std::string& name) const {
        const std::unique_ptr<xcb_intern_atom_reply_t, decltype(&std::free)> reply(
            xcb_intern_atom_reply(m_connection,
                                  xcb_intern_atom(m_connection, 0,
                                                  static_cast<std::uint16_t>(name.size()),
                                                  name.c_str()),
                                  nullptr),
            &std::free);
        return reply ? reply->atom : 0;
    }

    void send(unsigned window, const char* type, const std::array<std::uint32_t, 5>& words) {
        xcb_client_message_event_t message = {};
        message.response_type = XCB_CLIENT_MESSAGE;
        message.format = 32;
        message.window = window;
        message.type = atom(type);
        std::ranges::copy(words, message.data.data32);
        xcb_send_event(m_connection, 0, window, 0, reinterpret_cast<const char*>(&message));
        xcb_flush(m_connection);
    }

    /// Hands the file's name to whoever asks, until a message of this type comes.
    /// @return its first flag; nothing when none comes
    std::optional<bool> waitFor(const char* type) {
        const std::uint32_t wanted = atom(type);
        for (const auto deadline = Clock::now() + LONGEST_WAIT; Clock::now() < deadline;
             std::this_thread::sleep_for(std::chrono::milliseconds(2))) {
            const std::unique_ptr<xcb_generic_event_t, decltype(&std::free)> event(
                xcb_poll_for_event(m_connection), &std::free);
            if (!event)
                continue;
            const int kind = event->response_type & 0x7f;
            if (kind == XCB_SELECTION_REQUEST)
                answer(*reinterpret_cast<xcb_selection_request_event_t*>(event.get()));
            const auto* message = reinterpret_cast<xcb_client_message_event_t*>(event.get());
            if (kind == XCB_CLIENT_MESSAGE && message->type == wanted)
                return (message->data.data32[1] & 1) != 0;
        }
        return std::nullopt;
    }

    void answer(const xcb_selection_request_event_t& request) {
        xcb_change_property(m_connection, XCB_PROP_MODE_REPLACE, request.requestor,
                            request.property, request.target, 8,
                            static_cast<std::uint32_t>(m_list.size()), m_list.data());
        xcb_selection_notify_event_t told = {};
        told.response_type = XCB_SELECTION_NOTIFY;
        told.time = request.time;
        told.requestor = request.requestor;
        told.selection = request.selection;
        told.target = request.target;
        told.property = request.property;
        xcb_send_event(m_connection, 0, request.requestor, 0, reinterpret_cast<const char*>(&told));
        xcb_flush(m_connection);
    }

    xcb_connection_t* m_connection;
    xcb_window_t m_window = 0;
    std::string m_list;
};

} // namespace

bool dropFile(const std::string& display, unsigned window, QPoint at,
              const std::filesystem::path& file) {
    return DragSource(display, file).dropOn(window, at);
}

} // namespace quarn::test
