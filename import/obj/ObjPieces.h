#pragma once

#include "import/obj/ObjContent.h"

namespace quarn {

/// Sorts the elements of the parts into pieces, and collects the material files' names. Each
/// statement of a group or an object with another name than the one before begins an object; in an
/// object the elements of one material are one piece. A piece without a name that is not the only
/// one of its object is named after its material.
void takePieces(ObjContent& content);

} // namespace quarn
