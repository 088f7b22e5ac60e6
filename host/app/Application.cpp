#include "host/app/Application.h"

#include "ground/PathText.h"
#include "host/document/DisplayModeList.h"
#include "sdk/qncore/QnZoetrixDynamicAccess.h"

namespace quarn {

namespace {

/// The application that runs now. The programming interface reaches it through QuarnApp().
Application* running_application = nullptr;

/// Frames of the animation of a document; 0 when nothing keeps one.
int frameCount(Document* document) {
    const IQnZoetrixDynamicAccess* access = Zoetrix_QuarnDynamicAccess();
    if (!access || !document)
        return 0;
    return access->AnimationProperties(document->face()).FrameCount();
}

BreachReceiver receiverFor(const SessionOptions& options) {
    if (!options.strict)
        return breachReceiverOfEnvironment();
    return *options.strict ? abortOnBreach : logBreach;
}

} // namespace

Application* Application::current() {
    return running_application;
}

Application* Application::forCall(const char* call) {
    return isOnMainThread(call) ? running_application : nullptr;
}

Application::Application(FrontEnd& front_end, SessionOptions options)
    : m_front_end(front_end), m_options(std::move(options)), m_processor_use(m_options),
      m_former_receiver(setBreachReceiver(receiverFor(m_options))), m_texts(m_options.language),
      m_runner(*this) {
    claimMainThread();
    running_application = this;
    loadTexts("host", m_options.locale_folders);
    if (!m_options.program_locale_folder.empty())
        loadTexts("program", {m_options.program_locale_folder});
    DisplayModeList::instance().localize();
    m_documents = std::make_unique<DocumentList>(front_end);
    m_documents->openNew();
    m_plug_ins = std::make_unique<PlugInLoader>(*this);
}

Application::~Application() {
    m_documents->closeAll();
    m_plug_ins.reset();
    m_documents.reset();
    for (const std::unique_ptr<CQuarnCommand>& command : m_host_commands)
        m_commands.remove(*command);
    m_host_commands.clear();
    running_application = nullptr;
    releaseMainThread();
    setBreachReceiver(m_former_receiver);
}

void Application::loadTexts(const std::string& owner,
                            const std::vector<std::filesystem::path>& folders) {
    if (const Result<void> loaded = m_texts.load(owner, folders); !loaded)
        tell(loaded.message());
}

void Application::addHostCommands(std::vector<std::unique_ptr<CQuarnCommand>> commands) {
    for (std::unique_ptr<CQuarnCommand>& command : commands) {
        if (Result<void> added = m_commands.add(*command); !added)
            tell(added.message());
        m_host_commands.push_back(std::move(command));
    }
}

void Application::print(std::wstring_view text) {
    if (m_withheld_text)
        m_withheld_text->m_text += text;
    else
        m_front_end.print(text);
}

Application::WithheldText::WithheldText(Application& application)
    : m_application(application), m_outer(application.m_withheld_text) {
    m_application.m_withheld_text = this;
}

Application::WithheldText::~WithheldText() {
    end();
}

void Application::WithheldText::show() {
    end();
    if (!m_text.empty())
        m_application.print(m_text);
}

void Application::WithheldText::end() {
    if (std::exchange(m_is_keeping, false))
        m_application.m_withheld_text = m_outer;
}

void Application::tell(std::string_view message) {
    print((KM_wString::FromUtf8(message) + L"\n").View());
}

bool Application::mayWrite(const std::filesystem::path& file) const {
    return !m_recording || m_recording->mayWrite(file);
}

bool Application::passesOver(const std::filesystem::path& file) {
    if (!m_recording || !m_recording->passesOver(file))
        return false;
    if (const auto frame = m_recording->frameOf(file); frame && m_recording->hasKept(*frame))
        m_followers.frameKept(*frame, file);
    return true;
}

void Application::setRecording(std::unique_ptr<RunningRecording> recording) {
    m_recording = std::move(recording);
    const auto wants = [this] { return m_recording->makesNext(); };
    m_documents->setWantsPictures(m_recording ? std::function<bool()>(wants) : nullptr);
}

void Application::pictureWritten(const std::filesystem::path& file, const Image& picture) {
    if (m_recording)
        if (const auto frame = m_recording->fileWritten(file))
            m_followers.frameRecorded(*frame, file, picture);
    RunningCommand* command = m_runner.outermost();
    if (!command)
        return;
    ++command->pictures_written;
    const int total = m_recording ? m_recording->wantedFrames() : frameCount(m_documents->active());
    m_front_end.frameWritten(file, command->pictures_written, total);
}

CWnd* Application::windowFor(HWND window) {
    if (!window)
        return nullptr;
    std::unique_ptr<CWnd>& object = m_windows[window];
    if (!object)
        object = std::make_unique<CWnd>(window);
    return object.get();
}

} // namespace quarn
