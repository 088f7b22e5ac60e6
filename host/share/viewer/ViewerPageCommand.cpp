#include "ground/PathText.h"
#include "host/app/Application.h"
#include "host/commands/CommandEnd.h"
#include "host/share/RecordedFolderChoice.h"
#include "host/share/ShareCommands.h"
#include "host/share/viewer/ViewerPage.h"
#include "sdk/qncore/QnGet.h"

namespace quarn {

namespace {

CQuarnCommand::result askFolder(const CQuarnCommandContext& context,
                                std::filesystem::path& folder) {
    if (const auto chosen =
            chooseRecordedFolder(context, QnLocalizeString(L"Viewer page", 42741))) {
        folder = *chosen;
        return CQuarnCommand::success;
    }
    CQuarnGetString get;
    get.SetCommandPrompt(QnLocalizeString(L"Folder with recorded frames", 42740));
    if (get.GetString() != CQuarnGet::string)
        return get.CommandResult() == CQuarnCommand::success ? CQuarnCommand::nothing
                                                             : get.CommandResult();
    folder = pathFromText(get.String());
    return CQuarnCommand::success;
}

CQuarnCommand::result askTitle(std::string& title) {
    CQuarnGetString get;
    get.SetCommandPrompt(QnLocalizeString(L"Title of the page", 42742));
    get.SetDefaultString(KM_wString::FromUtf8(title));
    if (get.GetString() == CQuarnGet::string)
        title = KM_wString(get.String()).ToUtf8();
    return get.CommandResult();
}

CQuarnCommand::result askWish(PageWish& wish) {
    CQuarnGetOption get;
    get.SetCommandPrompt(QnLocalizeString(L"Enter to write the page", 42743));
    get.AcceptNothing();
    get.AddCommandOptionToggle(
        QnLocalizeCommandOptionName(L"OneFile", 42750), QnLocalizeCommandOptionValue(L"No", 42001),
        QnLocalizeCommandOptionValue(L"Yes", 42002), wish.is_one_file, &wish.is_one_file);
    const int title = get.AddCommandOption(QnLocalizeCommandOptionName(L"Title", 42751));
    for (;;) {
        const CQuarnGet::result answer = get.GetOption();
        if (answer == CQuarnGet::nothing)
            return CQuarnCommand::success;
        if (answer == CQuarnGet::string)
            return CQuarnCommand::failure;
        if (answer != CQuarnGet::option)
            return get.CommandResult();
        if (get.Option()->m_option_index != title)
            continue;
        const CQuarnCommand::result asked = askTitle(wish.title);
        if (asked != CQuarnCommand::success)
            return asked;
    }
}

void warnAll(const std::vector<std::string>& warnings) {
    for (const std::string& warning : warnings)
        Application::current()->frontEnd().warn(KM_wString::FromUtf8(warning).View());
}

/// In the unit that suits it: "812 kB", "15.8 MB".
KM_wString sizeText(std::uint64_t bytes) {
    constexpr double KILO = 1000.0;
    const auto size = static_cast<double>(bytes);
    return size < KILO * KILO ? KM_wString::FormatToString(L"%.0f kB", size / KILO)
                              : KM_wString::FormatToString(L"%.1f MB", size / (KILO * KILO));
}

void tellWritten(const WrittenPage& page) {
    Application::current()->frontEnd().sharedFileEnded(
        {page.file, true,
         KM_wString::FormatToString(QnLocalizeString(L"%s: %d pictures, %s.", 42749),
                                    textFromPath(page.file).Array(), page.pictures,
                                    sizeText(page.bytes).Array())});
}

CQuarnCommand::result writePage(const std::filesystem::path& folder, const PageWish& wish) {
    const auto recorded = readRecordedFolder(folder);
    if (!recorded)
        return fail(recorded.message());
    warnAll(recorded.value().warnings);
    const SessionOptions& options = Application::current()->options();
    FrontEnd& front_end = Application::current()->frontEnd();
    const std::filesystem::path name = viewerPageName(recorded.value().manifest.name);
    const auto page = writeViewerPage(
        recorded.value(), wish, {options.viewer_folder, options.locale_folders, options.overwrites},
        [&](double share) {
            front_end.sharedFileProgress(name, share);
            front_end.pumpEvents(0);
            return !front_end.isInterrupted();
        });
    if (!page)
        return front_end.isInterrupted() ? CQuarnCommand::cancel : fail(page.message());
    warnAll(page.value().warnings);
    tellWritten(page.value());
    return CQuarnCommand::success;
}

} // namespace

CQuarnCommand::result runViewerPage(const CQuarnCommandContext& context) {
    std::filesystem::path folder;
    CQuarnCommand::result asked = askFolder(context, folder);
    PageWish wish;
    if (asked == CQuarnCommand::success)
        asked = askWish(wish);
    return asked == CQuarnCommand::success ? writePage(folder, wish) : asked;
}

} // namespace quarn
