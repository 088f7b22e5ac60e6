#pragma once

#include "ground/Result.h"
#include "host/document/file/DocumentContent.h"

#include <filesystem>
#include <string>
#include <vector>

namespace quarn {

class Document;

/// What is written of a document, and for whom.
struct DocumentSaveOptions {
    /// From OLDEST_DOCUMENT_VERSION to KM_CURRENT_ARCHIVE_VERSION.
    int version = KM_CURRENT_ARCHIVE_VERSION;
    /// Only the selected objects, without views, cameras and lights.
    bool only_selected = false;
};

/// All that a document file has to hold of the document, with what plug-ins keep in it.
/// @return an error, part of a sentence, when a plug-in could not write
Result<DocumentContent> contentToSave(Document& document, const DocumentSaveOptions& options = {});

/// Adds to the content of a document what plug-ins keep in it, and what nobody here understands.
/// @return as contentToSave, with nothing added
Result<void> addPlugInContent(Document& document, DocumentContent& content,
                              const DocumentSaveOptions& options = {});

/// Writes a document file with what the document holds and what plug-ins keep in it. The file
/// appears whole and on the disk, or not at all; a file that was there before stays whole until
/// then. The document does not change, nor does it remember the file.
/// @return an error that names the file, what could not be written, and why
Result<void> saveDocument(Document& document, const std::filesystem::path& file,
                          const DocumentSaveOptions& options = {});

/// Puts the content of a file into the document that was opened for it just now, and hands plug-ins
/// what they keep in it.
/// @return what could not be taken over, in sentences for the person
std::vector<std::string> openContent(Document& document, const DocumentContent& content);

/// Adds the objects, cameras and lights of a file to a document, and hands plug-ins what they keep
/// in the file: an animation there replaces the one here. Settings and views stay as they are.
/// @return as openContent
std::vector<std::string> importContent(Document& document, const DocumentContent& content);

} // namespace quarn
