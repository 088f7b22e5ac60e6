#pragma once

#include "host/recording/RecordingFollower.h"

#include <functional>
#include <memory>
#include <vector>

namespace quarn {

/// Those who follow a recording while it is made.
class RecordingFollowers {
public:
    /// The camera of the view that is recorded, as it is now.
    using Camera = std::function<KM_Viewport()>;

    /// Follows the recording that the next command that records makes.
    void add(std::unique_ptr<RecordingFollower> follower);
    /// The same, before those that were added: they may read what this one writes at the end.
    void addFirst(std::unique_ptr<RecordingFollower> follower);
    /// A recording begins.
    void begin(Camera camera) { m_camera = std::move(camera); }
    /// A frame was there already, whole.
    void frameKept(int number, const std::filesystem::path& file);
    void frameRecorded(int number, const std::filesystem::path& file, const Image& picture);
    /// Tells all of them of the end, and lets them go.
    void end(const RecordingReport& report);
    /// Lets them go where nothing was recorded.
    void clear();

private:
    std::vector<std::unique_ptr<RecordingFollower>> m_followers;
    Camera m_camera;
};

} // namespace quarn
