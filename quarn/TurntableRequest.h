#pragma once

#include "quarn/CommandLine.h"
#include "quarn/Words.h"

#include <filesystem>
#include <optional>
#include <string>
#include <variant>
#include <vector>

namespace quarn::program {

/// A turntable that can be recorded: every value is checked.
struct TurntableRequest {
    std::filesystem::path model;
    std::string up_axis; ///< "Y", "Z" or, by the format, empty
    std::filesystem::path folder;
    std::string name; ///< of the animation, its pictures and its page; UTF-8
    int frames;
    PixelSize size;
    std::string capture_option; ///< as the capture prompt knows it, with its underscore
    std::string format;         ///< "jpg", "png", "bmp" or "tga"
    bool is_clockwise;
    double elevation_deg; ///< of the camera above the horizon through its target
    std::optional<double> distance_factor;
    std::optional<Triple> target;
    std::vector<std::string> hidden; ///< names of objects; UTF-8
    std::filesystem::path document;  ///< to save, a .quarn file; empty: none
};

/// Checks what was typed, before anything runs.
/// @return the turntable, or the first mistake
std::variant<TurntableRequest, Outcome> checkTurntable(const TurntableOptions& options);

/// The path of the page that the recording writes.
std::filesystem::path pagePath(const TurntableRequest& request);

} // namespace quarn::program
