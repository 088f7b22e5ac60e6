// The commands that record the animation that a document has.
#include "quarn/arguments/FilmArguments.h"
#include "quarn/arguments/Readings.h"
#include "quarn/arguments/RecordingArguments.h"
#include "quarn/arguments/Subcommands.h"
#include "quarn/runs/DocumentRecording.h"
#include "quarn/runs/FinishRun.h"

namespace quarn::program {

namespace {

constexpr int MOST_JOBS = 1024;

struct AskedRecording {
    DocumentRecordingRequest request{};
    int jobs = 1;
    bool goes_on = false;
    std::string recorder; ///< "anew" or "same" for one that this program started; else empty
    ScriptUse use;
};

void addQuality(const OptionAdder& add, std::optional<int>& quality) {
    add("--quality", quality, "N", wholeNumberFrom(1, 100),
        "Of jpg, 1 to 100: larger files look better (default: that of the frames that are there, "
        "else 90)");
}

/// @return what does not go together, or nothing
std::optional<std::string> settleRecording(AskedRecording& asked) {
    DocumentRecordingRequest& request = asked.request;
    if (asked.use.common.overwrites && asked.goes_on)
        return "--resume keeps the frames that are there, and --overwrite makes all anew: give one "
               "of them.";
    if (asked.use.common.overwrites)
        request.start = RecordingStartKind::anew;
    if (auto mistake = whyFilmIsMisused(request.film))
        return mistake;
    const char* const of_all = !request.film.file.empty()   ? "--video"
                               : request.viewer.is_one_file ? "--one-file"
                               : request.viewer.is_wanted   ? "--viewer"
                                                            : nullptr;
    if (of_all && !request.part.areAll())
        return std::string(of_all) +
               " is made of all frames, not of those of --frames: once they are there, quarn "
               "finish " +
               shellWord(request.folder.native()) + " " + of_all + " makes it.";
    return std::nullopt;
}

Outcome record(AskedRecording& asked) {
    if (const auto mistake = settleRecording(asked))
        return Outcome::misuse(*mistake);
    if (asked.recorder.empty())
        return recordDocument(asked.request, asked.jobs, asked.use);
    asked.request.start =
        asked.recorder == "anew" ? RecordingStartKind::anew : RecordingStartKind::resume;
    return runRecorder(asked.request, asked.use.common);
}

} // namespace

Action addRecord(CLI::App& command) {
    const auto asked = std::make_shared<AskedRecording>();
    DocumentRecordingRequest& request = asked->request;
    const OptionAdder add(command);
    add("DOC", request.document, "", savedDocument(), "The document, a .quarn file")->required();
    add("--out", request.folder, "DIR", scriptWord("the path of --out"),
        "Folder for the pictures; one that holds some of them already is gone on with")
        ->required();
    add("--frames", request.part, "RANGES", frameRanges(),
        "Only these, from 0 as in file names: 0-9,20-30:2 is the first ten, and every other one "
        "from 20 to 30; one frame is 12-12 (default: all, and then the page)");
    add("--jobs", asked->jobs, "N", wholeNumberFrom(1, MOST_JOBS),
        "Recorders that share the frames, each a process with a share of the cores that reads the "
        "document for itself",
        "1");
    command.add_flag("--resume", asked->goes_on,
                     "Keep whole frames of the same recording; it is done without this too");
    addQuality(add, request.quality);
    addViewer(command, request.viewer);
    addRecordingFilm(command, request.film, FilmTimes::perhaps);
    command.add_flag("--overwrite", asked->use.common.overwrites,
                     "Make all frames anew, whatever is there, in place of files of others too");
    addShowScript(command, asked->use.is_only_shown);
    addCommonOptions(command, asked->use.common);
    add("--recorder", asked->recorder, "WAY", oneOf({"anew", "same"}), "Used by --jobs")->group("");
    return [asked] { return record(*asked); };
}

Action addFinish(CLI::App& command) {
    const auto asked = std::make_shared<Asked<FinishRequest>>();
    FinishRequest& request = asked->request;
    const OptionAdder add(command);
    add("DIR", request.recorded, "", scriptWord("the folder's path"),
        "Folder that a document was recorded into, or the file NAME.recording in it")
        ->required();
    add("--document", request.document, "DOC", savedDocument(),
        "The document (default: where it was when the recording began)");
    add("--retries", request.retries, "N", numberOfRetries(),
        "How often frames that cannot be made are tried again", "2");
    addQuality(add, request.quality);
    addViewer(command, request.viewer);
    addRecordingFilm(command, request.film, FilmTimes::perhaps);
    command.add_flag("--overwrite", asked->use.common.overwrites,
                     "Replace a film that is there; make all frames anew where the document has "
                     "changed");
    addShowScript(command, asked->use.is_only_shown);
    addCommonOptions(command, asked->use.common);
    return [asked] {
        if (const auto mistake = whyFilmIsMisused(asked->request.film))
            return Outcome::misuse(*mistake);
        return finishRecording(asked->request, asked->use);
    };
}

} // namespace quarn::program
