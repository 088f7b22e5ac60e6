// The commands that read a file and let the host work on it.
#include "quarn/arguments/LightArguments.h"
#include "quarn/arguments/Readings.h"
#include "quarn/arguments/RecordingArguments.h"
#include "quarn/arguments/Subcommands.h"
#include "quarn/console/Console.h"
#include "quarn/reports/CurveReport.h"
#include "quarn/reports/ModelReport.h"
#include "quarn/runs/CameraExport.h"
#include "quarn/runs/ScriptRun.h"
#include "quarn/runs/SingleFrame.h"

namespace quarn::program {

namespace {

/// What is read first, and how the host is run.
struct FileWish {
    std::filesystem::path model;
    CommonOptions common;
};

/// How a person wants unsaved work to be kept.
struct KeepingWish {
    double every_s = 0.0;
    bool is_unwanted = false;

    std::optional<RecoveryOptions> options() const {
        if (is_unwanted)
            return std::nullopt;
        const auto every_ms = static_cast<std::chrono::milliseconds::rep>(1000.0 * every_s);
        return RecoveryOptions{.every = std::chrono::milliseconds(every_ms)};
    }
};

CLI::Option* addModel(CLI::App& command, FileWish& wish, const std::string& description) {
    return OptionAdder(command)("MODEL", wish.model, "", scriptWord("the model's path"),
                                description);
}

/// Without its dot.
std::string endingOf(const std::filesystem::path& file) {
    const std::string ending = file.extension().native();
    return ending.empty() ? "" : ending.substr(1);
}

} // namespace

Action addCurves(CLI::App& command) {
    const auto wish = std::make_shared<FileWish>();
    addModel(command, *wish, "The model file or document")->required();
    addCommonOptions(command, wish->common);
    return [=] { return reportCurves(wish->model, wish->common); };
}

Action addInfo(CLI::App& command) {
    const auto wish = std::make_shared<FileWish>();
    const auto is_json = std::make_shared<bool>(false);
    addModel(command, *wish, "The model file or document")->required();
    command.add_flag("--json", *is_json, "Tell it to a program, as JSON");
    addCommonOptions(command, wish->common);
    return [=] {
        return reportModel(wish->model, *is_json ? ReportForm::json : ReportForm::text,
                           wish->common);
    };
}

Action addFrame(CLI::App& command) {
    const auto asked = std::make_shared<Asked<FrameRequest>>();
    FrameRequest& request = asked->request;
    const OptionAdder add(command);
    add("DOC", request.document, "", savedDocument(), "The document, a .quarn file")->required();
    add("--number", request.number, "K", wholeNumberFrom(0), "The frame, from 0 as in file names")
        ->required();
    add("--size", request.size, "WxH", sizeOfPicture(),
        "Size of the picture in pixels (default: the view's)");
    addLight(add, request.light);
    add("--out", request.file, "FILE", scriptWord("the path of --out"),
        "The picture: .jpg, .png, .bmp or .tga")
        ->required();
    addShowScript(command, asked->use.is_only_shown);
    addCommonOptions(command, asked->use.common);
    return [asked] {
        const FrameRequest& frame = asked->request;
        if (const auto mistake = whyLightIsMisused(frame.light, endingOf(frame.file)))
            return Outcome::misuse(*mistake + " Give --out a file that ends in .png.");
        return writeSingleFrame(frame, asked->use);
    };
}

Action addCamera(CLI::App& command) {
    const auto asked = std::make_shared<Asked<CameraExportRequest>>();
    CameraExportRequest& request = asked->request;
    const OptionAdder add(command);
    add("DOC", request.document, "", savedDocument(), "The document, a .quarn file")->required();
    add("--out", request.file, "FILE", scriptWord("the path of --out"),
        "The camera: .glb, .gltf, .json or .csv")
        ->required();
    add("--fps", request.frame_rate, "N", wholeNumberFrom(1, 1000, "frames a second"),
        "Frames a second, 1 to 1000 (default: the largest of 10, 12, 15, 20, 24, 25 and 30 that "
        "lets the animation last 4 seconds)");
    command.add_flag("--overwrite", asked->use.common.overwrites,
                     "Replace a file that is no camera, and a protected one");
    addShowScript(command, asked->use.is_only_shown);
    addCommonOptions(command, asked->use.common);
    return [asked] { return exportCamera(asked->request, asked->use); };
}

Action addRun(CLI::App& command) {
    const auto wish = std::make_shared<FileWish>();
    const auto script = std::make_shared<std::string>();
    command.add_option("SCRIPT", *script, "The script file")->type_name("")->required();
    addModel(command, *wish, "A model file or document to read first");
    addOverwrite(command, wish->common);
    addCommonOptions(command, wish->common);
    return [=] { return runScript(*script, wish->model, wish->common); };
}

Action addConsole(CLI::App& command) {
    const auto wish = std::make_shared<FileWish>();
    addModel(command, *wish, "A model file or document to read first");
    addOverwrite(command, wish->common);
    const auto keeping = std::make_shared<KeepingWish>();
    const OptionAdder add(command);
    add("--recovery-every", keeping->every_s, "SECONDS", numberFrom(0.1, 3600, "seconds"),
        "How often unsaved work is kept for recovery", "10");
    command.add_flag("--no-recovery", keeping->is_unwanted,
                     "Keep no unsaved work for recovery, and offer none");
    addCommonOptions(command, wish->common);
    return [=] { return runConsole(wish->model, wish->common, keeping->options()); };
}

} // namespace quarn::program
