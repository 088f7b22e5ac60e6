#include "quarn/farm/JobScript.h"

#include "quarn/farm/JobScriptText.h"
#include "quarn/words/Words.h"

#include <cstdint>
#include <cstdio>

namespace quarn::program {

namespace {

constexpr std::size_t WIDEST_LINE = 100;

std::string setting(const std::string& name, const std::string& value) {
    return name + "=" + shellWord(value) + "\n";
}

std::string list(const std::string& name, const std::vector<std::string>& words) {
    return name + "=(" + shellCommand(words) + ")\n";
}

/// The frames of each chunk, several in a line.
std::string chunkTable(const FrameChunks& chunks) {
    std::string text = "CHUNKS=(";
    std::string line;
    for (const std::vector<int>& frames : chunks) {
        const std::string ranges = rangesText(frames);
        if (line.empty() || line.size() + ranges.size() > WIDEST_LINE) {
            text += line + "\n";
            line = "   ";
        }
        line += " " + ranges;
    }
    return text + line + "\n)\n";
}

std::vector<std::string> recordOptions(const FarmRequest& request) {
    std::vector<std::string> words;
    if (!request.instructions.empty())
        words.insert(words.end(), {"--instructions", request.instructions});
    return words;
}

void addFilm(const FilmRequest& film, std::vector<std::string>& words) {
    const auto add = [&](const char* option, int value) {
        if (value > 0)
            words.insert(words.end(), {option, std::to_string(value)});
    };
    words.insert(words.end(), {"--video", film.file.native()});
    add("--fps", film.frame_rate);
    add("--video-quality", film.quality);
    add("--width", film.width_px);
    if (film.has_caption)
        words.push_back("--caption");
}

std::vector<std::string> finishOptions(const FarmRequest& request) {
    std::vector<std::string> words = {"--retries", std::to_string(request.retries)};
    if (request.overwrites)
        words.push_back("--overwrite");
    if (!request.film.file.empty())
        addFilm(request.film, words);
    if (request.viewer.is_one_file)
        words.push_back("--one-file");
    else if (request.viewer.is_wanted)
        words.push_back("--viewer");
    return words;
}

/// Documents of one name lie beside each other on a node's disk.
std::string stagedName(const std::filesystem::path& document) {
    std::uint64_t mark = 0xcbf29ce484222325; // FNV-1a, 64 bits (Fowler, Noll and Vo, 1991)
    for (const char c : document.native())
        mark = (mark ^ static_cast<unsigned char>(c)) * 0x100000001b3;
    char text[17];
    std::snprintf(text, sizeof text, "%016llx", static_cast<unsigned long long>(mark));
    return text;
}

} // namespace

std::string jobScriptText(const FarmRequest& request, const JobScript& script) {
    return JOB_SCRIPT_START + setting("ANIMATION", script.animation) +
           setting("QUARN", script.program.native()) +
           setting("DOCUMENT", request.document.native()) +
           setting("OUT", request.folder.native()) +
           "\n# A folder on the nodes' own disks that the document is copied into once a node; "
           "empty: it is\n# read where it is.\n" +
           setting("STAGE", request.stage.native()) +
           setting("STAGED_NAME", stagedName(request.document)) +
           "\n# What is added to quarn record, and to quarn finish.\n" +
           list("RECORD_OPTIONS", recordOptions(request)) +
           list("FINISH_OPTIONS", finishOptions(request)) +
           "\n# The frames of each task, counted from 0.\n" + chunkTable(script.chunks) +
           JOB_SCRIPT_END;
}

} // namespace quarn::program
