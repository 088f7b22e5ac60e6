#include "sdk/qncore/QnFileUtilities.h"

#include "ground/PathText.h"
#include "host/app/Application.h"
#include "host/app/DocumentsFolder.h"
#include "sdk/qncore/QnLocalize.h"

#include <sys/stat.h>

namespace {

std::string withoutSeparatorAtEnd(std::string path) {
    while (path.size() > 1 && path.back() == '/')
        path.pop_back();
    return path;
}

/// A recording makes sure of its folder before each picture: before the first is drawn it is seen
/// whether all of them may be written.
bool mayBeRecordedInto(const std::filesystem::path& folder) {
    quarn::Application* const application = quarn::Application::current();
    quarn::RunningRecording* const recording =
        application && quarn::isMainThread() ? application->recording() : nullptr;
    return !recording || recording->begin(folder);
}

void tellFolderNotMade(const std::filesystem::path& folder, const std::error_code& error) {
    quarn::Application* const application = quarn::Application::current();
    if (!application || !quarn::isMainThread())
        return;
    const KM_wString name = quarn::textFromPath(folder);
    const KM_wString reason = KM_wString::FromUtf8(error.message());
    application->print(
        KM_wString::FormatToString(QnLocalizeString(L"The folder %s cannot be made: %s\n", 42111),
                                   name.Array(), reason.Array())
            .View());
}

} // namespace

bool CQuarnFileUtilities::GetMyDocumentsFolder(KM_wString& folder) {
    const quarn::Application* application = quarn::Application::current();
    const std::filesystem::path configured =
        application ? application->options().documents_folder : std::filesystem::path();
    const auto found = quarn::documentsFolder(configured);
    if (!found)
        return false;
    folder = KM_wString::FromUtf8(withoutSeparatorAtEnd(found->native()));
    return true;
}

bool CQuarnFileUtilities::DirExists(const wchar_t* path) {
    std::error_code error;
    return path && std::filesystem::is_directory(quarn::pathFromText(path), error);
}

bool CQuarnFileUtilities::CreateDir(const wchar_t* path) {
    if (!path || !*path)
        return false;
    const std::filesystem::path folder = quarn::pathFromText(path);
    std::error_code why;
    std::filesystem::create_directories(folder, why);
    if (std::error_code unused; std::filesystem::is_directory(folder, unused))
        return mayBeRecordedInto(folder);
    tellFolderNotMade(folder, why);
    return false;
}
