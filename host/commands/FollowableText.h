#pragma once

#include "host/document/Document.h"

namespace quarn {

/// The object's name, or its id where it has none.
KM_wString nameOrId(const DocumentObject& object);

/// What a camera can follow, a line for each: curves with kind, length, whether they are closed,
/// and the number of points that define them; and points. Says so where there are none.
KM_wString followableText(const Document& document);

} // namespace quarn
