#pragma once

#include "import/ImportedModel.h"
#include "kelmar/KM_Xform.h"

namespace quarn {

/// Y up to Z up: x stays, y becomes z, z becomes -y.
KM_Xform zUpFromYUp();

/// The model as it is when the other axis of its file is taken as the one that points up, because a
/// person said so. Large meshes stay shared and stand elsewhere, so that what was built of them can
/// be used again. For formats that leave the axis open: they hold no cameras, lights and places.
/// @param up  y or z, other than the one that was taken
ImportedModel turnedUp(const ImportedModel& model, UpAxis up);

} // namespace quarn
