#pragma once

#include "host/import/ModelFile.h"
#include "sdk/qncore/QnCommand.h"

#include <optional>

namespace quarn {

class Document;

/// A model file that a command asked for, or how the command ends without one.
struct AskedModel {
    CQuarnCommand::result result = CQuarnCommand::success;
    std::filesystem::path file;
    ImportedModel model; ///< only after success
};

/// Asks for a model file and reads it. What was wrong is told already.
AskedModel askModel();

/// Adds a model to a document and tells what it holds. Where the document was empty, its views are
/// fitted, so that the model is seen whatever its units.
void addToDocument(Document& document, const AskedModel& asked);

} // namespace quarn
