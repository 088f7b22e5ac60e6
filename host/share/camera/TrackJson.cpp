#include "host/share/camera/CameraFile.h"
#include "host/share/camera/TrackText.h"

#include <nlohmann/json.hpp>

namespace quarn {

namespace {

using json = nlohmann::ordered_json;

template <class Coordinates> json listOf(const Coordinates& p) {
    return {p.x, p.y, p.z};
}

json unitsOf(UnitSystem units) {
    const KM_wString name(unitName(units));
    return name.IsEmpty() ? json() : json(name.ToUtf8());
}

json headOf(const CameraTrack& track) {
    const FrameCamera& camera = track.keys.front().camera;
    json head = {{"format", CAMERA_FILE_MARK},
                 {"version", 1},
                 {"program", "quarn " QUARN_VERSION},
                 {"name", track.name},
                 {"units", unitsOf(track.units)},
                 {"metres_per_unit",
                  track.units == UnitSystem::none ? json() : json(metresPerUnit(track.units))},
                 {"up_axis", "z"},
                 {"frame_rate", track.frame_rate},
                 {"frame_count", track.frameCount()},
                 {"width_px", track.picture.width_px},
                 {"height_px", track.picture.height_px},
                 {"projection", camera.is_parallel ? "parallel" : "perspective"}};
    if (camera.is_parallel) {
        head["width"] = track.opening.width();
        head["height"] = track.opening.height();
    } else {
        head["lens_mm"] = camera.lens_mm;
        head["vertical_angle_deg"] = verticalAngle_deg(track.opening);
    }
    return head;
}

json momentOf(const FrameSun& sun) {
    return {{"time", sun.time},
            {"zone", sun.zone},
            {"azimuth_deg", sun.azimuth_deg},
            {"altitude_deg", sun.altitude_deg}};
}

json sunOf(const SunKey& sun) {
    json told = sun.moment ? momentOf(*sun.moment) : json::object();
    told["direction"] = listOf(sun.to_sun);
    return told;
}

json frameOf(const CameraTrack& track, int frame) {
    const CameraKey& key = track.key(frame);
    json told = {{"frame", frame},
                 {"time_s", track.time_s(frame)},
                 {"place", listOf(key.camera.place)},
                 {"target", listOf(key.camera.target)},
                 {"direction", listOf(key.direction)},
                 {"up", listOf(key.camera.up)}};
    if (track.isSunStudy())
        told["sun"] = sunOf(track.suns[static_cast<std::size_t>(frame)]);
    return told;
}

} // namespace

/// A frame takes one line, so that a person can read the file.
std::string trackJson(const CameraTrack& track) {
    std::string text = headOf(track).dump(2);
    text.resize(text.rfind('\n'));
    text += ",\n  \"frames\": [";
    for (int frame = 0; frame < track.frameCount(); ++frame)
        text += (frame == 0 ? "\n    " : ",\n    ") + frameOf(track, frame).dump();
    return text + "\n  ]\n}\n";
}

} // namespace quarn
