#include "sdk/qncore/QnTextFile.h"

#include "ground/AtomicFile.h"
#include "ground/FileLinks.h"
#include "ground/PartFile.h"
#include "ground/PathText.h"
#include "ground/TextEncoding.h"
#include "host/app/Application.h"

#include <unistd.h>

#include <optional>
#include <string>

struct CQnTextFile::State {
    std::optional<std::filesystem::path> path; ///< nothing while no file is open
    filetype type = filetype::utf8;
    std::wstring text;
    bool is_passed_over = false; ///< counts as written and is not
};

namespace {

std::filesystem::path folderOf(const std::filesystem::path& file) {
    return file.has_parent_path() ? file.parent_path() : ".";
}

bool canBeWritten(const std::filesystem::path& asked) {
    const quarn::Result<std::filesystem::path> file = quarn::fileBehindLinks(asked);
    const std::filesystem::path path = file ? file.value() : asked; // closing tells what is wrong
    std::error_code error;
    const std::filesystem::path folder = folderOf(path);
    return !path.filename().empty() && !std::filesystem::is_directory(path, error) &&
           std::filesystem::is_directory(folder, error) && access(folder.c_str(), W_OK) == 0;
}

/// The application, where it can be told something; else null.
quarn::Application* applicationHere() {
    return quarn::isMainThread() ? quarn::Application::current() : nullptr;
}

bool mayWrite(const std::filesystem::path& file) {
    const quarn::Application* const application = applicationHere();
    return !application || application->mayWrite(file);
}

quarn::Protection protection() {
    const quarn::Application* const application = applicationHere();
    return application ? application->protection() : quarn::Protection::respected;
}

void noteEnd(const std::filesystem::path& file, const quarn::Result<void>& written) {
    quarn::Application* const application = applicationHere();
    if (!application)
        return;
    if (!written)
        application->tell(written.message());
    else if (quarn::RunningRecording* recording = application->recording())
        recording->fileWritten(file);
}

} // namespace

CQnTextFile::CQnTextFile() : m_state(std::make_unique<State>()) {}

CQnTextFile::~CQnTextFile() {
    Close();
}

bool CQnTextFile::Open(const wchar_t* path, open_mode mode, filetype type) {
    if (m_state->path || !path || mode != open_mode::write)
        return false;
    const std::filesystem::path file = quarn::pathFromText(path);
    if (!canBeWritten(file) || !mayWrite(file))
        return false;
    quarn::Application* const application = applicationHere();
    *m_state = {file, type, {}, application && application->passesOver(file)};
    return true;
}

bool CQnTextFile::WriteString(const wchar_t* text) {
    if (!m_state->path)
        return false;
    m_state->text += text ? text : L"";
    return true;
}

bool CQnTextFile::Close() {
    if (!m_state->path)
        return false;
    const State closing = std::exchange(*m_state, {});
    if (closing.is_passed_over)
        return true;
    const auto encoding = static_cast<quarn::TextEncoding>(closing.type);
    const std::string bytes = quarn::encodeTextFile(closing.text, encoding);
    // A page comes once behind its pictures; those are written without a look around.
    quarn::removeLeftParts(folderOf(*closing.path));
    const quarn::Result<void> written =
        quarn::writeFileAtomically(*closing.path, std::as_bytes(std::span(bytes)), protection());
    noteEnd(*closing.path, written);
    return written.ok();
}
