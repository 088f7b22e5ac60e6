#pragma once

#include "ground/Result.h"
#include "import/ModelReading.h"

#include <TDocStd_Document.hxx>

namespace quarn {

/// Makes meshes of the parts of a document, each once however often an assembly repeats it, cut by
/// the colours of their faces. Curves and points that belong to no face come too.
/// @return an error whose message is why not, a part of a sentence: given up, or too much memory
Result<SourceScene> meshesOf(const Handle(TDocStd_Document) & document,
                             const ModelReading& reading);

} // namespace quarn
