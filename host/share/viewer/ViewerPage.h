#pragma once

#include "ground/AtomicFile.h"
#include "host/recording/RecordedFolder.h"

#include <cstdint>
#include <functional>

namespace quarn {

/// What a page is made from, and what it may replace.
struct PageSources {
    std::filesystem::path viewer_folder; ///< as SessionOptions has it
    std::vector<std::filesystem::path> locale_folders;
    bool overwrites = false; ///< also a file that is no such page
};

/// How a person wants the page.
struct PageWish {
    bool is_one_file = false; ///< the pictures in the page; else it stays beside them
    std::string title;        ///< UTF-8; empty: the animation's name
};

/// A page that stands written.
struct WrittenPage {
    std::filesystem::path file;
    std::uint64_t bytes = 0;
    int pictures = 0;
    /// What the person should know, in sentences of the user's language.
    std::vector<std::string> warnings;
};

/// Told how much of a page is there, from 0 to 1, before each picture that comes into it.
/// @return false where the page is not wanted any more
using PageProgress = std::function<bool(double share)>;

/// "house-viewer.html"
std::string viewerPageName(const std::string& animation);

/// Writes the page that shows a recording to others, into its folder: whole or not at all. Frames
/// that are cut off or damaged are left out, with a warning.
/// @param progress  may be empty; a page whose pictures stay beside it is there at once
/// @return an error, one sentence: no frame can be shown, a file of this name is no such page, it
///         would be larger than browsers take, the program's files are missing, the disk is full,
///         it is not wanted any more
Result<WrittenPage> writeViewerPage(const RecordedFolder& recorded, const PageWish& wish,
                                    const PageSources& sources, const PageProgress& progress = {});

} // namespace quarn
