#include "desktop/window/InstalledFiles.h"

#include "desktop/texts/Texts.h"

#include <QCoreApplication>

namespace quarn::desktop {

namespace {

std::filesystem::path installedTree() {
    return nativePath(QCoreApplication::applicationDirPath()).parent_path();
}

} // namespace

std::filesystem::path plugInFolder() {
    return installedTree() / "lib" / "quarn" / "plug-ins";
}

SessionOptions sessionOptions(const std::string& language) {
    const std::filesystem::path shared = installedTree() / "share" / "quarn";
    const std::filesystem::path texts = shared / "locale";
    SessionOptions options;
    options.plug_in_folders = {plugInFolder()};
    options.locale_folders = {texts / "host"};
    options.program_locale_folder = texts / "desktop";
    options.dialog_folders = {shared / "dialogs"};
    options.viewer_folder = shared / "viewer";
    options.language = language;
    return options;
}

} // namespace quarn::desktop
