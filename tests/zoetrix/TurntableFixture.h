#pragma once

#include "tests/zoetrix/DialogEntries.h"
#include "tests/zoetrix/PlugInFixture.h"

/// A view whose camera stands at (5, 4, 3) and looks at (2, 0, 1): the circle has radius 5 about
/// (2, 0, 3). Commands are answered at the command line or in a dialog; every test begins with the
/// direction that a freshly loaded plug-in has.
class TurntableFixture : public PlugInFixture {
protected:
    explicit TurntableFixture(const std::string& plug_ins = "dialogs");

    void SetUp() override;

    /// Runs the command as a person does who enters this into the dialog.
    CQuarnCommand::result runInDialog(const Entered& entered);
    /// Runs the command with prompts: frames, direction, and Enter to the rest.
    CQuarnCommand::result runAtCommandLine(const wchar_t* frames, const wchar_t* direction);

    static constexpr KM_3dPoint eye{5.0, 4.0, 3.0};
    static constexpr KM_3dPoint target{2.0, 0.0, 1.0};
    static constexpr KM_3dPoint centre{2.0, 0.0, 3.0};
    static constexpr double radius = 5.0;

    /// How far around the circle the camera of a frame stands from the eye, anticlockwise seen from
    /// above, in radians from 0 to 2 pi.
    double angleOf(const KM_3dPoint& point) const;
};
