#pragma once

#include "tests/zoetrix/PlugInFixture.h"

/// A small scene, a view of 64 by 48 pixels, and an animation whose frames go into `frames`.
class RecordingFixture : public PlugInFixture {
protected:
    void SetUp() override;

    /// Small rendered pictures, by few samples: 32 by 24 pixels.
    void renderSmall();

    /// The names of the files in the folder, in order.
    std::vector<std::string> files() const;

    const std::filesystem::path frames = folder.path() / "frames";
};
