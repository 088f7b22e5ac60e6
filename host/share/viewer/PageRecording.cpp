#include "host/share/viewer/PageRecording.h"

#include <algorithm>
#include <nlohmann/json.hpp>

namespace quarn {

namespace {

using Json = nlohmann::ordered_json;

constexpr int TO_THE_LEFT = -1;
constexpr int TO_THE_RIGHT = 1;

std::string pageKind(const FramesManifest& manifest) {
    if (manifest.kind == "turntable")
        return "turntable";
    const bool is_study = manifest.kind == "one_day_sun" || manifest.kind == "seasonal_sun";
    return is_study ? "study" : "walk";
}

std::uint64_t meanBytes(const FramesManifest& manifest) {
    std::uint64_t bytes = 0;
    for (const ManifestFrame& frame : manifest.images)
        bytes += frame.bytes;
    return bytes / manifest.images.size();
}

/// The file of each frame, null for one that is not there.
Json filesOf(const PageRecording& recording) {
    Json files(std::vector<Json>(static_cast<std::size_t>(pageFrames(recording.manifest))));
    for (const ManifestFrame& frame : recording.manifest.images)
        files[static_cast<std::size_t>(frame.number)] = recording.is_one_file ? "" : frame.file;
    return files;
}

/// Time, zone, azimuth and altitude of each frame; null where a study has none.
Json sunsOf(const FramesManifest& manifest) {
    const bool has_sun = std::ranges::any_of(
        manifest.images, [](const ManifestFrame& frame) { return frame.sun.has_value(); });
    if (!has_sun)
        return nullptr;
    Json suns(std::vector<Json>(static_cast<std::size_t>(pageFrames(manifest))));
    for (const ManifestFrame& frame : manifest.images)
        if (const auto& sun = frame.sun)
            suns[static_cast<std::size_t>(frame.number)] =
                Json::array({sun->time, sun->zone, sun->azimuth_deg, sun->altitude_deg});
    return suns;
}

} // namespace

int pageFrames(const FramesManifest& manifest) {
    const int there = manifest.images.back().number + 1;
    return manifest.kind == "turntable" ? std::max(there, manifest.frames) : there;
}

int turnOf(const FramesManifest& manifest) {
    double anticlockwise = 0.0; // of the camera, seen from above
    const ManifestFrame* before = nullptr;
    for (const ManifestFrame& frame : manifest.images) {
        if (before && before->number + 1 == frame.number && before->camera && frame.camera) {
            const KM_3dVector from = before->camera->place - before->camera->target;
            const KM_3dVector to = frame.camera->place - frame.camera->target;
            anticlockwise += from.x * to.y - from.y * to.x;
        }
        before = &frame;
    }
    return anticlockwise < 0.0 ? TO_THE_RIGHT : TO_THE_LEFT;
}

std::string pageRecordingJson(const PageRecording& recording) {
    const FramesManifest& manifest = recording.manifest;
    const std::string kind = pageKind(manifest);
    const int rate =
        manifest.frame_rate > 0 ? manifest.frame_rate : standardFrameRate(pageFrames(manifest));
    const Json json = {
        {"title", recording.title},
        {"kind", kind},
        {"count", pageFrames(manifest)},
        {"first", manifest.images.front().number},
        {"width", recording.width_px},
        {"height", recording.height_px},
        {"rate", rate},
        {"turn", kind == "turntable" ? turnOf(manifest) : TO_THE_RIGHT},
        {"inside", recording.is_one_file},
        {"bytes", meanBytes(manifest)},
        {"files", filesOf(recording)},
        {"suns", sunsOf(manifest)},
        {"place", manifest.place},
    };
    return json.dump(-1, ' ', false, Json::error_handler_t::replace);
}

} // namespace quarn
