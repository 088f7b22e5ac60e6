#pragma once

#include "sdk/qncore/QnGet.h"

#include <string>
#include <vector>

namespace quarn {

/// The objects that a command works on, or how the command ends without them.
struct PickedObjects {
    CQuarnCommand::result result = CQuarnCommand::cancel;
    std::vector<KM_UUID> ids; ///< after success, one at least; an object named twice stands twice
};

/// Asks for the objects that a command works on, as its last question. Every word that the
/// command's line has left is an object, up to `_Enter` or the end of the line. A line without
/// words means the selection; where nothing is selected, the person names objects until Enter.
PickedObjects askObjects(const wchar_t* prompt);

/// "1 object", "3 objects".
std::string objectCountText(std::size_t count);

} // namespace quarn
