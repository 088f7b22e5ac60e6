#pragma once

#include "ground/AtomicFile.h"
#include "ground/Result.h"
#include "host/document/file/DocumentContent.h"

#include <filesystem>

namespace quarn {

/// Writes a document file. It appears whole and on the disk, or not at all; a file that was there
/// before stays whole until then.
/// @param protection  whether a file that is protected from writing is left alone
/// @return as writeFileToDisk; an error names the file, what could not be written, and why
Result<WrittenFile> writeDocumentFile(const DocumentContent& content,
                                      const std::filesystem::path& file,
                                      Protection protection = Protection::respected);

/// Reads a document file whole and checks it.
/// @return an error that names the file and tells what is wrong with it
Result<DocumentContent> readDocumentFile(const std::filesystem::path& file);

} // namespace quarn
