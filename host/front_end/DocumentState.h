#pragma once

#include "sdk/qncore/QnExport.h"

#include <filesystem>

class CQuarnDoc;

namespace quarn {

/// The document file that a document was opened from or saved to last; empty when there is none.
QNCORE_API std::filesystem::path documentFile(CQuarnDoc& document);

/// Whether a document holds something that its file does not: objects, lights, sun, cameras of
/// views, display modes, frame sizes, or the animation record were changed since it was made,
/// opened or saved. Moving the camera with the mouse alone does not count: nobody wants to be asked
/// about that.
QNCORE_API bool isModified(CQuarnDoc& document);

/// How many objects it has, hidden ones too.
QNCORE_API int objectCount(CQuarnDoc& document);

} // namespace quarn
