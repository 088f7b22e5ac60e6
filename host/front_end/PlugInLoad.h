#pragma once

#include <string>

namespace quarn {

/// How a plug-in file was loaded, or why not.
struct PlugInLoad {
    enum class Outcome {
        loaded,
        loaded_before,
        unknown_id,
        file_missing,
        not_a_library,
        exports_missing,
        version_mismatch,
        load_refused,
    };
    Outcome outcome = Outcome::loaded;
    /// One sentence for a person; empty when it was loaded.
    std::string message;

    bool ok() const { return outcome <= Outcome::loaded_before; }
};

} // namespace quarn
