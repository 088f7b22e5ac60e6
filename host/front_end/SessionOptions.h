#pragma once

#include <cstdint>
#include <filesystem>
#include <optional>
#include <string>
#include <vector>

namespace quarn {

/// What a session is started with.
struct SessionOptions {
    /// Where plug-ins are looked for when they are needed, in this order.
    std::vector<std::filesystem::path> plug_in_folders;
    /// Folders of the host's own string tables (`<language>.json`). The tables of a plug-in
    /// `Name.qnp` are looked for in `locale/Name` beside its file, then in `Name` beside these
    /// folders.
    std::vector<std::filesystem::path> locale_folders;
    /// The user's language ("de", "ja"); empty takes it from the environment.
    std::string language;
    /// The user's documents folder; empty takes it from the environment, and where that knows none
    /// there is none.
    std::filesystem::path documents_folder;
    /// Whether the program ends where a plug-in breaks a rule of the interface; else a line on the
    /// error output says so and the call does nothing. Nothing: strict where the environment
    /// variable QUARN_STRICT is set to anything but 0.
    std::optional<bool> strict = std::nullopt;
    /// The folder of the string tables of the program that runs the session (`<language>.json`),
    /// for QnLocalizeString; the host's own texts go first. Empty: the program has none.
    std::filesystem::path program_locale_folder = {};
    /// Folders of dialog templates (`<id>.dialog.json`). Those of a plug-in `Name.qnp` are looked
    /// for in `dialogs/Name` beside its file, then in `Name` in these folders; those of the program
    /// itself in these folders.
    std::vector<std::filesystem::path> dialog_folders = {};
    /// The folder of the files that viewer pages are made from (`viewer.html` and what it names).
    std::filesystem::path viewer_folder = {};
    /// Whether write-protected files are replaced, and by a recording also files of others that
    /// have the names of its pictures or its page.
    bool overwrites = false;
    /// How much memory reading a model file may take, in bytes; 0: half of what is free then.
    std::uint64_t most_memory = 0;
    /// Whether what is opened or imported will be drawn: then the scene of a large model is built
    /// as a part of its loading, while the front end works on its events. Else the first picture
    /// builds it.
    bool builds_scenes = false;
    /// By how many threads pictures are drawn and models read at most; 0: by as many as the machine
    /// has processors.
    int most_threads = 0;
    /// The instruction set that pictures are drawn with, one of instructionSets(); empty: the
    /// fastest.
    std::string instructions = {};
};

} // namespace quarn
