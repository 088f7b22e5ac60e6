#include "desktop/dialogs/Choosers.h"

#include "desktop/dialogs/DialogOwner.h"
#include "desktop/dialogs/FileBrowser.h"
#include "desktop/dialogs/MessageBox.h"
#include "desktop/texts/Texts.h"

#include <QDir>
#include <QFileInfo>
#include <QPointer>

#include <algorithm>

namespace quarn::desktop {
namespace {

namespace fs = std::filesystem;

/// Brackets in a label would be taken for patterns.
QString labelOf(const FileKind& kind) {
    return qtText(kind.label).replace('(', '[').replace(')', ']');
}

/// "OBJ models (*.obj *.OBJ)": the desktop's file systems tell upper from lower case.
QString filterOf(const FileKind& kind) {
    QStringList patterns;
    for (const std::string& extension : kind.extensions)
        patterns << "*." + QString::fromStdString(extension)
                 << "*." + QString::fromStdString(extension).toUpper();
    if (patterns.isEmpty())
        patterns << "*";
    return labelOf(kind) + " (" + patterns.join(' ') + ")";
}

QStringList filtersOf(const std::vector<FileKind>& kinds) {
    QStringList filters;
    for (const FileKind& kind : kinds)
        filters << filterOf(kind);
    return filters;
}

fs::path nearestFolder(fs::path path) {
    std::error_code ignored;
    while (!path.empty() && !fs::is_directory(path, ignored) && path != path.parent_path())
        path = path.parent_path();
    return path;
}

void begin(FileBrowser& browser, const fs::path& start) {
    if (const fs::path folder = nearestFolder(start); !folder.empty())
        browser.setDirectory(qtText(folder));
    std::error_code ignored;
    if (!start.empty() && start.has_filename() && !fs::is_directory(start, ignored))
        browser.selectFile(qtText(start.filename()));
}

/// Whether the person agrees to lose a file that is there.
bool mayReplace(FileBrowser& browser, const fs::path& file) {
    std::error_code ignored;
    if (!fs::exists(file, ignored))
        return true;
    const QString question = localized(L"\"%1\" is there already. Replace it?", 45326);
    return askWhether(&browser, question.arg(qtText(file.filename())).toStdWString(),
                      browser.windowTitle().toStdWString(),
                      localized(L"Replace", 45327).toStdWString());
}

bool endsWith(const std::string& extension, const FileKind& kind) {
    return std::ranges::find(kind.extensions, extension) != kind.extensions.end();
}

/// The kind whose filter is picked; the first where the window does not tell. Some windows tell the
/// filter, some the label that they show.
std::size_t pickedKind(const FileBrowser& browser, const std::vector<FileKind>& kinds) {
    const QString told = browser.selectedNameFilter();
    const auto picked = std::ranges::find_if(kinds, [&](const FileKind& kind) {
        return told == filterOf(kind) || told == labelOf(kind);
    });
    return picked == kinds.end() ? 0 : static_cast<std::size_t>(picked - kinds.begin());
}

FileChoice chosen(FileBrowser& browser, const FileQuestion& question) {
    const QStringList files = browser.selectedFiles();
    if (files.isEmpty())
        return {FileChoice::Kind::given_up, {}};
    const fs::path file = nativePath(files.first());
    if (question.kind == FileQuestion::Kind::open)
        return {FileChoice::Kind::chosen, file};
    return {FileChoice::Kind::chosen,
            withExtension(file, question.file_kinds, pickedKind(browser, question.file_kinds))};
}

} // namespace

std::filesystem::path withExtension(const std::filesystem::path& file,
                                    const std::vector<FileKind>& kinds, std::size_t chosen_kind) {
    if (chosen_kind >= kinds.size() || kinds[chosen_kind].extensions.empty())
        return file;
    std::string extension = file.extension().string();
    if (!extension.empty())
        extension.erase(0, 1);
    std::ranges::transform(extension, extension.begin(), [](char letter) {
        return letter >= 'A' && letter <= 'Z' ? static_cast<char>(letter - 'A' + 'a') : letter;
    });
    if (std::ranges::any_of(kinds, [&](const FileKind& kind) { return endsWith(extension, kind); }))
        return file;
    fs::path extended = file;
    extended += "." + kinds[chosen_kind].extensions.front();
    return extended;
}

std::optional<std::filesystem::path> askFolder(QWidget* owner, std::wstring_view title,
                                               std::wstring_view message,
                                               const std::filesystem::path& start) {
    const QPointer<FileBrowser> browser = new FileBrowser(topmostOwner(owner), qtText(title));
    browser->askForFolder();
    browser->setMessage(qtText(message));
    begin(*browser, start);
    std::optional<fs::path> folder;
    if (browser->exec() == QDialog::Accepted && browser && !browser->selectedFiles().isEmpty())
        folder = nativePath(browser->selectedFiles().first());
    delete browser.data();
    return folder;
}

FileChoice askFile(QWidget* owner, const FileQuestion& question) {
    const bool saves = question.kind == FileQuestion::Kind::save;
    const QPointer<FileBrowser> browser =
        new FileBrowser(topmostOwner(owner), qtText(question.title));
    browser->setAcceptMode(saves ? QFileDialog::AcceptSave : QFileDialog::AcceptOpen);
    browser->setFileMode(saves ? QFileDialog::AnyFile : QFileDialog::ExistingFile);
    browser->setOption(QFileDialog::DontConfirmOverwrite); // the extension may still be added
    browser->setLabelText(QFileDialog::Accept,
                          saves ? localized(L"Save", 45329) : localized(L"Open", 45330));
    if (!question.file_kinds.empty())
        browser->setNameFilters(filtersOf(question.file_kinds));
    begin(*browser, question.start);
    FileChoice choice = {FileChoice::Kind::given_up, {}};
    while (browser && browser->exec() == QDialog::Accepted && browser) {
        const FileChoice candidate = chosen(*browser, question);
        if (!saves || mayReplace(*browser, candidate.file)) {
            choice = candidate;
            break;
        }
    }
    delete browser.data();
    return choice;
}

} // namespace quarn::desktop
