#pragma once

#include "host/app/LibraryFile.h"
#include "host/front_end/PlugInLoad.h"

#include <string>

namespace quarn {

/// Checks the entry functions that every plug-in file exports, and the interface version that it
/// was built for.
/// @return loaded, exports_missing (the message names them) or version_mismatch (the message gives
///         both numbers)
PlugInLoad checkExports(const LibraryFile& library, const std::filesystem::path& file);

/// Says why the linker refused a file: a plug-in that was linked against another version of the
/// host's libraries, or no library at all.
PlugInLoad refusedByLinker(const std::string& reason, const std::filesystem::path& file);

} // namespace quarn
