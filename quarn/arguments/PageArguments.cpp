#include "quarn/arguments/Readings.h"
#include "quarn/arguments/RecordingArguments.h"
#include "quarn/arguments/Subcommands.h"
#include "quarn/runs/PageRun.h"

namespace quarn::program {

namespace {

struct AskedPage {
    std::filesystem::path recorded;
    ViewerRequest request;
    ScriptUse use;
};

} // namespace

Action addPage(CLI::App& command) {
    const auto asked = std::make_shared<AskedPage>();
    const OptionAdder add(command);
    add("FOLDER", asked->recorded, "", scriptWord("the folder's path"),
        "The folder of a recording, or the file NAME.frames.json in it")
        ->required();
    command.add_flag("--one-file", asked->request.is_one_file,
                     "Put the pictures into the page, so that it can be sent alone");
    add("--title", asked->request.title, "TEXT", scriptWord("the title of --title"),
        "Title of the page (default: the animation's name)");
    addOverwrite(command, asked->use.common);
    addShowScript(command, asked->use.is_only_shown);
    addCommonOptions(command, asked->use.common);
    return [asked] { return writePage(asked->recorded, asked->request, asked->use); };
}

} // namespace quarn::program
