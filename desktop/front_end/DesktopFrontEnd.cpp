#include "desktop/front_end/DesktopFrontEnd.h"

#include "sdk/qncore/QnPlatform.h"

#include <QApplication>
#include <QCoreApplication>
#include <QEventLoop>
#include <QTimer>

#include <utility>

namespace quarn::desktop {

namespace {

/// Often enough that buttons feel alive, seldom enough that a recording does not notice.
constexpr qint64 BREATH_STEP_MS = 40;

} // namespace

void DesktopFrontEnd::setParts(FrontEndParts parts) {
    m_parts = std::move(parts);
    if (!m_early_text.empty() && m_parts.print)
        m_parts.print(std::exchange(m_early_text, {}));
}

void DesktopFrontEnd::commandStarts() {
    m_is_stop_requested = false;
    m_escape.forgetTap();
    m_since_breath.start();
}

void DesktopFrontEnd::commandEnded() {
    m_is_stop_requested = false;
}

void DesktopFrontEnd::print(std::wstring_view text) {
    if (m_parts.print)
        m_parts.print(text);
    else
        m_early_text += text;
}

/// A stop that was asked for ends questions too, so that a command with several of them ends.
Answer DesktopFrontEnd::ask(const Question& question) {
    if (m_is_stop_requested)
        return {Answer::Kind::cancel, {}};
    Answer answer = m_parts.ask ? m_parts.ask(question) : Answer{};
    m_escape.forgetTap();
    return answer;
}

int DesktopFrontEnd::showMessage(std::wstring_view text, std::wstring_view title, unsigned flags) {
    const int answer =
        m_parts.show_message ? m_parts.show_message(m_main_window, text, title, flags) : 1;
    m_escape.forgetTap();
    return answer;
}

std::optional<std::filesystem::path>
DesktopFrontEnd::chooseFolder(std::wstring_view title, std::wstring_view message,
                              const std::filesystem::path& start_folder) {
    if (!m_parts.choose_folder)
        return std::nullopt;
    auto folder = m_parts.choose_folder(m_main_window, title, message, start_folder);
    m_escape.forgetTap();
    return folder;
}

FileChoice DesktopFrontEnd::chooseFile(const FileQuestion& question) {
    if (!m_parts.choose_file)
        return {};
    FileChoice choice = m_parts.choose_file(m_main_window, question);
    m_escape.forgetTap();
    return choice;
}

std::optional<ModelUp> DesktopFrontEnd::chooseUpAxis(const UpAxisQuestion& question) {
    if (m_is_stop_requested || !m_parts.choose_up_axis)
        return std::nullopt;
    const auto up = m_parts.choose_up_axis(m_main_window, question);
    m_escape.forgetTap();
    return up;
}

std::optional<Place> DesktopFrontEnd::chooseLocation(std::wstring_view title, const Place& start) {
    if (!m_parts.choose_place)
        return std::nullopt;
    // A form asks for the place while it is open: the picker belongs before that form.
    QWidget* const form = QApplication::activeModalWidget();
    const std::optional<Place> place =
        m_parts.choose_place(form ? form : m_main_window.data(), title, start);
    m_escape.forgetTap();
    return place;
}

std::unique_ptr<DialogWindow> DesktopFrontEnd::makeDialog(const DialogTemplate& form, HWND owner) {
    QWidget* const window = owner ? reinterpret_cast<QWidget*>(owner) : m_main_window.data();
    return m_parts.make_dialog ? m_parts.make_dialog(form, window) : nullptr;
}

/// For no time at all it works on what is there already.
void DesktopFrontEnd::pumpEvents(unsigned milliseconds) {
    if (milliseconds == 0) {
        QCoreApplication::processEvents();
    } else {
        QEventLoop loop;
        QTimer::singleShot(static_cast<int>(milliseconds), Qt::PreciseTimer, &loop,
                           &QEventLoop::quit);
        loop.exec();
    }
    m_since_breath.start();
}

/// Dialogs and questions run loops of their own; this is for work that has none.
void DesktopFrontEnd::breatheWhenDue() {
    if (!m_since_breath.isValid() || m_since_breath.elapsed() >= BREATH_STEP_MS)
        pumpEvents(0);
}

bool DesktopFrontEnd::isKeyDown(int virtual_key) {
    return virtual_key == VK_ESCAPE && (m_is_stop_requested || m_escape.isDown());
}

bool DesktopFrontEnd::isInterrupted() const {
    return m_is_stop_requested;
}

HWND DesktopFrontEnd::mainWindow() {
    return reinterpret_cast<HWND>(m_main_window.data());
}

void DesktopFrontEnd::frameWritten(const std::filesystem::path& file, int written, int total) {
    if (m_parts.frame_written)
        m_parts.frame_written(file, written, total);
    breatheWhenDue();
}

void DesktopFrontEnd::recordingEnded(const RecordingReport& report) {
    if (m_parts.recording_ended)
        m_parts.recording_ended(report);
}

/// Whoever makes the file works on events between its steps. Escape can mean nothing else then.
void DesktopFrontEnd::sharedFileProgress(const std::filesystem::path& file, double share) {
    if (m_parts.shared_file_progress)
        m_parts.shared_file_progress(file, share);
    if (m_escape.isDown())
        requestStop();
}

void DesktopFrontEnd::sharedFileEnded(const SharedFileReport& report) {
    if (m_parts.shared_file_ended)
        m_parts.shared_file_ended(report);
    else
        FrontEnd::sharedFileEnded(report);
}

void DesktopFrontEnd::pictureRendered(double share) {
    if (m_parts.picture_rendered)
        m_parts.picture_rendered(share);
    breatheWhenDue();
}

void DesktopFrontEnd::modelRead(const std::filesystem::path&, ModelStep step, double share) {
    if (m_parts.model_read)
        m_parts.model_read(step, share);
    breatheWhenDue();
}

void DesktopFrontEnd::viewShown(CQuarnView& view, const ShownPicture& picture) {
    if (m_parts.view_shown)
        m_parts.view_shown(view, picture);
}

void DesktopFrontEnd::renderWindowShown(const ShownPicture& picture) {
    if (m_parts.render_window_shown)
        m_parts.render_window_shown(picture);
}

} // namespace quarn::desktop
