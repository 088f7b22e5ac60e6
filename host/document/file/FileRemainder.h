#pragma once

#include "host/document/file/DocumentContent.h"

#include <algorithm>

namespace quarn {

/// What of a document file nobody here understands. It is kept as it came, and written back.
struct FileRemainder {
    /// Of plug-ins that are not loaded or could not read it.
    std::vector<PlugInContent> plug_ins;
    std::vector<UnknownContent> unknown;

    /// Keeps what a plug-in has in a file, in place of what was kept for it before.
    void keep(const PlugInContent& plug_in) {
        forget(plug_in.plug_in_id);
        plug_ins.push_back(plug_in);
    }
    /// What is kept for a plug-in; null when nothing is.
    const PlugInContent* find(const KM_UUID& plug_in_id) const {
        const auto found = std::ranges::find(plug_ins, plug_in_id, &PlugInContent::plug_in_id);
        return found == plug_ins.end() ? nullptr : &*found;
    }
    void forget(const KM_UUID& plug_in_id) {
        std::erase_if(plug_ins,
                      [&](const PlugInContent& kept) { return kept.plug_in_id == plug_in_id; });
    }
};

} // namespace quarn
