#pragma once

#include "host/session/ViewPicking.h"
#include "sdk/qncore/QnDoc.h"

#include <QString>

namespace quarn::desktop {

/// The command line that selects what a person clicked on: that object alone, or it as well.
/// Nothing picked selects nothing, or, where it adds, leaves the selection.
/// @return empty where there is nothing to do
QString selectLine(const CQuarnDoc& document, const std::optional<PickedObject>& picked, bool adds);

/// A picked object as an answer: the name where it finds this very object; else the id.
KM_wString objectWord(const CQuarnDoc& document, const PickedObject& picked);

/// A point as a question for points takes it: "1.25,0,-3", with as many digits as a click has.
KM_wString pointText(const KM_3dPoint& point);

} // namespace quarn::desktop
