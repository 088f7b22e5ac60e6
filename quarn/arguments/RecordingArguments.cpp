#include "quarn/arguments/RecordingArguments.h"

#include "quarn/arguments/FilmArguments.h"
#include "quarn/arguments/LightArguments.h"
#include "quarn/arguments/Readings.h"
#include "quarn/words/AnimationName.h"

namespace quarn::program {

namespace {

Reading<CaptureMode> modeFor(CaptureSubject subject) {
    return [=](const std::string& option,
               const std::string& word) -> std::variant<CaptureMode, Refusal> {
        const std::string choice = "; " + option + " takes " + captureModeNames(subject) + ".";
        const std::optional<CaptureMode> mode = captureMode(word);
        if (!mode)
            return Refusal{"unknown display mode \"" + word + "\"" + choice};
        if (subject == CaptureSubject::moving_sun && !mode->suits_sun_studies)
            return Refusal{"sun studies are not recorded in the display mode \"" + word + "\"" +
                           choice};
        return *mode;
    };
}

Reading<std::string> animationName() {
    return [](const std::string&, const std::string& word) -> std::variant<std::string, Refusal> {
        if (const auto refusal = whyNameIsRefused(word))
            return Refusal{*refusal};
        return word;
    };
}

/// A file to save a document in; its extension may be left out.
Reading<std::filesystem::path> documentFile() {
    using Path = std::filesystem::path;
    return [](const std::string& option, const std::string& word) -> std::variant<Path, Refusal> {
        if (const auto refusal = whyPathIsRefused("the path of " + option, word))
            return Refusal{*refusal};
        Path file = word;
        if (!file.has_filename())
            return Refusal{option + " must name a file, not \"" + word + "\"."};
        if (!file.has_extension())
            file += ".quarn";
        if (!isDocument(file))
            return Refusal{option + " must name a file that ends in .quarn, not \"" + word + "\"."};
        return file;
    };
}

void addHidden(CLI::App& command, std::vector<std::string>& hidden) {
    command.add_option("--hide", hidden, "Leave out this object; may be given again")
        ->type_name("NAME")
        ->expected(1)
        ->take_all()
        ->each([](const std::string& name) {
            if (const auto refusal = whyPathIsRefused("the name of --hide", name))
                throw CLI::ValidationError(*refusal);
        });
}

} // namespace

void addCommonOptions(CLI::App& command, CommonOptions& common) {
    command.add_flag("--verbose", common.is_verbose, "Show what the host's commands print");
    command.add_option("--language", common.language,
                       "Language of texts, such as de or ja (default: the environment's)");
    const OptionAdder add(command);
    add("--limit-memory", common.most_memory, "SIZE", sizeOfMemory(),
        "Memory that reading a model may take, such as 500M or 2G (default: half of what is free)");
    add("--threads", common.most_threads, "N", threadCount(),
        "By how many threads models are read and pictures drawn, 1 to 1024 (default: one for each "
        "processor core)");
    add("--instructions", common.instructions, "NAME", instructionSet(),
        "Instructions of the processor that pictures are drawn with: avx512, avx2 or sse2 "
        "(default: the fastest of them that it has); pictures of different ones differ in a few "
        "pixels");
}

void addShowScript(CLI::App& command, bool& is_only_shown) {
    command.add_flag("--show-script", is_only_shown,
                     "Print the host commands that would be run, and run nothing");
}

void addViewer(CLI::App& command, ViewerRequest& viewer) {
    command.add_flag("--viewer", viewer.is_wanted,
                     "Also write NAME-viewer.html, a page to show to others: quarn page --help "
                     "tells more");
    command.add_flag_callback(
        "--one-file", [&viewer] { viewer.is_wanted = viewer.is_one_file = true; },
        "The same with the pictures inside, so that it can be sent alone");
}

void addOverwrite(CLI::App& command, CommonOptions& common) {
    command.add_flag(
        "--overwrite", common.overwrites,
        "Replace files that a recording of this name did not write, and protected ones");
}

void addModelAndFolder(const OptionAdder& add, RecordingRequest& request) {
    add("MODEL", request.model, "", scriptWord("the model's path"),
        "The model file: OBJ, glTF, GLB, PLY, STL, ...; or a document")
        ->required();
    add("--out", request.folder, "DIR", scriptWord("the path of --out"),
        "Folder for the pictures and the page (default: one beside the model, with its name)");
    add("--up", request.up_axis, "AXIS", oneOf({"y", "z"}),
        "Axis that points up in the file, y or z (default: y for glTF and such, z for OBJ, PLY, "
        "STL)");
    add("--tolerance", request.tolerance, "LENGTH", numberFrom(1e-9, 1e9),
        "How far meshes may lie beside the curved surfaces of STEP, IGES and BREP, in their units "
        "(default: a thousandth of the model's size)");
}

void addFrames(const OptionAdder& add, RecordingRequest& request, const std::string& description) {
    add("--frames", request.frames, "N", wholeNumberFrom(1), description, "72");
}

void addLens(const OptionAdder& add, std::optional<double>& lens_mm, const std::string& rest) {
    add("--lens", lens_mm, "MM", numberFrom(1, 10000, "millimetres"),
        "Lens length, as of a camera for 35 mm film " + rest);
}

void addRecordingOptions(CLI::App& command, RecordingRequest& request, ScriptUse& use,
                         CaptureSubject subject) {
    const OptionAdder add(command);
    add("--size", request.size, "WxH", sizeOfPicture(), "Size of a picture in pixels", "1280x720");
    add("--mode", request.mode, "NAME", modeFor(subject),
        "Display mode: " + captureModeNames(subject), "Rendered");
    add("--samples", request.samples, "N", wholeNumberFrom(1, 16384),
        "With RenderFull or RenderPreview: how often each pixel is looked at, 1 to 16384 (default: "
        "64 and 8, or the document's own)");
    add("--format", request.format, "NAME", oneOf({"jpg", "png", "bmp", "tga"}),
        "jpg, png, bmp or tga", "jpg");
    add("--quality", request.quality, "N", wholeNumberFrom(1, 100),
        "Of jpg, 1 to 100: larger files look better (default: 90)");
    addLight(add, request.light);
    addHidden(command, request.hidden);
    add("--name", request.name, "NAME", animationName(),
        "Name of the animation (default: the model file's)");
    addViewer(command, request.viewer);
    add("--save", request.document, "DOC", documentFile(),
        "Keep the document with its animation in this .quarn file, before recording");
    addRecordingFilm(command, request.film,
                     subject == CaptureSubject::moving_sun ? FilmTimes::perhaps : FilmTimes::none);
    command.add_flag("--resume", request.goes_on,
                     "Go on with the recording in the folder; where another one is there, say so "
                     "and write nothing "
                     "(default, and with --overwrite: make that anew)");
    addOverwrite(command, use.common);
    addShowScript(command, use.is_only_shown);
    addCommonOptions(command, use.common);
}

std::optional<std::string> settle(RecordingRequest& request) {
    if (!request.up_axis.empty() && isDocument(request.model))
        return "--up is for model files; a document knows its axes.";
    if (request.tolerance > 0.0 && isDocument(request.model))
        return "--tolerance is for model files; a document has its meshes.";
    if (request.samples > 0 && !request.mode.is_rendered)
        return "--samples is for rendered pictures: with it --mode must be RenderFull or "
               "RenderPreview, not \"" +
               request.mode.name + "\".";
    if (request.quality && request.format != "jpg")
        return "--quality is for jpg pictures, not for " + request.format + ".";
    if (auto mistake = whyLightIsMisused(request.light, request.format))
        return *mistake + " Give --format png.";
    if (request.folder.empty()) {
        request.folder = request.model.parent_path() / request.model.stem();
        request.has_own_folder = true;
    }
    if (auto mistake = whyFilmIsMisused(request.film))
        return mistake;
    if (request.name.empty())
        request.name = animationNameFor(request.model);
    return std::nullopt;
}

} // namespace quarn::program
