#pragma once

#include <string>

namespace quarn {

class Document;
struct ImportedPlace;

/// Has sun studies begin with the place that a model states: it becomes that of the animation
/// record, which their forms are filled from. A document that has a place keeps it: one that a sun
/// study was set up for, or one of a model before.
/// @return what the person is told of it, in UTF-8; empty where nothing changed
std::string offerStudyPlace(Document& document, const ImportedPlace& place);

} // namespace quarn
