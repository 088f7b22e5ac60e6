#include "quarn/CommandLine.h"

#include "quarn/CaptureMode.h"

#include <CLI/CLI.hpp>

namespace quarn::program {

namespace {

constexpr const char* SHORT_HELP = R"(usage: quarn COMMAND ...

  quarn turntable MODEL --frames N --out DIR   record a turntable as pictures and a page
  quarn run SCRIPT [MODEL]                     run a script of host commands
  quarn info MODEL                             tell what a model file holds

quarn --help and quarn COMMAND --help tell more.
)";

constexpr const char* PROGRAM_FOOTER = R"(
Examples:
  quarn turntable house.glb --frames 120 --out out/house
  quarn info house.glb
  quarn run steps.txt house.glb

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

constexpr const char* RUN_FOOTER = R"(
A script holds one host command a line; the words after a command's name answer its questions.
Blank lines and lines that start with # are skipped. The first command that fails ends the run.

Example (steps.txt):
  _-StandardView _Top
  _-FitView _Enter
  _-SetTurntableAnimation 36 _Clockwise _png _Shaded _Enter _Enter
  _-RecordAnimation _TargetFolder "out" _Enter

The command Help lists every command.)";

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

CLI::App& addTurntable(CLI::App& program, TurntableOptions& options) {
    CLI::App& command =
        *program.add_subcommand("turntable", "Record a turntable as pictures and a page");
    command.add_option("MODEL", options.model, "The model file: OBJ, glTF, GLB, PLY, STL, ...");
    command.add_option("--frames", options.frames, "Pictures of one whole turn, from 1");
    command.add_option("--out", options.folder, "Folder for the pictures and the page");
    command.add_option("--size", options.size, "Width x height of a picture in pixels")
        ->capture_default_str();
    command.add_option("--mode", options.mode, "Display mode: " + captureModeNames())
        ->capture_default_str();
    command.add_option("--format", options.format, "jpg, png, bmp or tga")->capture_default_str();
    command
        .add_option("--direction", options.direction,
                    "Way round, clockwise or anticlockwise, seen from above")
        ->capture_default_str();
    command
        .add_option("--elevation", options.elevation_deg,
                    "Degrees that the camera stands above the model, -89 to 89")
        ->capture_default_str();
    command.add_option("--distance", options.distance_factor,
                       "Camera distance times this factor: below 1 nearer, above 1 farther");
    command.add_option("--target", options.target,
                       "X,Y,Z of the point to turn about (default: the model's middle)");
    command.add_option("--name", options.name, "Name of the animation (default: the model file's)");
    command.add_flag("--show-script", options.shows_script,
                     "Print the host commands that would be run, and run nothing");
    command.footer(TURNTABLE_FOOTER);
    addCommonOptions(command, options.common);
    return command;
}

CLI::App& addRun(CLI::App& program, ScriptOptions& options) {
    CLI::App& command = *program.add_subcommand("run", "Run a script of host commands");
    command.add_option("SCRIPT", options.script, "The script file");
    command.add_option("MODEL", options.model, "A model file to read first");
    command.footer(RUN_FOOTER);
    addCommonOptions(command, options.common);
    return command;
}

CLI::App& addInfo(CLI::App& program, ModelOptions& options) {
    CLI::App& command = *program.add_subcommand("info", "Tell what a model file holds");
    command.add_option("MODEL", options.model, "The model file");
    command.footer(INFO_FOOTER);
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
                               "; the commands are turntable, run and "
                               "info" +
                               hintOf(command));
    return Outcome::misuse("unexpected argument " + word + hintOf(command));
}

Outcome refuseMissing(const CLI::App& command, const std::string& what) {
    return Outcome::misuse(command.get_name() + " needs " + what + hintOf(command));
}

/// Every command is there with all that it cannot do without, and nothing is left over.
std::variant<Outcome, const CLI::App*> chosenCommand(const CLI::App& program) {
    if (!program.remaining().empty())
        return refuseLeftOver(program, program.remaining().front());
    const std::vector<const CLI::App*> chosen =
        program.get_subcommands([](const CLI::App* command) { return command->parsed(); });
    if (chosen.empty())
        return Outcome{Outcome::misused, SHORT_HELP};
    if (!chosen.front()->remaining().empty())
        return refuseLeftOver(*chosen.front(), chosen.front()->remaining().front());
    return chosen.front();
}

} // namespace

Request readCommandLine(int argument_count, const char* const* arguments) {
    CLI::App program("Turns a model file into frames and a page that plays them.", "quarn");
    program.set_version_flag("--version", "quarn " QUARN_VERSION);
    program.footer(PROGRAM_FOOTER);
    program.allow_extras();
    program.require_subcommand(0, 1); // further words may be files that are named like a command
    TurntableOptions turntable;
    ScriptOptions script;
    ModelOptions model;
    const CLI::App& turntable_command = addTurntable(program, turntable);
    const CLI::App& run_command = addRun(program, script);
    addInfo(program, model);

    try {
        program.parse(argument_count, arguments);
    } catch (const CLI::Success& finished) {
        std::ostringstream text;
        program.exit(finished, text, text);
        return Outcome::success(text.str());
    } catch (const CLI::ParseError& mistake) {
        return Outcome::misuse(std::string(mistake.what()) + hintOf(program));
    }

    const auto chosen = chosenCommand(program);
    if (const Outcome* const refusal = std::get_if<Outcome>(&chosen))
        return *refusal;
    const CLI::App& command = *std::get<const CLI::App*>(chosen);
    if (&command == &turntable_command) {
        turntable.was_name_given = command.count("--name") > 0;
        if (turntable.model.empty())
            return refuseMissing(command, "a model file");
        if (turntable.frames.empty())
            return refuseMissing(command, "--frames N, the number of pictures");
        if (turntable.folder.empty())
            return refuseMissing(command, "--out DIR, the folder for the pictures");
        return turntable;
    }
    if (&command == &run_command)
        return script.script.empty() ? Request(refuseMissing(command, "a script file")) : script;
    return model.model.empty() ? Request(refuseMissing(command, "a model file")) : model;
}

} // namespace quarn::program
