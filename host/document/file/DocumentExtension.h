#pragma once

#include <filesystem>

namespace quarn {

/// The ending of document files.
inline constexpr const char* DOCUMENT_EXTENSION = ".quarn";

/// Whether a file is a document by its name, ignoring case.
bool isDocumentFile(const std::filesystem::path& file);

} // namespace quarn
