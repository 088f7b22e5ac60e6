#include "ground/PathText.h"
#include "host/app/Application.h"
#include "host/commands/CommandEnd.h"
#include "host/commands/FileAsking.h"
#include "host/share/RecordedFolderChoice.h"
#include "host/share/ShareCommands.h"
#include "host/share/film/FilmFollower.h"
#include "host/share/film/FolderFilm.h"
#include "sdk/qncore/QnGet.h"

namespace quarn {

namespace {

constexpr int MOST_FRAMES_A_SECOND = 60;
constexpr int WIDEST_PX = 16384;

/// Asks what the film is to be made of, until there is a folder, or the next recording is meant. A
/// person who has chosen a folder in a chooser is asked for the rest alone.
class SourceQuestion {
public:
    CQuarnCommand::result run(const CQuarnCommandContext& context) {
        m_folder = chooseRecordedFolder(context, QnLocalizeString(L"Folder of the frames", 42760))
                       .value_or("");
        for (;;) {
            const CQuarnGet::result answer = ask();
            if (answer == CQuarnGet::nothing)
                return CQuarnCommand::success;
            if (answer == CQuarnGet::string) {
                m_folder = pathFromText(m_get.String());
                return CQuarnCommand::success;
            }
            if (answer != CQuarnGet::option)
                return m_get.CommandResult();
            const int picked = m_get.Option()->m_option_index;
            if (picked == m_next_recording)
                return CQuarnCommand::success;
            if (const auto asked = askPart(picked); asked != CQuarnCommand::success)
                return asked;
        }
    }

    FilmWish wish() const {
        FilmWish wish = m_wish;
        wish.has_caption = m_has_caption;
        return wish;
    }
    /// Empty where the next recording is meant.
    const std::filesystem::path& folder() const { return m_folder; }

private:
    CQuarnGet::result ask() {
        m_get.ClearCommandOptions();
        if (m_folder.empty())
            askFolder();
        else
            askToGoOn();
        m_frame_rate = m_get.AddCommandOption(QnLocalizeCommandOptionName(L"FrameRate", 42761));
        m_quality = m_get.AddCommandOption(QnLocalizeCommandOptionName(L"Quality", 42762));
        m_width = m_get.AddCommandOption(QnLocalizeCommandOptionName(L"Width", 42763));
        m_get.AddCommandOptionToggle(QnLocalizeCommandOptionName(L"Caption", 42764),
                                     QnLocalizeCommandOptionValue(L"No", 42001),
                                     QnLocalizeCommandOptionValue(L"Yes", 42002), m_has_caption,
                                     &m_has_caption);
        return m_get.GetOption();
    }

    void askFolder() {
        m_get.SetCommandPrompt(QnLocalizeString(L"Folder of the frames", 42760));
        m_get.AcceptString();
        m_next_recording =
            m_get.AddCommandOption(QnLocalizeCommandOptionName(L"NextRecording", 42760));
    }

    void askToGoOn() {
        m_get.SetCommandPrompt(QnLocalizeString(L"Save the film", 42765));
        m_get.AcceptNothing();
    }

    CQuarnCommand::result askPart(int picked) {
        if (picked == m_frame_rate)
            return askNumber(QnLocalizeString(L"Frames a second", 42762), MOST_FRAMES_A_SECOND,
                             m_wish.frame_rate);
        if (picked == m_quality)
            return askNumber(QnLocalizeString(L"Quality, 1 to 100", 42763), 100, m_wish.quality);
        if (picked == m_width)
            return askNumber(QnLocalizeString(L"Width of the film in pixels", 42764), WIDEST_PX,
                             m_wish.width_px);
        return CQuarnCommand::success;
    }

    static CQuarnCommand::result askNumber(const wchar_t* prompt, int most, int& number) {
        CQuarnGetInteger get;
        get.SetCommandPrompt(prompt);
        get.SetLowerLimit(1);
        get.SetUpperLimit(most);
        if (number > 0)
            get.SetDefaultInteger(number);
        if (get.GetNumber() == CQuarnGet::number)
            number = get.Number();
        return get.CommandResult();
    }

    FilmWish m_wish;
    std::filesystem::path m_folder;
    CQuarnGetOption m_get;
    bool m_has_caption = false;
    int m_next_recording = 0;
    int m_frame_rate = 0;
    int m_quality = 0;
    int m_width = 0;
};

/// Beside the frames, with the name of their folder, which is usually the animation's.
std::filesystem::path offeredFile(const std::filesystem::path& folder) {
    const std::filesystem::path name = folder.filename();
    return name.empty() ? folder : folder / (name.native() + ".mp4");
}

/// A person who chose a file that is there has agreed to replace it.
CQuarnCommand::result askFilmFile(const CQuarnCommandContext& context,
                                  const std::filesystem::path& folder, FilmWish& wish) {
    wish.may_replace = Application::current()->options().overwrites;
    const FileChoice choice = chooseFile(context, FileUse::save_film, offeredFile(folder));
    if (choice.kind == FileChoice::Kind::given_up)
        return CQuarnCommand::cancel;
    if (choice.kind == FileChoice::Kind::chosen) {
        wish.file = choice.file;
        wish.may_replace = true;
        return CQuarnCommand::success;
    }
    return askFile(context, FileUse::save_film, QnLocalizeString(L"Film file", 42761), wish.file);
}

CQuarnCommand::result followNextRecording(FilmWish wish) {
    Application& application = *Application::current();
    const KM_wString text = KM_wString::FormatToString(
        QnLocalizeString(L"The next recording makes the film %s too.", 42785),
        textFromPath(wish.file).Array());
    application.recordingFollowers().add(
        std::make_unique<FilmFollower>(std::move(wish), application));
    application.tell(text.ToUtf8());
    return CQuarnCommand::success;
}

CQuarnCommand::result filmFolder(const std::filesystem::path& folder, const FilmWish& wish) {
    FrontEnd& front_end = Application::current()->frontEnd();
    const auto made = makeFilmOfFolder(folder, wish, front_end);
    if (!made)
        return fail(made.message());
    front_end.sharedFileEnded(made.value());
    return front_end.isInterrupted() ? CQuarnCommand::cancel : CQuarnCommand::success;
}

} // namespace

CQuarnCommand::result runFilm(const CQuarnCommandContext& context) {
    SourceQuestion question;
    if (const auto asked = question.run(context); asked != CQuarnCommand::success)
        return asked;
    FilmWish wish = question.wish();
    if (const auto asked = askFilmFile(context, question.folder(), wish);
        asked != CQuarnCommand::success)
        return asked;
    if (const auto checked = checkFilm(wish, filmModule()); !checked)
        return fail(checked.message());
    return question.folder().empty() ? followNextRecording(std::move(wish))
                                     : filmFolder(question.folder(), wish);
}

} // namespace quarn
