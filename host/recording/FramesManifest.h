#pragma once

#include "ground/Result.h"
#include "kelmar/KM_Point.h"

#include <cstdint>
#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

class KM_Viewport;

namespace quarn {

/// The camera that a frame was drawn with, in model units.
struct FrameCamera {
    KM_3dPoint place;
    KM_3dPoint target; ///< one unit in front of the place where the view had none
    KM_3dVector up;    ///< unit, perpendicular to the direction of view
    bool is_parallel = false;
    double lens_mm = 0.0; ///< of a perspective view: on a film of 36 mm by 24 mm
    double width = 0.0;   ///< of a parallel view: what the picture spans
    double height = 0.0;

    friend bool operator==(const FrameCamera&, const FrameCamera&) = default;
};

/// Where the sun of a frame stands.
struct FrameSun {
    std::string time;          ///< of the place, "2026-06-21T14:30:00"
    std::string zone;          ///< "UTC+1"
    double azimuth_deg = 0.0;  ///< clockwise from north
    double altitude_deg = 0.0; ///< above the horizon, without refraction

    friend bool operator==(const FrameSun&, const FrameSun&) = default;
};

/// One picture of a recording.
struct ManifestFrame {
    int number = 0;   ///< from 0
    std::string file; ///< its name in the folder, UTF-8
    std::uint64_t bytes = 0;
    std::uint64_t xxh64 = 0; ///< of the file
    std::optional<FrameCamera> camera;
    std::optional<FrameSun> sun; ///< of sun studies

    friend bool operator==(const ManifestFrame&, const ManifestFrame&) = default;
};

/// What the file NAME.frames.json beside the pictures of a recording holds: everything about them
/// that pages, films and other programs need. docs/frames-manifest.md describes it.
struct FramesManifest {
    std::string program; ///< that recorded them, with its version; empty: not known
    std::string name;    ///< of the animation, UTF-8
    std::string kind;    ///< as RecordingSettings has it; empty: not known
    int frames = 0;      ///< of the whole animation
    int width_px = 0;    ///< 0: not known
    int height_px = 0;
    std::string mode;                  ///< English name; empty: not known
    std::string extension;             ///< of the pictures, without a point
    int frame_rate = 0;                ///< at which they are to be played, frames a second
    double metres_per_unit = 0.0;      ///< 0: the document has no units
    std::string place;                 ///< of a sun study, UTF-8; empty: not known, or none
    std::string document;              ///< fingerprint, 16 hexadecimal digits; empty: not known
    std::string settings;              ///< the same of all settings that change pictures
    std::string instructions;          ///< the instruction set that drew them; empty: not known
    std::vector<ManifestFrame> images; ///< those that are there, by rising number

    friend bool operator==(const FramesManifest&, const FramesManifest&) = default;
};

/// "house.frames.json"
std::string manifestName(const std::string& animation);

/// At how many frames a second an animation is played where nobody says otherwise: the largest of
/// 10, 12, 15, 20, 24, 25 and 30 that lets it last 4 seconds, else 10.
int standardFrameRate(int frames);

/// What a manifest tells of a camera. The camera must be valid.
FrameCamera frameCameraOf(const KM_Viewport& viewport);

/// Reads such a file.
/// @return an error, in one sentence, where it is missing, something else, damaged or of a later
///         version of the program
Result<FramesManifest> readFramesManifest(const std::filesystem::path& file);
/// Writes such a file; it appears whole or not at all.
Result<void> writeFramesManifest(const std::filesystem::path& file, const FramesManifest& manifest);

/// The text of such a file.
std::string framesManifestText(const FramesManifest& manifest);
/// Reads it back.
/// @param file  for the message
Result<FramesManifest> parseFramesManifest(std::string_view text,
                                           const std::filesystem::path& file);

} // namespace quarn
