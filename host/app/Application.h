#pragma once

#include "engine/images/ImageFile.h"
#include "ground/AtomicFile.h"
#include "host/app/CommandRegistry.h"
#include "host/app/CommandRunner.h"
#include "host/app/PlugInLoader.h"
#include "host/app/ProcessorUse.h"
#include "host/app/RecordingFollowers.h"
#include "host/app/StringTables.h"
#include "host/border/Contract.h"
#include "host/document/DocumentList.h"
#include "host/front_end/FrontEnd.h"
#include "host/front_end/SessionOptions.h"
#include "host/recording/RunningRecording.h"

#include <filesystem>
#include <map>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

class CDialog;

namespace quarn {

/// The running host. A session owns it; there is at most one, because the programming interface
/// names no other.
class Application {
public:
    /// Starts with one new document and the host's texts.
    Application(FrontEnd& front_end, SessionOptions options);
    /// Closes the documents, then unloads the plug-ins, the last loaded first. What plug-ins have
    /// seen of documents and views stays as in DocumentList until they are unloaded.
    ~Application();
    Application(const Application&) = delete;
    Application& operator=(const Application&) = delete;

    /// The application that runs now, or null.
    static Application* current();
    /// The application, for a call that belongs on the main thread; null when none runs, and on
    /// every other thread, which is reported as a breach.
    static Application* forCall(const char* call);

    /// Registers commands of the host's own; one that cannot be is told.
    void addHostCommands(std::vector<std::unique_ptr<CQuarnCommand>> commands);

    FrontEnd& frontEnd() const { return m_front_end; }
    const SessionOptions& options() const { return m_options; }
    StringTables& texts() { return m_texts; }
    CommandRegistry& commands() { return m_commands; }
    CommandRunner& runner() { return m_runner; }
    DocumentList& documents() { return *m_documents; }
    PlugInLoader& plugIns() { return *m_plug_ins; }

    /// Shows text on the command line as it stands; while text is withheld, keeps it.
    void print(std::wstring_view text);
    class WithheldText;
    /// Shows a message of the host (UTF-8) as a line of its own.
    void tell(std::string_view message);

    /// Whether a picture or a page may be written to a file now: a recording that runs leaves files
    /// of others alone, and has told so then.
    bool mayWrite(const std::filesystem::path& file) const;
    /// Whether a picture or a page is not to be written now and counts as written all the same: a
    /// recording that runs has that frame already, or leaves it to others.
    bool passesOver(const std::filesystem::path& file);
    /// What becomes of a write-protected file that is to be replaced.
    Protection protection() const {
        return m_options.overwrites ? Protection::overridden : Protection::respected;
    }
    /// Of the pictures that are written, 1 to 100.
    int jpegQuality() const { return m_jpeg_quality; }
    void setJpegQuality(int quality) { m_jpeg_quality = quality; }
    /// To be called after a picture was written to a file: counts it for the command that runs, and
    /// tells the front end. Without a running command nothing happens.
    /// @param picture  what the file holds
    void pictureWritten(const std::filesystem::path& file, const Image& picture);

    /// The recording of a whole animation that runs now, or null. RecordingScope begins and ends
    /// it.
    RunningRecording* recording() const { return m_recording.get(); }
    /// Who follows the recording that runs now, or the next one. RecordingScope lets them go at
    /// its end.
    RecordingFollowers& recordingFollowers() { return m_followers; }
    void setRecording(std::unique_ptr<RunningRecording> recording);
    /// What the next recording is to make.
    void chooseNextRecording(RecordingChoice choice) { m_next_recording = std::move(choice); }
    /// Takes that; the one after it is the usual one.
    RecordingChoice takeNextRecording() { return std::exchange(m_next_recording, {}); }

    /// The window object for a window; null for a null window.
    CWnd* windowFor(HWND window);

    /// The dialog that is open, or null: there is at most one.
    const CDialog* openDialog() const { return m_open_dialog; }
    void setOpenDialog(const CDialog* dialog) { m_open_dialog = dialog; }

    /// A wait that was cut short counts as waited: who looks at the clock would go on waiting.
    void cutWaitShort(unsigned int milliseconds) { m_cut_waits_ms += milliseconds; }
    /// By how much the clock of the interface runs ahead therefore.
    unsigned int cutWaits() const { return m_cut_waits_ms; }

    void requestExit() { m_exit_requested = true; }
    void takeBackExit() { m_exit_requested = false; }
    bool isExitRequested() const { return m_exit_requested; }

private:
    void loadTexts(const std::string& owner, const std::vector<std::filesystem::path>& folders);

    FrontEnd& m_front_end;
    SessionOptions m_options;
    ProcessorUse m_processor_use; ///< first: what follows draws
    BreachReceiver m_former_receiver;
    StringTables m_texts;
    CommandRegistry m_commands;
    std::vector<std::unique_ptr<CQuarnCommand>> m_host_commands;
    CommandRunner m_runner;
    std::unique_ptr<DocumentList> m_documents;
    std::unique_ptr<PlugInLoader> m_plug_ins;
    std::unique_ptr<RunningRecording> m_recording;
    RecordingChoice m_next_recording;
    RecordingFollowers m_followers;
    std::map<HWND, std::unique_ptr<CWnd>> m_windows;
    const CDialog* m_open_dialog = nullptr;
    bool m_exit_requested = false;
    unsigned int m_cut_waits_ms = 0; ///< goes round, as the clock does
    int m_jpeg_quality = STANDARD_JPEG_QUALITY;
    WithheldText* m_withheld_text = nullptr; ///< null while text is shown at once
};

/// Keeps what is printed while it lives. Scopes nest like blocks.
class Application::WithheldText {
public:
    explicit WithheldText(Application& application);
    /// What was not shown by then is dropped.
    ~WithheldText();
    WithheldText(const WithheldText&) = delete;
    WithheldText& operator=(const WithheldText&) = delete;

    /// Prints what was kept, and keeps no more.
    void show();

private:
    friend class Application;
    void end();

    Application& m_application;
    WithheldText* m_outer;
    std::wstring m_text;
    bool m_is_keeping = true;
};

} // namespace quarn
