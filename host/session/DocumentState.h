#pragma once

#include "sdk/qncore/QnExport.h"

#include <filesystem>

class CQuarnDoc;

namespace quarn {

/// The document file that a document was opened from or saved to last; empty when there is none.
QNCORE_API std::filesystem::path documentFile(CQuarnDoc& document);

/// Whether a document holds something that its file does not: objects, their names and visibility,
/// lights, sun, views, their display modes and frame sizes, edges, or the animation are others than
/// when it was made, opened or saved. What was put back is no change: a curve that is hidden while
/// an animation plays, a light that a sun study moves.
///
/// These alone do not count, so that nobody is asked to save them: cameras, which view is active,
/// what is selected, which frame of the animation was shown last and that its view has the
/// animation's display mode since, frame sizes that a window gives with setFrameSize. A new
/// document, and one that a model file was opened as, is not modified; nor is one after SaveAs in
/// an older version of the file where it was not before, but that does not make a modified one
/// unmodified, because such a file may hold less.
///
/// Takes some milliseconds for a document of many thousand objects or frames; ask after commands,
/// not for every picture.
QNCORE_API bool isModified(CQuarnDoc& document);

/// The folder that choosers show first: that of the document at work, else that of the user's
/// documents; empty where neither is known.
QNCORE_API std::filesystem::path firstFolder();

/// How many objects it has, hidden ones too.
QNCORE_API int objectCount(CQuarnDoc& document);

} // namespace quarn
