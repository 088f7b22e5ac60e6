#pragma once

#include <filesystem>

namespace quarn {

/// How much of the fence stands.
struct Fence {
    bool has_call_filter = false; ///< calls of the system: no network, no programs, no writing
    bool has_file_rules = false;  ///< files: only those that it was given
};

/// Fences this process for good, as far as the kernel can: from now on it opens no file for writing
/// and no connection, starts no process, looks into no other one and sends no signal. Where the
/// kernel has rules for files, it opens only those of the model's folder and below it, the model
/// file itself, where its path is a link, and what the system's libraries need: libraries and their
/// data, but nobody's documents. Threads go on working. To be called while there is only one.
Fence raiseFence(const std::filesystem::path& model);

} // namespace quarn
