#pragma once

#include "host/document/ObjectTable.h"
#include "sdk/qncore/QnCommand.h"

namespace quarn {

/// Asks for the name of the curve that a new one takes the place of; it keeps its id, so that
/// whatever follows it follows the new one. A name that no object has is that of a new object.
///
/// @return success, and a name that is free or a curve's; else how the command ends
CQuarnCommand::result askReplacedCurve(const ObjectTable& objects, KM_wString& name);
/// As above, for a point.
CQuarnCommand::result askReplacedPoint(const ObjectTable& objects, KM_wString& name);

} // namespace quarn
