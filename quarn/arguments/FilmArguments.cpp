#include "quarn/arguments/FilmArguments.h"

#include "quarn/arguments/Readings.h"
#include "quarn/arguments/RecordingArguments.h"
#include "quarn/arguments/Subcommands.h"
#include "quarn/runs/FolderFilm.h"

namespace quarn::program {

namespace {

constexpr int MOST_FRAMES_A_SECOND = 60;
constexpr int WIDEST_PX = 16384;

} // namespace

void addFilmLook(CLI::App& command, FilmRequest& film, FilmTimes times) {
    const OptionAdder add(command);
    add("--fps", film.frame_rate, "N", wholeNumberFrom(1, MOST_FRAMES_A_SECOND),
        "Frames a second of the film (default: the most of 10, 12, 15, 20, 24, 25 and 30 that lets "
        "it last 4 s)");
    add("--video-quality", film.quality, "N", wholeNumberFrom(1, 100),
        "1 to 100: smaller films, or better ones (default: 80)");
    add("--width", film.width_px, "PX", wholeNumberFrom(1, WIDEST_PX),
        "Width of the film, at most that of the frames (default: theirs; of a gif at most 640)");
    if (times == FilmTimes::perhaps)
        command.add_flag("--caption", film.has_caption,
                         "Show the date and time of each frame of a sun study in the film");
}

void addRecordingFilm(CLI::App& command, FilmRequest& film, FilmTimes times) {
    const OptionAdder add(command);
    add("--video", film.file, "FILE", scriptWord("the path of --video"),
        "Make a film too, beside the drawing: .mp4, .webm, .gif, .webp or .apng");
    addFilmLook(command, film, times);
}

std::optional<std::string> whyFilmIsMisused(const FilmRequest& film) {
    if (!film.file.empty())
        return std::nullopt;
    const char* const option = film.frame_rate > 0 ? "--fps"
                               : film.quality > 0  ? "--video-quality"
                               : film.width_px > 0 ? "--width"
                               : film.has_caption  ? "--caption"
                                                   : nullptr;
    if (!option)
        return std::nullopt;
    return std::string(option) + " is for a film: give its file with --video too.";
}

Action addVideo(CLI::App& command) {
    const auto asked = std::make_shared<Asked<FolderFilmRequest>>();
    const OptionAdder add(command);
    FolderFilmRequest& request = asked->request;
    add("FOLDER", request.folder, "", scriptWord("the path of the folder"),
        "Folder that a recording was made into, or its NAME.frames.json")
        ->required();
    add("FILE", request.film.file, "", scriptWord("the path of the film"),
        "The film: .mp4, .webm, .gif, .webp or .apng")
        ->required();
    addFilmLook(command, request.film, FilmTimes::perhaps);
    command.add_flag("--overwrite", asked->use.common.overwrites,
                     "Replace a file that is there already");
    addShowScript(command, asked->use.is_only_shown);
    addCommonOptions(command, asked->use.common);
    return [asked] { return makeFolderFilm(asked->request, asked->use); };
}

} // namespace quarn::program
