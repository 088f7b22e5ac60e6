#pragma once

#include "host/commands/FileAsking.h"
#include "host/document/DocumentScene.h"
#include "host/document/file/DocumentContent.h"
#include "import/ImportedModel.h"
#include "sdk/qncore/QnCommand.h"

#include <filesystem>
#include <memory>
#include <variant>

namespace quarn {

class Document;
class DocumentList;

/// A model or document file that a command asked for, or how the command ends without one.
struct AskedFile {
    CQuarnCommand::result result = CQuarnCommand::success;
    std::filesystem::path file;
    bool is_given_up = false;                             ///< by the person, while it was read
    std::variant<ImportedModel, DocumentContent> content; ///< only after success
    bool is_interactive = false;                          ///< a person in a window asked for it
    std::unique_ptr<DocumentScene> scene; ///< of the document with the content; null: not built
};

/// Asks for a model or document file, reads and checks it whole and, where it is large and will be
/// drawn, builds the scene; no open document is touched. What was wrong is told already. A person
/// in a window is asked which way a model is up, where only habit says so.
/// @param use  what the file is for: to open or to import
AskedFile askFileToRead(const CQuarnCommandContext& context, FileUse use);

/// Adds what was read to a document and tells what it is. Where the document was empty, its views
/// are fitted, so that the model is seen whatever its units.
void addToDocument(Document& document, AskedFile& asked);

/// Opens a new document with what was read and tells what it is. A document file's views come as
/// they were saved, and the new document remembers the file.
void openAsDocument(DocumentList& list, AskedFile& asked);

} // namespace quarn
