#include "quarn/arguments/ProgramArguments.h"

#include "quarn/arguments/HelpTexts.h"
#include "quarn/scripts/CaptureMode.h"

#include <CLI/CLI.hpp>
#include <algorithm>
#include <sstream>

namespace quarn::program {

namespace {

void addCommonOptions(CLI::App& command, CommonOptions& common) {
    command.add_flag("--verbose", common.is_verbose, "Show what the host's commands print");
    command.add_option("--language", common.language,
                       "Language of texts, such as de or ja (default: the environment's)");
    // Left over words are told by a message of ours.
    command.allow_extras();
}

void addShowScript(CLI::App& command, bool& shows_script) {
    command.add_flag("--show-script", shows_script,
                     "Print the host commands that would be run, and run nothing");
}

/// Adds options that take one word.
class OptionAdder {
public:
    explicit OptionAdder(CLI::App& command) : m_command(command) {}

    template <class Value>
    CLI::Option* operator()(const char* name, Value& value, const char* value_name,
                            const std::string& description) const {
        return m_command.add_option(name, value, description)->type_name(value_name);
    }

private:
    CLI::App& m_command;
};

/// What goes in and out, which a person looks for first.
void addModelAndFolder(CLI::App& command, RecordingOptions& options) {
    const OptionAdder add(command);
    add("MODEL", options.model, "", "The model file: OBJ, glTF, GLB, PLY, STL, ...; or a document")
        ->required();
    add("--out", options.folder, "DIR", "Folder for the pictures and the page")->required();
    add("--up", options.up_axis, "AXIS",
        "Axis that points up in the file, y or z (default: y for glTF and such, z for OBJ, PLY, "
        "STL)");
}

/// The rest of what every recording takes.
void addRecordingOptions(CLI::App& command, RecordingOptions& options,
                         CaptureSubject subject = CaptureSubject::moving_camera) {
    const OptionAdder add(command);
    add("--size", options.size, "WxH", "Size of a picture in pixels")->capture_default_str();
    add("--mode", options.mode, "NAME", "Display mode: " + captureModeNames(subject))
        ->capture_default_str();
    add("--samples", options.samples, "N",
        "With RenderFull or RenderPreview: how often each pixel is looked at, 1 to 16384 (default: "
        "64 and 8, or the document's own)");
    add("--format", options.format, "NAME", "jpg, png, bmp or tga")->capture_default_str();
    command.add_option("--hide", options.hidden, "Leave out this object; may be given again")
        ->type_name("NAME")
        ->expected(1)
        ->take_all();
    add("--name", options.name, "NAME", "Name of the animation (default: the model file's)");
    add("--save", options.document, "DOC",
        "Keep the document with its animation in this .quarn file, before recording");
    addShowScript(command, options.shows_script);
    addCommonOptions(command, options.common);
}

CLI::App& addTurntable(CLI::App& program, TurntableOptions& options) {
    CLI::App& command =
        *program.add_subcommand("turntable", "Record a turntable as pictures and a page");
    const OptionAdder add(command);
    addModelAndFolder(command, options.recording);
    add("--frames", options.frames, "N", "Pictures of one whole turn, from 1")->required();
    add("--direction", options.direction, "NAME",
        "Way round seen from above, clockwise or anticlockwise")
        ->capture_default_str();
    add("--elevation", options.elevation_deg, "DEG",
        "Angle of the camera above the model, -89 to 89")
        ->capture_default_str();
    add("--distance", options.distance_factor, "FACTOR",
        "Camera distance times this: 0.01 to 1000, below 1 is nearer");
    add("--target", options.target, "X,Y,Z", "Point to turn about (default: the model's middle)");
    addRecordingOptions(command, options.recording);
    command.footer(TURNTABLE_FOOTER);
    return command;
}

/// What the cameras that follow something have in common.
template <class Options> void addTravelOptions(CLI::App& command, Options& options) {
    const OptionAdder add(command);
    command.add_flag("--even-speed", options.has_even_speed,
                     "Run through the camera's curve at even speed, whatever its parameters");
    add("--frames", options.frames, "N", "Pictures from the start to the end, from 1")->required();
    add("--lens", options.lens_mm, "MM",
        "Lens length, as of a camera for 35 mm film (default: 24, which suits a walk; a "
        "document's own)");
    addRecordingOptions(command, options.recording);
}

CLI::App& addFlythrough(CLI::App& program, FlythroughOptions& options) {
    CLI::App& command =
        *program.add_subcommand("flythrough", "Record a walk along a curve, looking ahead");
    const OptionAdder add(command);
    addModelAndFolder(command, options.recording);
    add("--path", options.path.object, "NAME", "Curve to follow, by its name or id");
    add("--camera-curve", options.path.curve_file, "FILE", "Follow the curve in this file instead");
    addTravelOptions(command, options);
    command.footer(FLYTHROUGH_FOOTER);
    return command;
}

CLI::App& addPath(CLI::App& program, PathOptions& options) {
    CLI::App& command = *program.add_subcommand(
        "path", "Record a camera that follows one curve and looks along another");
    const OptionAdder add(command);
    addModelAndFolder(command, options.recording);
    add("--camera", options.camera.object, "NAME",
        "Curve or point that the camera follows, by its name or id");
    add("--camera-curve", options.camera.curve_file, "FILE", "Or: the curve in this file");
    add("--camera-point", options.camera.point, "X,Y,Z", "Or: the place where the camera stays");
    add("--target", options.target.object, "NAME",
        "Curve or point that the camera looks at, by its name or id");
    add("--target-curve", options.target.curve_file, "FILE", "Or: the curve in this file");
    add("--target-point", options.target.point, "X,Y,Z", "Or: the place that it looks at");
    addTravelOptions(command, options);
    command.footer(PATH_FOOTER);
    return command;
}

void addSiteOptions(CLI::App& command, SiteOptions& options) {
    const OptionAdder add(command);
    add("--place", options.place, "NAME", "City where the model stands; quarn places lists them");
    add("--latitude", options.latitude_deg, "DEG", "Or: degrees north, -90 to 90");
    add("--longitude", options.longitude_deg, "DEG",
        "and degrees east, -180 to 180; west is negative");
    add("--north", options.north_deg, "DEG",
        "Where north is in the model, in degrees clockwise from its Y axis")
        ->capture_default_str();
}

void addStudyViewOptions(CLI::App& command, StudyViewOptions& options) {
    const OptionAdder add(command);
    add("--view", options.view, "NAME",
        "Top, Front, Right, Perspective or a camera of the model, in place of the next options");
    add("--azimuth", options.azimuth_deg, "DEG",
        "Where the camera stands, clockwise from the Y axis (default: 150, in front and to the "
        "right)");
    add("--elevation", options.elevation_deg, "DEG",
        "Angle of the camera above the model, 0 to 89 (default: 30)");
    add("--target", options.target, "X,Y,Z", "Point to look at (default: the model's middle)");
    add("--distance", options.distance_factor, "FACTOR",
        "Distance of the camera, 1 where the model just fits into the picture (default: 1.1)");
}

CLI::App& addDay(CLI::App& program, DayOptions& options) {
    CLI::App& command =
        *program.add_subcommand("day", "Record the sun and the shadows through one day");
    const OptionAdder add(command);
    addModelAndFolder(command, options.recording);
    addSiteOptions(command, options.site);
    add("--date", options.date, "DATE", "The day, such as 2026-06-21")->required();
    add("--from", options.from, "HH:MM", "Time of the first picture")->capture_default_str();
    add("--to", options.to, "HH:MM", "Time that no picture is later than")->capture_default_str();
    add("--every", options.every, "MINUTES", "Minutes between pictures, 1 to 1440")
        ->capture_default_str();
    addStudyViewOptions(command, options.view);
    addRecordingOptions(command, options.recording, CaptureSubject::moving_sun);
    command.footer(std::string(DAY_FOOTER) + SITE_FOOTER);
    return command;
}

CLI::App& addSeason(CLI::App& program, SeasonOptions& options) {
    CLI::App& command = *program.add_subcommand(
        "season", "Record the sun and the shadows of one time of day through the seasons");
    const OptionAdder add(command);
    addModelAndFolder(command, options.recording);
    addSiteOptions(command, options.site);
    add("--from", options.from, "DATE", "Date of the first picture, such as 2026-03-21")
        ->required();
    add("--to", options.to, "DATE", "Date that no picture is later than")->required();
    add("--every", options.every, "DAYS", "Days between pictures, from 1")->capture_default_str();
    add("--at", options.at, "HH:MM", "Time of day of every picture")->capture_default_str();
    addStudyViewOptions(command, options.view);
    addRecordingOptions(command, options.recording, CaptureSubject::moving_sun);
    command.footer(std::string(SEASON_FOOTER) + SITE_FOOTER);
    return command;
}

CLI::App& addPlaces(CLI::App& program, PlacesOptions& options) {
    CLI::App& command =
        *program.add_subcommand("places", "List the cities that a sun study knows by name");
    command.add_option("TEXT", options.text, "Only those with this in their name or country")
        ->type_name("");
    command.footer(PLACES_FOOTER);
    command.allow_extras();
    return command;
}

CLI::App& addCurves(CLI::App& program, CurvesOptions& options) {
    CLI::App& command = *program.add_subcommand("curves", "List what a camera can follow");
    command.add_option("MODEL", options.model, "The model file or document")
        ->type_name("")
        ->required();
    command.footer(CURVES_FOOTER);
    addCommonOptions(command, options.common);
    return command;
}

CLI::App& addFrame(CLI::App& program, FrameOptions& options) {
    CLI::App& command =
        *program.add_subcommand("frame", "Write one frame of a document's animation");
    const auto add = [&](const char* name, std::string& value, const char* value_name,
                         const char* description) {
        return command.add_option(name, value, description)->type_name(value_name);
    };
    add("DOC", options.document, "", "The document, a .quarn file")->required();
    add("--number", options.number, "K", "The frame, from 0 as in file names")->required();
    add("--size", options.size, "WxH", "Size of the picture in pixels (default: the view's)");
    add("--out", options.file, "FILE", "The picture: .jpg, .png, .bmp or .tga")->required();
    addShowScript(command, options.shows_script);
    command.footer(FRAME_FOOTER);
    addCommonOptions(command, options.common);
    return command;
}

CLI::App& addRun(CLI::App& program, ScriptOptions& options) {
    CLI::App& command = *program.add_subcommand("run", "Run a script of host commands");
    command.add_option("SCRIPT", options.script, "The script file")->type_name("")->required();
    command.add_option("MODEL", options.model, "A model file or document to read first")
        ->type_name("");
    command.footer(RUN_FOOTER);
    addCommonOptions(command, options.common);
    return command;
}

CLI::App& addInfo(CLI::App& program, ModelOptions& options) {
    CLI::App& command = *program.add_subcommand("info", "Tell what a model file holds");
    command.add_option("MODEL", options.model, "The model file or document")
        ->type_name("")
        ->required();
    command.footer(INFO_FOOTER);
    addCommonOptions(command, options.common);
    return command;
}

CLI::App& addConsole(CLI::App& program, ConsoleOptions& options) {
    CLI::App& command = *program.add_subcommand("console", "Type host commands");
    command.add_option("MODEL", options.model, "A model file or document to read first")
        ->type_name("");
    command.footer(CONSOLE_FOOTER);
    addCommonOptions(command, options.common);
    return command;
}

std::string hintOf(const CLI::App& command) {
    const bool is_program = command.get_parent() == nullptr;
    return " (quarn" + (is_program ? "" : " " + command.get_name()) + " --help tells more)";
}

Outcome refuseLeftOver(const CLI::App& command, const std::string& word) {
    if (word.starts_with('-'))
        return Outcome::misuse("unknown option " + word + hintOf(command));
    if (command.get_parent() == nullptr)
        return Outcome::misuse(
            "unknown command " + word +
            "; the commands are turntable, flythrough, path, day, season, places, curves, "
            "frame, run, console and info" +
            hintOf(command));
    return Outcome::misuse("unexpected argument " + word + hintOf(command));
}

/// The command that was typed, or the program where none was.
const CLI::App& typedCommand(const CLI::App& program) {
    const auto typed = program.get_subcommands([](const CLI::App* c) { return c->parsed(); });
    return typed.empty() ? program : *typed.front();
}

Outcome refuseMistake(const CLI::App& program, const CLI::ParseError& mistake) {
    std::string message = mistake.what();
    std::replace(message.begin(), message.end(), '\n', ' ');
    return Outcome::misuse(message + hintOf(typedCommand(program)));
}

void noteGiven(const CLI::App& command, RecordingOptions& options) {
    options.was_name_given = command.count("--name") > 0;
    options.was_document_given = command.count("--save") > 0;
}

/// The commands of the program, each with the options that it fills.
class Commands {
public:
    explicit Commands(CLI::App& program)
        : m_turntable_command(addTurntable(program, m_turntable)),
          m_flythrough_command(addFlythrough(program, m_flythrough)),
          m_path_command(addPath(program, m_path)), m_day_command(addDay(program, m_day)),
          m_season_command(addSeason(program, m_season)),
          m_places_command(addPlaces(program, m_places)),
          m_curves_command(addCurves(program, m_curves)),
          m_frame_command(addFrame(program, m_frame)), m_run_command(addRun(program, m_script)),
          m_console_command(addConsole(program, m_console)) {
        addInfo(program, m_model);
    }

    /// @param command  the one that was typed
    Request request(const CLI::App& command) {
        if (&command == &m_turntable_command)
            return recordingRequest(command, m_turntable);
        if (&command == &m_flythrough_command)
            return recordingRequest(command, m_flythrough);
        if (&command == &m_path_command)
            return recordingRequest(command, m_path);
        if (&command == &m_day_command)
            return recordingRequest(command, m_day);
        if (&command == &m_season_command)
            return recordingRequest(command, m_season);
        if (&command == &m_places_command)
            return m_places;
        if (&command == &m_curves_command)
            return m_curves;
        if (&command == &m_frame_command)
            return m_frame;
        if (&command == &m_run_command)
            return m_script;
        if (&command == &m_console_command)
            return m_console;
        return m_model;
    }

private:
    template <class Options>
    static Request recordingRequest(const CLI::App& command, Options& options) {
        noteGiven(command, options.recording);
        return options;
    }

    TurntableOptions m_turntable;
    FlythroughOptions m_flythrough;
    PathOptions m_path;
    DayOptions m_day;
    SeasonOptions m_season;
    PlacesOptions m_places;
    CurvesOptions m_curves;
    FrameOptions m_frame;
    ScriptOptions m_script;
    ModelOptions m_model;
    ConsoleOptions m_console;
    const CLI::App& m_turntable_command;
    const CLI::App& m_flythrough_command;
    const CLI::App& m_path_command;
    const CLI::App& m_day_command;
    const CLI::App& m_season_command;
    const CLI::App& m_places_command;
    const CLI::App& m_curves_command;
    const CLI::App& m_frame_command;
    const CLI::App& m_run_command;
    const CLI::App& m_console_command;
};

} // namespace

Request readCommandLine(int argument_count, const char* const* arguments) {
    CLI::App program("Turns a model file into frames and a page that plays them.", "quarn");
    program.set_version_flag("--version", "quarn " QUARN_VERSION);
    program.footer(PROGRAM_FOOTER);
    program.allow_extras();
    program.require_subcommand(0, 1); // further words may be files that are named like a command
    Commands commands(program);

    try {
        program.parse(argument_count, arguments);
    } catch (const CLI::Success& finished) {
        std::ostringstream text;
        program.exit(finished, text, text);
        return Outcome::success(text.str());
    } catch (const CLI::ParseError& mistake) {
        return refuseMistake(program, mistake);
    }

    const CLI::App& command = typedCommand(program);
    for (const CLI::App* reader : {static_cast<const CLI::App*>(&program), &command})
        if (!reader->remaining().empty())
            return refuseLeftOver(*reader, reader->remaining().front());
    if (&command == &program)
        return Outcome{Outcome::misused, SHORT_HELP};
    return commands.request(command);
}

} // namespace quarn::program
