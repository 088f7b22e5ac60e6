#pragma once

#include "kelmar/KM_wString.h"

namespace quarn {

class Document;

/// The animation that is set up in a document: "turntable, 120 frames in Perspective". Empty when
/// there is none.
KM_wString animationText(Document& document);

} // namespace quarn
