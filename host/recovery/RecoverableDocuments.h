#pragma once

#include "ground/Result.h"
#include "kelmar/KM_wString.h"

#include <chrono>
#include <cstddef>
#include <filesystem>
#include <string>
#include <vector>

namespace quarn {

class DocumentList;

/// A document with unsaved work whose program ended without a person's wish.
struct RecoverableDocument {
    std::filesystem::path recovery; ///< the recovery file
    std::filesystem::path mark;     ///< what in the state folder leads to it
    std::filesystem::path document; ///< the document's own file; empty: it was never saved
    KM_wString name;                ///< of its own file, without the ending; empty: never saved
    std::chrono::system_clock::time_point kept_at; ///< its last state
    /// What its active view showed, as a PNG file of at most 320 by 320 pixels; empty where nothing
    /// was drawn.
    std::vector<std::byte> picture;
};

/// The documents that can be recovered, the last kept first: those of programs of this machine that
/// do not run any more. Clears away marks that lead to no recovery file.
std::vector<RecoverableDocument> recoverableIn(const std::filesystem::path& state_folder);

/// Whether the document's own file was written after the last state was kept: by the program that
/// ended as it saved, or by somebody who left the recovery for later.
bool hasNewerFile(const RecoverableDocument& document);

/// Which document it is and when it was kept, by the clock on the wall, in a line for a person:
/// "house", kept 2026-06-21 12:03, of /home/me/house.quarn
std::string textOf(const RecoverableDocument& document);

/// Opens a document that can be recovered as a new one of the list: modified, and with its own
/// file's name again.
/// @return what could not be taken over and what the person has to know, in sentences; or a
///         sentence that says why it cannot be recovered, with no document opened
Result<std::vector<std::string>> openRecovered(DocumentList& list,
                                               const RecoverableDocument& document);

} // namespace quarn
