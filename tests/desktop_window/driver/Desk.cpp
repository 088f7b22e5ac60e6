#include "tests/desktop_window/driver/Desk.h"

#include <chrono>
#include <cstdlib>
#include <gtest/gtest.h>
#include <poll.h>
#include <stdexcept>
#include <sys/socket.h>
#include <thread>
#include <unistd.h>

namespace quarn::test {

namespace {

using Clock = std::chrono::steady_clock;

/// On a machine that is busy with other things, too.
constexpr std::chrono::seconds LONGEST_WAIT{60};
constexpr std::chrono::milliseconds BETWEEN_LOOKS{20};
constexpr std::chrono::milliseconds STILL{250};
constexpr std::chrono::milliseconds DOUBLE_CLICK{450};
constexpr unsigned ESCAPE = 0xff1b;

void writeProgram(const std::filesystem::path& file, const std::string& script) {
    writeFile(file, script);
    std::filesystem::permissions(file, std::filesystem::perms::owner_all);
}

std::map<std::string, std::string> environmentIn(const std::filesystem::path& home) {
    const char* const path = std::getenv("PATH");
    return {
        {"HOME", home},
        {"XDG_CONFIG_HOME", home / ".config"},
        {"XDG_DATA_HOME", home / ".local"},
        {"XDG_STATE_HOME", home / ".state"},
        {"XDG_CACHE_HOME", home / ".cache"},
        {"XDG_RUNTIME_DIR", home / ".run"},
        {"XDG_CURRENT_DESKTOP", ""},
        {"QT_QPA_PLATFORM", "xcb"},
        {"QT_QPA_PLATFORMTHEME", ""},
        {"QT_STYLE_OVERRIDE", "Fusion"},
        {"QT_SCALE_FACTOR", "1"},
        {"QT_QPA_GENERIC_PLUGINS", "windowprobe"},
        {"QT_PLUGIN_PATH", QUARN_PROBE_FOLDER},
        {"LC_ALL", "C.UTF-8"},
        {"QUARN_STRICT", "1"},
        {"DBUS_SESSION_BUS_ADDRESS", "unix:path=" + (home / "nobody").string()},
        {"PATH", (home / "bin").string() + ':' + (path ? path : "/usr/bin:/bin")},
    };
}

} // namespace

/// The connection to the probe in the program.
class Desk::Probe {
public:
    Probe() {
        if (socketpair(AF_UNIX, SOCK_STREAM, 0, m_ends) != 0)
            throw std::runtime_error("no connection to the probe");
    }
    ~Probe() {
        close(m_ends[0]);
        closeOther();
    }
    Probe(const Probe&) = delete;
    Probe& operator=(const Probe&) = delete;

    int other() const { return m_ends[1]; }
    void closeOther() {
        if (m_ends[1] >= 0)
            close(m_ends[1]);
        m_ends[1] = -1;
    }

    /// @return nothing when the program is gone, or does not answer in time
    std::optional<QByteArray> ask() {
        if (send(m_ends[0], "?", 1, MSG_NOSIGNAL) != 1)
            return std::nullopt;
        QByteArray told;
        pollfd ready = {m_ends[0], POLLIN, 0};
        const int longest_ms = static_cast<int>(std::chrono::milliseconds(LONGEST_WAIT).count());
        while (poll(&ready, 1, longest_ms) == 1) {
            char bytes[65536];
            const ssize_t count = read(m_ends[0], bytes, sizeof bytes);
            if (count <= 0)
                return std::nullopt;
            told.append(bytes, count);
            if (told.endsWith('\n'))
                return told;
        }
        return std::nullopt;
    }

private:
    int m_ends[2] = {-1, -1};
};

Desk::Desk() : m_home(m_folder / "home/architect") {
    for (const char* const folder : {"Documents", "bin", ".run"})
        std::filesystem::create_directories(home() / folder);
    std::filesystem::permissions(home() / ".run", std::filesystem::perms::owner_all);
    std::filesystem::create_directories(home() / ".config/Quarn");
    writeFile(
        home() / ".config/Quarn/quarn-desktop.conf",
        "[files]\nasks_which_way_is_up=false\n"); // the models of these tests stand as they are
    writeProgram(home() / "bin" / "xdg-open",
                 "#!/bin/sh\nprintf '%s\\n' \"$@\" >>'" + (home() / "opened").string() + "'\n");
}

/// The program before its display.
Desk::~Desk() {
    m_program.reset();
    m_probe.reset();
    m_display.reset();
}

void Desk::start(const DeskStart& start) {
    begin(start);
    waitUntilIdle();
}

void Desk::begin(const DeskStart& start) {
    m_program.reset();
    m_probe = std::make_unique<Probe>();
    if (!m_display)
        m_display = std::make_unique<Display>(start.screen_px);
    Start program;
    program.program = QUARN_DESKTOP_PROGRAM;
    program.folder = home();
    program.environment = environmentIn(home());
    program.environment["DISPLAY"] = m_display->name();
    program.environment["QUARN_PROBE_SOCKET"] = std::to_string(m_probe->other());
    program.environment["SESSION_MANAGER"] = start.session_manager;
    program.largest_file = start.largest_file;
    for (const QString& argument : start.arguments)
        program.arguments.push_back(argument.toStdString());
    m_program = std::make_unique<RunningProgram>(program);
    m_probe->closeOther();
    const SeenWidget window = widget("mainWindow");
    m_display->giveKeyboard(window.window_id);
}

Ended Desk::waitForEnd() {
    m_last_seen.reset();
    return m_program->wait();
}

void Desk::fail(const std::string& what) {
    const auto* const test = testing::UnitTest::GetInstance()->current_test_info();
    if (test && m_display)
        m_display->picture().save(QString("failed-%1.png").arg(test->name()));
    const QString seen = m_last_seen ? m_last_seen->description() : QString("nothing");
    throw std::runtime_error(what + "; seen was:\n" + seen.toStdString());
}

Windows Desk::look() {
    const std::optional<QByteArray> told = m_probe->ask();
    if (!told)
        fail("the program has ended or does not answer: " + m_program->wait().err);
    m_last_seen = readWindows(*told);
    return *m_last_seen;
}

Windows Desk::lookUntil(const std::string& what, const Condition& condition) {
    const Clock::time_point deadline = Clock::now() + LONGEST_WAIT;
    for (;;) {
        Windows windows = look();
        if (condition(windows))
            return windows;
        if (Clock::now() > deadline)
            fail("never seen: " + what);
        std::this_thread::sleep_for(BETWEEN_LOOKS);
    }
}

SeenWidget Desk::widget(const QString& name) {
    const Windows windows = lookUntil(name.toStdString() + ", enabled", [&](const Windows& seen) {
        const SeenWidget* const found = seen.widget(name);
        return found && found->is_enabled;
    });
    return *windows.widget(name);
}

void Desk::waitForText(const QString& name, const QString& text) {
    lookUntil((name + " with " + text).toStdString(), [&](const Windows& seen) {
        const SeenWidget* const found = seen.widget(name);
        return found && found->text == text;
    });
}

void Desk::waitUntilGone(const QString& name) {
    lookUntil("no " + name.toStdString(), [&](const Windows& seen) { return !seen.widget(name); });
}

Windows Desk::waitUntilIdle() {
    return lookUntil("an idle window", [](const Windows& seen) {
        return !seen.isCommandRunning() && seen.modalWindows().isEmpty();
    });
}

void Desk::click(const QString& name) {
    m_display->click(widget(name).place.center());
}

void Desk::clickButton(const QString& text) {
    const Windows windows = lookUntil("a button " + text.toStdString(), [&](const Windows& seen) {
        const SeenWidget* const found = seen.button(text);
        return found && found->is_enabled;
    });
    m_display->click(windows.button(text)->place.center());
}

void Desk::clickItem(const QString& widget_name, const QString& item) {
    const Windows windows =
        lookUntil((item + " in " + widget_name).toStdString(), [&](const Windows& seen) {
            const SeenWidget* const found = seen.widget(widget_name);
            const SeenItem* const part = found ? found->item(item) : nullptr;
            return part && part->is_enabled;
        });
    m_display->click(windows.widget(widget_name)->item(item)->place.center());
}

void Desk::choose(const QString& combo_box, const QString& entry) {
    click(combo_box);
    const auto listWith = [&](const Windows& seen) -> const SeenItem* {
        for (const SeenWidget& list : seen.widgets)
            if (list.classes.contains("QComboBoxListView"))
                return list.item(entry);
        return nullptr;
    };
    const Windows open = lookUntil((entry + " in the list of " + combo_box).toStdString(),
                                   [&](const Windows& seen) { return listWith(seen) != nullptr; });
    // Where the entry lies under the mouse already, a quicker click belongs to the opening one.
    std::this_thread::sleep_for(DOUBLE_CLICK);
    m_display->click(listWith(open)->place.center());
    lookUntil((combo_box + " showing " + entry).toStdString(), [&](const Windows& seen) {
        const SeenWidget* const box = seen.widget(combo_box);
        return box && box->text == entry && !listWith(seen);
    });
}

void Desk::stepTo(const QString& number, int value) {
    for (SeenWidget box = widget(number); box.value != value; box = widget(number)) {
        const SeenItem* const arrow = box.item(box.value < value ? "up" : "down");
        for (int left = std::abs(value - box.value); left > 0; --left)
            m_display->click(arrow->place.center());
        const int before = box.value;
        lookUntil(number.toStdString() + " stepping", [&](const Windows& seen) {
            const SeenWidget* const now = seen.widget(number);
            return now && now->value != before;
        });
    }
}

void Desk::chooseInMenu(const QString& action) {
    const auto titleOf = [&](const Windows& seen, const char* kind) -> const SeenItem* {
        for (const SeenWidget& menu : seen.widgets)
            for (const SeenItem& title : menu.items)
                if (menu.classes.contains(kind) && title.holds.contains(action) && title.is_enabled)
                    return &title;
        return nullptr;
    };
    const Windows closed =
        lookUntil("a menu with " + action.toStdString(),
                  [&](const Windows& seen) { return titleOf(seen, "QMenuBar") != nullptr; });
    m_display->click(titleOf(closed, "QMenuBar")->place.center());
    Windows open = lookUntil(action.toStdString() + " in an open menu", [&](const Windows& seen) {
        return seen.menuWith(action) || titleOf(seen, "QMenu");
    });
    if (!open.menuWith(action))
        m_display->click(titleOf(open, "QMenu")->place.center());
    open = lookUntil(action.toStdString() + ", enabled in its menu", [&](const Windows& seen) {
        const SeenWidget* const menu = seen.menuWith(action);
        return menu && menu->item(action)->is_enabled;
    });
    m_display->click(open.menuWith(action)->item(action)->place.center());
}

/// A window manager would have given the window in front the keyboard.
void Desk::escape() {
    const Windows seen = look();
    for (const SeenWidget& window : seen.widgets)
        if (window.is_window &&
            (window.is_in_front || (window.name == "mainWindow" && seen.modalWindows().isEmpty())))
            m_display->giveKeyboard(window.window_id);
    m_display->tapKey(ESCAPE);
}

void Desk::giveUp(const std::function<void(const Windows&)>& how) {
    constexpr std::chrono::milliseconds TO_ACT{60};
    const Clock::time_point deadline = Clock::now() + LONGEST_WAIT;
    for (Windows seen = look(); seen.isCommandRunning() || !seen.modalWindows().isEmpty();
         seen = look()) {
        if (Clock::now() > deadline)
            fail("it cannot be given up");
        how(seen);
        std::this_thread::sleep_for(TO_ACT);
    }
}

void Desk::cancel(const Windows& seen) {
    for (const char* const name : {"cancel", "promptCancel", "keepDocument"})
        if (const SeenWidget* const button = seen.widget(name); button && button->is_enabled) {
            m_display->click(button->place.center());
            return;
        }
    const SeenWidget* const button = seen.button("Cancel");
    if (button && button->is_in_front)
        m_display->click(button->place.center());
    else
        escape();
}

void Desk::closeWindow(const QString& window_name) {
    m_display->askToClose(widget(window_name).window_id);
}

QImage Desk::stillPicture() {
    const Clock::time_point deadline = Clock::now() + LONGEST_WAIT;
    QImage before = m_display->picture();
    while (Clock::now() < deadline) {
        std::this_thread::sleep_for(STILL);
        QImage now = m_display->picture();
        if (now == before)
            return now;
        before = now;
    }
    fail("the screen never rests");
    return {};
}

} // namespace quarn::test
