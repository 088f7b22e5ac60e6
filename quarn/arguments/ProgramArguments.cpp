#include "quarn/arguments/ProgramArguments.h"

#include "quarn/arguments/HelpTexts.h"
#include "quarn/arguments/Subcommands.h"

#include <CLI/CLI.hpp>
#include <algorithm>
#include <map>
#include <optional>
#include <sstream>

namespace quarn::program {

namespace {

/// A command of the program: what it is called, what help tells of it, and what it takes and does.
struct Subcommand {
    const char* name;
    const char* summary;
    const char* footer;
    Action (*add)(CLI::App& command);
    const char* more_footer = "";
};

constexpr Subcommand SUBCOMMANDS[] = {
    {"share", "Make a page and a film of a model, to send away", SHARE_FOOTER, addShare},
    {"turntable", "Record a turntable as pictures and a page", TURNTABLE_FOOTER, addTurntable},
    {"flythrough", "Record a walk along a curve, looking ahead", FLYTHROUGH_FOOTER, addFlythrough},
    {"path", "Record a camera that follows one curve and looks along another", PATH_FOOTER,
     addPath},
    {"day", "Record the sun and the shadows through one day", DAY_FOOTER, addDay, SITE_FOOTER},
    {"season", "Record the sun and the shadows of one time of day through the seasons",
     SEASON_FOOTER, addSeason, SITE_FOOTER},
    {"sun", "Tell where the sun stands, and when it rises and sets", SUN_FOOTER, addSun},
    {"sunpath", "Draw the ways of the sun through a year, and what hides them", SUNPATH_FOOTER,
     addSunPath},
    {"sunhours", "Tell how many hours of sun each place of a model gets", SUN_HOURS_FOOTER,
     addSunHours},
    {"places", "List the cities that a sun study knows by name", PLACES_FOOTER, addPlaces},
    {"curves", "List what a camera can follow", CURVES_FOOTER, addCurves},
    {"record", "Record a document's animation, or a part of it; goes on where it was stopped",
     RECORD_FOOTER, addRecord},
    {"finish", "Make what a recording lacks, then its page", FINISH_FOOTER, addFinish},
    {"farm", "Have a cluster record a document's animation", FARM_FOOTER, addFarm},
    {"frame", "Write one frame of a document's animation", FRAME_FOOTER, addFrame},
    {"camera", "Write the camera of each frame of a document's animation for other programs",
     CAMERA_FOOTER, addCamera},
    {"page", "Write a page that shows recorded frames to others", PAGE_FOOTER, addPage},
    {"video", "Make a film of recorded pictures", VIDEO_FOOTER, addVideo},
    {"run", "Run a script of host commands", RUN_FOOTER, addRun},
    {"console", "Type host commands", CONSOLE_FOOTER, addConsole},
    {"info", "Tell what a model file holds", INFO_FOOTER, addInfo},
};

/// "turntable, flythrough, ... and info"
std::string subcommandNames() {
    std::string names;
    for (const Subcommand& subcommand : SUBCOMMANDS)
        names += (names.empty()                              ? ""
                  : &subcommand == std::end(SUBCOMMANDS) - 1 ? " and "
                                                             : ", ") +
                 std::string(subcommand.name);
    return names;
}

using Actions = std::map<const CLI::App*, Action>;

Actions addSubcommands(CLI::App& program) {
    Actions actions;
    for (const Subcommand& subcommand : SUBCOMMANDS) {
        CLI::App& command = *program.add_subcommand(subcommand.name, subcommand.summary);
        command.footer(std::string(subcommand.footer) + subcommand.more_footer);
        command.allow_extras(); // left over words are told by a message of ours
        actions[&command] = subcommand.add(command);
    }
    return actions;
}

/// "quarn farm submit"
std::string fullNameOf(const CLI::App& command) {
    const CLI::App* const parent = command.get_parent();
    return parent ? fullNameOf(*parent) + " " + command.get_name() : "quarn";
}

std::string hintOf(const CLI::App& command) {
    return " (" + fullNameOf(command) + " --help tells more)";
}

Outcome refuseLeftOver(const CLI::App& command, const std::string& word) {
    if (word.starts_with('-'))
        return Outcome::misuse("unknown option " + word + hintOf(command));
    if (command.get_parent() == nullptr)
        return Outcome::misuse("unknown command " + word + "; the commands are " +
                               subcommandNames() + hintOf(command));
    return Outcome::misuse("unexpected argument " + word + hintOf(command));
}

/// The command that was typed, or the program where none was.
const CLI::App& typedCommand(const CLI::App& program) {
    const auto typed = program.get_subcommands([](const CLI::App* c) { return c->parsed(); });
    return typed.empty() ? program : *typed.front();
}

/// The command of commands that was typed, such as "submit" behind "farm".
const CLI::App& innermostCommand(const CLI::App& program) {
    const CLI::App& typed = typedCommand(program);
    return &typed == &program ? program : innermostCommand(typed);
}

/// A word that the program or the command does not know, as a refusal.
/// @param start  what the word begins with; empty: any word
std::optional<Outcome> leftOver(const CLI::App& program, const std::string& start) {
    for (const CLI::App* reader : {&program, &typedCommand(program), &innermostCommand(program)}) {
        const std::vector<std::string> words = reader->remaining();
        const auto word = std::ranges::find_if(
            words, [&](const std::string& left) { return left.starts_with(start); });
        if (word != words.end())
            return refuseLeftOver(*reader, *word);
    }
    return std::nullopt;
}

/// An option that is misspelled is why another one is missing.
Outcome refuseMistake(const CLI::App& program, const CLI::ParseError& mistake) {
    const CLI::App& command = innermostCommand(program);
    if (command.get_help_ptr()->count() > 0)
        return Outcome::success(program.help());
    if (const auto unknown = leftOver(program, "-"))
        return *unknown;
    std::string message = mistake.what();
    if (dynamic_cast<const CLI::ValidationError*>(&mistake))
        return Outcome::misuse(message);
    std::replace(message.begin(), message.end(), '\n', ' ');
    return Outcome::misuse(message + hintOf(command));
}

} // namespace

Outcome runArguments(int argument_count, const char* const* arguments) {
    CLI::App program("Turns a model file into frames and a page that plays them.", "quarn");
    program.set_version_flag("--version", "quarn " QUARN_VERSION);
    program.footer(PROGRAM_FOOTER);
    program.allow_extras();
    program.require_subcommand(0, 1); // further words may be files that are named like a command
    const Actions actions = addSubcommands(program);
    try {
        program.parse(argument_count, arguments);
    } catch (const CLI::Success& finished) {
        std::ostringstream text;
        program.exit(finished, text, text);
        return Outcome::success(text.str());
    } catch (const CLI::ParseError& mistake) {
        return refuseMistake(program, mistake);
    }
    if (const auto unknown = leftOver(program, ""))
        return *unknown;
    const auto action = actions.find(&typedCommand(program));
    return action == actions.end() ? Outcome{Outcome::misused, SHORT_HELP} : action->second();
}

} // namespace quarn::program
