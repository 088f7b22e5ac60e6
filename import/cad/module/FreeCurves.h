#pragma once

#include "import/assembly/SourceScene.h"

#include <TopoDS_Shape.hxx>

namespace quarn {

/// Adds the edges of a shape that bound no face as polylines, and the vertices that end no edge as
/// points, in one piece; none where there are none.
/// @param tolerance  how far a polyline may lie beside its curve
void addFreeCurves(const TopoDS_Shape& shape, double tolerance, const KM_wString& name,
                   SourceScene& scene);

} // namespace quarn
