#pragma once

#include "ground/Result.h"

namespace quarn {

class DocumentScene;
struct Image;
struct ImportedModel;

/// Draws a model that is in no document as it stands on the ground in the sun, seen from before it,
/// to its right and above.
/// @param scene  takes the model over
/// @return an error, with no use to be made of the picture, when the model cannot be drawn
Result<void> drawModel(const ImportedModel& model, DocumentScene& scene, int width_px,
                       int height_px, Image& picture);

} // namespace quarn
