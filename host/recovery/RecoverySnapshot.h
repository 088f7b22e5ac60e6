#pragma once

#include "host/document/SavedState.h"
#include "host/recovery/RecoveryState.h"
#include "kelmar/KM_Viewport.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace quarn {

class Document;

/// What of a document has to be the same for a recovery file to be up to date: what makes it
/// modified, and the cameras.
struct RecoveryMatter {
    SavedState saved;
    std::vector<KM_Viewport> cameras;
    std::size_t active_camera = 0;
    friend bool operator==(const RecoveryMatter&, const RecoveryMatter&) = default;
};

RecoveryMatter recoveryMatterOf(const Document& document);

/// Which picture a view shows.
struct ShownView {
    const void* view = nullptr;
    std::uint64_t show_count = 0;
    friend bool operator==(const ShownView&, const ShownView&) = default;
};

/// A document as it is now, to be kept.
struct RecoverySnapshot {
    std::unique_ptr<RecoveryState> state;
    /// Why a plug-in's part is missing, a sentence; the rest is there.
    std::optional<std::string> trouble;
};

/// Copies what changes of a document and shares what does not.
/// @param objects  the copies of its objects
/// @param shown  whose picture was copied last; receives whose is copied now, or stays where there
///               is no other one
RecoverySnapshot snapshotOf(Document& document, std::shared_ptr<const ObjectCopies> objects,
                            ShownView& shown);

} // namespace quarn
