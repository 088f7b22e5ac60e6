#pragma once

#include "host/document/LightChoice.h"
#include "sdk/qncore/QnCommand.h"

namespace quarn {

class DocumentDrawing;

// The questions about what a document is lit by beside its own lights. Enter keeps what is chosen
// already. After any other result than success the choice is what it was before.

/// Asks what lies around. A picture is read at once, and one that cannot be read is told.
/// @param drawing  keeps the picture that was read
CQuarnCommand::result askSurroundings(const CQuarnCommandContext& context, DocumentDrawing& drawing,
                                      LightChoice& choice);
CQuarnCommand::result askExposure(LightChoice& choice);
CQuarnCommand::result askBackground(LightChoice& choice);

/// Lets a person choose a picture of surroundings with a chooser.
/// @return empty where none was chosen
std::filesystem::path chooseSurroundings(const CQuarnCommandContext& context,
                                         const std::filesystem::path& present);

} // namespace quarn
