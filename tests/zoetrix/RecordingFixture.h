#pragma once

#include "tests/zoetrix/PlugInFixture.h"

/// A small scene, a view of 64 by 48 pixels, and an animation whose frames go into `frames`.
class RecordingFixture : public PlugInFixture {
protected:
    void SetUp() override;

    /// Loads commands that stand in for a renderer, and empties their journal.
    void loadRenderer();
    static std::string journal();

    /// The names of the files in the folder, in order.
    std::vector<std::string> files() const;

    const std::filesystem::path frames = folder.path() / "frames";
};
