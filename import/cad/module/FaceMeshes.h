#pragma once

#include "ground/Result.h"
#include "import/ReadingBudget.h"
#include "import/assembly/SourceScene.h"

#include <TDF_Label.hxx>
#include <XCAFPrs_Style.hxx>

namespace quarn {

/// Adds the triangles of a part's faces to the scene, a piece for each colour of them, with the
/// normals of the surfaces.
/// @param style  what the place of the part gives it
/// @return an error whose message is why not, a part of a sentence: the budget does not hold them
Result<void> addFaceMeshes(const TDF_Label& part, const XCAFPrs_Style& style,
                           const KM_wString& name, ReadingBudget& budget, SourceScene& scene);

} // namespace quarn
