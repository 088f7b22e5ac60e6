#pragma once

#include "tests/desktop_window/driver/Desk.h"

namespace quarn::test {

/// A desk whose documents hold a small model, `house.obj`: two objects with 24 triangles.
class HouseDesk : public Desk {
public:
    HouseDesk();

    /// Starts the program with the model open.
    void startWithHouse(DeskStart start = {});
    /// Opens the model in the file chooser.
    void openHouse();
    /// Sets up a turntable of 100 frames by the form.
    void setUpTurntable();
    /// Looks until the output holds a text.
    void waitForOutput(const QString& text);
};

} // namespace quarn::test
