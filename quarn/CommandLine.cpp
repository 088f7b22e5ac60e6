#include "quarn/CommandLine.h"

#include "quarn/CaptureMode.h"

#include <CLI/CLI.hpp>
#include <algorithm>
#include <sstream>

namespace quarn::program {

namespace {

constexpr const char* SHORT_HELP = R"(usage: quarn COMMAND ...

  quarn turntable MODEL --frames N --out DIR   record a turntable as pictures and a page
  quarn frame DOC --number K --out FILE        write one frame of a saved animation
  quarn run SCRIPT [MODEL]                     run a script of host commands
  quarn console [MODEL]                        type host commands
  quarn info MODEL                             tell what a model file holds

A MODEL may be a .quarn document too. quarn --help and quarn COMMAND --help tell more.
)";

constexpr const char* PROGRAM_FOOTER = R"(
Examples:
  quarn turntable house.glb --frames 120 --out out/house --save house.quarn
  quarn frame house.quarn --number 60 --out middle.png
  quarn info house.glb
  quarn run steps.txt house.glb
  quarn console house.glb

Exit codes: 0 done, 1 failed, 2 arguments that make no sense, 130 stopped with Ctrl-C (143 by
a request to terminate). Ctrl-C lets the picture that is being recorded be finished and writes the
page; a second Ctrl-C ends the program at once.)";

constexpr const char* TURNTABLE_FOOTER = R"(
The model is framed so that it fills the pictures well during the whole turn. The pictures are
named NAME000, NAME001, ... and NAME.html plays them in a browser.

Examples:
  quarn turntable house.glb --frames 120 --out out/house
  quarn turntable part.stl --frames 36 --out out --mode Shaded --format png --size 640x480
  quarn turntable town.obj --frames 240 --out out --elevation 35 --distance 0.8 --name Town
  quarn turntable town.obj --frames 240 --out out --show-script > town.txt)";

constexpr const char* FRAME_FOOTER = R"(
The frame is drawn as the recording draws it; at the view's own size it is the same file.

Examples:
  quarn frame house.quarn --number 0 --out first.jpg
  quarn frame house.quarn --number 60 --size 3840x2160 --out middle.png)";

constexpr const char* RUN_FOOTER = R"(
A script holds one host command a line; the words after a command's name answer its questions.
Blank lines and lines that start with # are skipped. The first command that fails ends the run.

Example (steps.txt):
  _-StandardView _Top
  _-FitView _Enter
  _-SetTurntableAnimation 36 _Clockwise _png _Shaded _Enter _Enter
  _-RecordAnimation _TargetFolder "out" _Enter

The command Help lists every command.)";

constexpr const char* CONSOLE_FOOTER = R"(
A command asks for what it needs: "Number of frames <100>: ". What stands in < > is the answer of
an empty line; what stands in ( ) are options, picked by typing their names (in a question for
text as they stand there, with their brackets). Answers may also follow the command's name on its
line; the command asks for those that are missing, and again for one that does not fit.

  Tab        completes names of commands, options, objects and files
  Up, Down   call back earlier lines; those of earlier runs are kept in
             $XDG_STATE_HOME/quarn/history or else ~/.local/state/quarn/history
  Ctrl-C     cancels the command that asks; ends a recording after the current picture (a second
             one, while a command is at work, ends the program at once)
  Ctrl-D     ends the program where a command is asked for, as Exit does; nothing is saved then

An empty line where a command is asked for does nothing; Up and Enter repeat the last command. What
is piped in is read as if it were typed; there lines that start with # are skipped.

Example:
  quarn console house.glb
  Command: SetTurntableAnimation 36 Clockwise
  File type <jpg> ( jpg png bmp tga ):)";

constexpr const char* INFO_FOOTER = R"(
Example:
  quarn info house.glb)";

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

CLI::App& addTurntable(CLI::App& program, TurntableOptions& options) {
    CLI::App& command =
        *program.add_subcommand("turntable", "Record a turntable as pictures and a page");
    const auto add = [&](const char* name, std::string& value, const char* value_name,
                         const std::string& description) {
        return command.add_option(name, value, description)->type_name(value_name);
    };
    add("MODEL", options.model, "", "The model file: OBJ, glTF, GLB, PLY, STL, ...; or a document")
        ->required();
    add("--frames", options.frames, "N", "Pictures of one whole turn, from 1")->required();
    add("--out", options.folder, "DIR", "Folder for the pictures and the page")->required();
    add("--up", options.up_axis, "AXIS",
        "Axis that points up in the file, y or z (default: y for glTF and such, z for OBJ, PLY, "
        "STL)");
    add("--size", options.size, "WxH", "Size of a picture in pixels")->capture_default_str();
    add("--mode", options.mode, "NAME", "Display mode: " + captureModeNames())
        ->capture_default_str();
    add("--format", options.format, "NAME", "jpg, png, bmp or tga")->capture_default_str();
    add("--direction", options.direction, "NAME",
        "Way round seen from above, clockwise or anticlockwise")
        ->capture_default_str();
    add("--elevation", options.elevation_deg, "DEG",
        "Angle of the camera above the model, -89 to 89")
        ->capture_default_str();
    add("--distance", options.distance_factor, "FACTOR",
        "Camera distance times this: 0.01 to 1000, below 1 is nearer");
    add("--target", options.target, "X,Y,Z", "Point to turn about (default: the model's middle)");
    command.add_option("--hide", options.hidden, "Leave out this object; may be given again")
        ->type_name("NAME")
        ->expected(1)
        ->take_all();
    add("--name", options.name, "NAME", "Name of the animation (default: the model file's)");
    add("--save", options.document, "DOC",
        "Keep the document with its animation in this .quarn file, before recording");
    addShowScript(command, options.shows_script);
    command.footer(TURNTABLE_FOOTER);
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
        return Outcome::misuse("unknown command " + word +
                               "; the commands are turntable, frame, run, console and info" +
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

} // namespace

Request readCommandLine(int argument_count, const char* const* arguments) {
    CLI::App program("Turns a model file into frames and a page that plays them.", "quarn");
    program.set_version_flag("--version", "quarn " QUARN_VERSION);
    program.footer(PROGRAM_FOOTER);
    program.allow_extras();
    program.require_subcommand(0, 1); // further words may be files that are named like a command
    TurntableOptions turntable;
    FrameOptions frame;
    ScriptOptions script;
    ModelOptions model;
    ConsoleOptions console;
    const CLI::App& turntable_command = addTurntable(program, turntable);
    const CLI::App& frame_command = addFrame(program, frame);
    const CLI::App& run_command = addRun(program, script);
    const CLI::App& console_command = addConsole(program, console);
    addInfo(program, model);

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
    if (&command == &turntable_command) {
        turntable.was_name_given = command.count("--name") > 0;
        turntable.was_document_given = command.count("--save") > 0;
        return turntable;
    }
    if (&command == &frame_command)
        return frame;
    if (&command == &run_command)
        return script;
    if (&command == &console_command)
        return console;
    return model;
}

} // namespace quarn::program
