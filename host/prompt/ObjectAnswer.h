#pragma once

#include "host/prompt/PromptState.h"

#include <optional>
#include <vector>

namespace quarn {

/// Adds the object that a text names to what was given; one that was given already changes nothing.
///
/// @param text  an object's name, ignoring case, or its id
/// @return nothing when it was added; otherwise why not, without a full stop ("Roof is a mesh; pick
///         a point or a curve")
std::optional<KM_wString> takeObject(ObjectPick& pick, const KM_wString& text);

/// Takes the selection of the active document, where the question allows that, nothing was given
/// before and as many objects are wanted.
/// @return whether it was taken; otherwise nothing changes
bool takeSelection(ObjectPick& pick);

/// The names of the objects in the active document that would be a good answer, in its order.
std::vector<KM_wString> objectNames(const ObjectPick& pick);

} // namespace quarn
