#pragma once

#include "kelmar/KM_wString.h"

namespace quarn {

class Document;

/// The animation that is set up in a document: "turntable, 120 frames in Perspective"; of a sun
/// study with its place and clocks, where they have a name. Empty when there is none.
KM_wString animationText(Document& document);

} // namespace quarn
