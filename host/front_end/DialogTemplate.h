#pragma once

#include "kelmar/KM_wString.h"

#include <vector>

namespace quarn {

/// One control of a dialog.
struct DialogControl {
    enum class Kind { text, number, integer, date, time, combo_box, button };
    int id = 0;
    Kind kind = Kind::text;
    KM_wString label; ///< in the user's language; of a button: what stands on it
    KM_wString hint;  ///< a tool tip, in the user's language; may be empty
    /// Whether it stands in the row of the control before it, as a button beside its field does.
    bool joins_row = false;
};

/// What a dialog looks like: its controls from top to bottom, which is also the order of the Tab
/// key. OK and Cancel are there in any case.
struct DialogTemplate {
    int id = 0;
    KM_wString title; ///< in the user's language
    std::vector<DialogControl> controls;
};

} // namespace quarn
