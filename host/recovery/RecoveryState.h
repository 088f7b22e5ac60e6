#pragma once

#include "engine/images/Image.h"
#include "host/document/Document.h"
#include "host/document/file/DocumentContent.h"

#include <chrono>
#include <filesystem>
#include <memory>

namespace quarn {

/// A document at one moment, as it is kept. All of it is its own but for meshes, materials and
/// textures, which never change: another thread may read it while the document goes on.
struct RecoveryState {
    std::filesystem::path document; ///< the document's own file; empty: it was never saved
    std::chrono::system_clock::time_point kept_at;
    DocumentContent content;                       ///< without its objects, where these are copies
    std::shared_ptr<const ObjectCopies> objects{}; ///< null: they stand in the content
    Image picture; ///< what the active view shows, made small; of no size: as it was kept before
};

} // namespace quarn
