#pragma once

#include "engine/render/Renderer.h"
#include "ground/Result.h"

#include <functional>

class KM_Viewport;

namespace quarn {

class Document;
struct Image;
struct SceneChanges;

/// Renders a picture of a document while the front end works on its events and shows how far it
/// is. The person ends it with Escape or by asking the program to stop.
/// @param shown  takes the picture so far; may be empty
/// @return as Renderer::render
Result<RenderEnd> renderWatched(Document& document, const KM_Viewport& viewport,
                                const RenderRequest& request, Image& picture,
                                const SceneChanges& changes, const Renderer::Shown& shown = {});

} // namespace quarn
