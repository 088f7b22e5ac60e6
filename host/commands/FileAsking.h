#pragma once

#include "host/front_end/FrontEndChoices.h"
#include "sdk/qncore/QnCommand.h"

#include <filesystem>
#include <vector>

namespace quarn {

// Commands that a person starts in a window ask for files with a chooser, where the line gives no
// file and there is a chooser; all others at their prompts.

/// What a command wants a file for: the title of its chooser.
enum class FileUse {
    open,
    import,
    save,
    save_selected,
    save_frame,
    save_rendering,
    export_camera,
    import_curve,
    load_plug_in,
    run,
    save_film,
    surroundings,
};

/// The folder that choosers show first where nothing else is offered: that of the document at work,
/// else that of the user's documents; empty where neither is known.
std::filesystem::path firstChooserFolder();

/// Lets a person choose a file.
/// @param offered  for a file to save: the one that is there already; empty for none
/// @return nobody where the command has to ask at its prompt: it is a script's, its line has words
///         left, or there is no chooser
FileChoice chooseFile(const CQuarnCommandContext& context, FileUse use,
                      const std::filesystem::path& offered = {});

/// Asks for a file, with a chooser or at a prompt.
/// @param prompt  in the user's language
/// @param file    receives the file after success
/// @return cancel when the chooser was closed; failure where the file is to be written and words
///         of the line are left behind it; else as the prompt ended
CQuarnCommand::result askFile(const CQuarnCommandContext& context, FileUse use,
                              const wchar_t* prompt, std::filesystem::path& file);

} // namespace quarn
