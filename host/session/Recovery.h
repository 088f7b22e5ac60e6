#pragma once

#include "host/recovery/RecoverableDocuments.h"
#include "sdk/qncore/QnExport.h"

#include <chrono>
#include <filesystem>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace quarn {

class Session;

// What a document holds that its file does not is kept in a recovery file, so that a crash loses
// little of it. docs/recovery.md tells where these files are and what stands in them.

/// Where and how often unsaved work is kept.
struct RecoveryOptions {
    /// Where it is noted which recovery files there are, and where they are themselves that cannot
    /// stand beside their documents; empty: the user's (userStateFolder).
    std::filesystem::path state_folder = {};
    /// The steady beat.
    std::chrono::milliseconds every{10000};
};

/// Keeps the unsaved work of a session: as long as its document is modified (isModified), a
/// recovery file holds the document as it was on the last beat. The file goes as soon as a beat
/// finds that the document was saved, that it is as it was saved again, or that another one was
/// opened in its place. Nobody else's recovery files are touched, but for the one that the document
/// was recovered from: it goes as soon as the keeper's own file holds as much, and with that file.
///
/// Belongs to the main thread, in which it takes a copy of the document without what is immutable:
/// under 5 ms for a million triangles. A thread of its own writes the copy; what was written before
/// and did not change is not written again. Before each command of the session, those of a script
/// too, the keeper looks by itself whether there is something to keep: what a command began with is
/// kept on the beat, however long the command runs.
///
/// One keeper for a session.
class QNCORE_API RecoveryKeeper {
public:
    /// @param session  must outlive the keeper
    RecoveryKeeper(Session& session, RecoveryOptions options);
    /// The session ends by a person's wish, and what was not saved is not wanted: the recovery file
    /// goes. After keepNow it stays, while the document is modified. Waits for what is just being
    /// written.
    ~RecoveryKeeper();
    RecoveryKeeper(const RecoveryKeeper&) = delete;
    RecoveryKeeper& operator=(const RecoveryKeeper&) = delete;

    /// To be called between commands and now and then while nothing happens, each second or more
    /// often. Does what is due, which mostly is nothing. Does nothing while a command runs.
    void beat();

    /// Keeps the document as it is now and waits until that is on the disk, for a program that is
    /// told to end without a person to ask. From now on the recovery file outlives the keeper while
    /// the document is modified. Nothing is written where nothing is unsaved. To be called between
    /// commands.
    /// @return nothing when all unsaved work is kept, or there is none; else a sentence that says
    ///         what could not be kept and why
    std::optional<std::string> keepNow();

    /// The person does not want the unsaved work of the document: its recovery files go at once.
    /// The document is kept again when it changes further. Needs not be called after a save.
    void forget();

    /// What hinders the keeper, as a sentence for the person: no space is left, no folder can be
    /// written. Each trouble comes once; work goes on, and the keeper tries again on each beat.
    /// @return nothing when there is no news
    std::optional<std::string> takeTrouble();

private:
    struct State;
    std::unique_ptr<State> m_state;
};

/// The documents that can be recovered, the last kept first: those of programs of this machine that
/// do not run any more. Looks at a few hundred bytes of each. Marks that lead to no recovery file
/// any more are cleared away.
QNCORE_API std::vector<RecoverableDocument> recoverableDocuments(const RecoveryOptions& options);

/// Opens such a document in place of the one at work. It has its own file's name again and counts
/// as modified, also where nothing changes any more. What cannot be taken over is told on the
/// command line. Its recovery file stays until the session's keeper has one of its own, or until
/// the document is saved or discarded.
/// @return nothing when it is open; else a sentence that says why it cannot be recovered, with the
///         document at work untouched: the file is gone or damaged, or a command runs
QNCORE_API std::optional<std::string> recover(Session& session,
                                              const RecoverableDocument& document);

/// Removes the recovery file of a document that nobody wants.
QNCORE_API void discard(const RecoverableDocument& document);

/// Whether the document's own file was written after the last state was kept: by the program that
/// ended as it saved, or by somebody who left the recovery for later.
QNCORE_API bool fileIsNewer(const RecoverableDocument& document);

/// Which document it is and when it was kept, by the clock on the wall, in a line for a person:
/// "house", kept 2026-06-21 12:03, of /home/me/house.quarn
QNCORE_API std::string recoverableText(const RecoverableDocument& document);

} // namespace quarn
