#pragma once

#include <chrono>
#include <cstddef>
#include <filesystem>
#include <vector>

namespace quarn {

/// What of a recovery file is shown before it is opened.
struct RecoveryGlance {
    /// Of its last state; of the file's last change, where no state was found.
    std::chrono::system_clock::time_point kept_at;
    std::vector<std::byte> picture; ///< a PNG file; empty: there is none
};

/// Looks at the heads of a recovery file's chunks alone; whether it is damaged shows when it is
/// opened.
RecoveryGlance glanceAt(const std::filesystem::path& recovery);

} // namespace quarn
