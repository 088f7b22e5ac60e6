#include "sdk/qncore/QnFileUtilities.h"

#include "ground/PathText.h"
#include "host/app/Application.h"
#include "host/app/DocumentsFolder.h"

namespace {

std::string withoutSeparatorAtEnd(std::string path) {
    while (path.size() > 1 && path.back() == '/')
        path.pop_back();
    return path;
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
    std::error_code error;
    std::filesystem::create_directories(folder, error);
    return std::filesystem::is_directory(folder, error);
}
